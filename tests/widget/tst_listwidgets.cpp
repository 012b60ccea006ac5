// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/containerelement.h>
#include <kvt-common/elementselementwidget.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/listwidgetproxymodel.h>
#include <kvt-common/nodeselementwidget.h>

#include "elementtreestring.h"
#include "screenshot.h"

#include <QAbstractItemModelTester>
#include <QSettings>
#include <QtTest>
#include <QtWidgets>

#include <memory>

namespace {

// The listed container: "staff", of type "group", with three columns.
struct ListRoot : TestElement<ContainerElement> {
    explicit ListRoot(Module &module) : TestElement(module, rightsYes, "group", "staff") {}
    int columnCount() const override { return 3; }
};

QComboBox *typeBox(QWidget *w) { return w->findChild<QComboBox *>("_patternTypeComboBox"); }
QLineEdit *patternEdit(QWidget *w) { return w->findChild<QLineEdit *>("_patternLineEdit"); }
void type(QWidget *w, int mode, const QString &pattern)
{
    typeBox(w)->setCurrentIndex(mode);
    patternEdit(w)->setFocus();
    QTest::keyClicks(patternEdit(w), pattern);
}
// The first shown column of the listed rows, in the order of the view.
QString shownOrder(const ListElementWidget *widget)
{
    QStringList texts;
    for (int row = 0; row < widget->proxy()->rowCount(); ++row)
        texts.append(widget->proxy()->index(row, 0).data().toString());
    return texts.join(QLatin1Char(' '));
}
// The listed rows by element title, sorted.
QString rows(const ListElementWidget *widget)
{
    QStringList titles;
    for (int row = 0; row < widget->proxy()->rowCount(); ++row)
        titles.append(widget->proxy()->toElement(widget->proxy()->index(row, 0))->title());
    titles.sort();
    return titles.join(QLatin1Char(' '));
}

} // namespace

class ListWidgetsTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordingModule> module;
    ListRoot *root = nullptr;
    std::unique_ptr<QAbstractItemModelTester> tester;

    // Made, kept by the module (which deletes it), shown for the root and watched.
    template <class W>
    W *show(const QString &type = QStringLiteral("group"))
    {
        auto *widget = new W(type, *module, rightsYes);
        module->insertElementWidget(widget);
        widget->setElement(root, EditElementRole);
        tester.reset(new QAbstractItemModelTester(widget->proxy(), QAbstractItemModelTester::FailureReportingMode::QtTest));
        widget->resize(400, 300);
        widget->show();
        return widget;
    }

private Q_SLOTS:
    void initTestCase() { QCoreApplication::setOrganizationName(QStringLiteral("kvt-tests")); }
    void init()
    {
        module.reset(new RecordingModule(QStringLiteral("users")));
        root = new ListRoot(*module);
        root->setParent(module.get());
        // x is a supplement (flag 1); dave's children are not listed.
        ElementTreeString::build(*module, root, QStringLiteral("alice bob Carol dave[d1 d2] x#1"));
    }
    void cleanup()
    {
        tester.reset();
        module.reset();
        // The line edit's clear button fades in by an animation that frees
        // itself at the next animation tick once its button is gone.
        QTest::qWait(50);
        QSettings().clear();
    }

    void filter_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<QString>("pattern");
        QTest::addColumn<QString>("expected");
        // Column n of an element shows "<title>:<n>"; column 0 its title only.
        QTest::newRow("no filter: first level, no supplement") << 0 << "" << "Carol alice bob dave";
        QTest::newRow("wildcard, any case") << 0 << "C*L" << "Carol";
        QTest::newRow("regexp matching column 0 only") << 1 << "^alice$" << "";
        QTest::newRow("last column searched") << 1 << "e:2$" << "alice dave";
    }
    void filter()
    {
        QFETCH(int, mode);
        QFETCH(QString, pattern);
        auto *widget = show<ElementsElementWidget>();
        type(widget, mode, pattern);
        QTEST(rows(widget), "expected");
        QCOMPARE(widget->proxy()->columnCount(), 2); // column 0 is never shown
    }

    void choosingAndContextMenu_data()
    {
        QTest::addColumn<bool>("nodes");
        QTest::newRow("nodes") << true;
        QTest::newRow("elements") << false;
    }
    void choosingAndContextMenu()
    {
        QFETCH(bool, nodes);
        ListElementWidget *widget = nodes ? static_cast<ListElementWidget *>(show<NodesElementWidget>())
                                          : show<ElementsElementWidget>();
        QVERIFY(QTest::qWaitForWindowExposed(widget));
        QVERIFY(keepScreenshot(widget, QString::fromLatin1(widget->metaObject()->className()).toLower()));
        ElementTreeView *view = widget->elementTreeView();

        // A double click on any cell of bob's row makes bob current, unselected.
        TreeNode *bob = ElementTreeString::find(root, "bob");
        QSignalSpy current(bob, SIGNAL(setCurrentNode(TreeNode*)));
        const QModelIndex index = widget->proxy()->treeNodeToIndex(bob);
        const QPoint centre = view->visualRect(index.sibling(index.row(), 1)).center();
        QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, centre);
        QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, centre);
        QCOMPARE(current.count(), 1);
        QVERIFY(!view->selectionModel()->hasSelection());

        // The module relays the menu request in global coordinates, measured
        // from the top of the view: below a shown header, at the point of a hidden one.
        module->connectElementWidgets();
        QSignalSpy menu(module.get(), SIGNAL(customContextMenuRequested(QPoint)));
        Q_EMIT view->customContextMenuRequested(QPoint(5, 7));
        const int header = nodes ? 0 : view->header()->height();
        QVERIFY(menu.count() == 1 && (nodes || header > 0));
        QCOMPARE(menu.first().first().toPoint(), view->mapToGlobal(QPoint(5, 7 + header)));
    }

    // A list opens sorted ascending on its first shown column (a header left
    // to itself would start descending); a stored header state still wins
    // (settingsPerType).
    void initialSorting()
    {
        auto *widget = show<ElementsElementWidget>();
        QCOMPARE(shownOrder(widget), QStringLiteral("Carol:1 alice:1 bob:1 dave:1"));
        const QHeaderView *header = widget->elementTreeView()->header();
        QVERIFY(header->sortIndicatorSection() == 0 && header->sortIndicatorOrder() == Qt::AscendingOrder);
    }

    void settingsPerType()
    {
        QSettings settings;
        auto *group = show<ElementsElementWidget>();
        type(group, 1, QStringLiteral("^[ab]"));
        group->elementTreeView()->sortByColumn(1, Qt::DescendingOrder);
        delete group;
        QCOMPARE(settings.value("elementsElementWidget/groupFilterValue").toString(), QStringLiteral("^[ab]"));

        // A new widget of the same type finds its filter and sorting again;
        // a widget of another type does not.
        group = show<ElementsElementWidget>();
        QCOMPARE(typeBox(group)->currentIndex(), 1);
        QCOMPARE(rows(group), QStringLiteral("alice bob"));
        QHeaderView *header = group->elementTreeView()->header();
        QVERIFY(header->sortIndicatorSection() == 1 && header->sortIndicatorOrder() == Qt::DescendingOrder);
        QCOMPARE(rows(show<ElementsElementWidget>(QStringLiteral("host"))), QStringLiteral("Carol alice bob dave"));
    }
};

QTEST_MAIN(ListWidgetsTest)
#include "tst_listwidgets.moc"
