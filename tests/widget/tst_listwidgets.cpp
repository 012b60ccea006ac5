#include <kvt-common/containerelement.h>
#include <kvt-common/elementselementwidget.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/listwidgetproxymodel.h>
#include <kvt-common/nodeselementwidget.h>

#include "elementtreestring.h"
#include "screenshot.h"

#include <QAbstractItemModelTester>
#include <QComboBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QSettings>
#include <QtTest>

#include <memory>

namespace {

// The listed container: "staff", of type "group", with a chosen number of columns.
struct ListRoot : TestElement<ContainerElement> {
    ListRoot(Module &module, int columns) : TestElement(module, rightsYes, "group", "staff"), columns(columns) {}
    int columnCount() const override { return columns; }
    int columns;
};

} // namespace

class ListWidgetsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { QCoreApplication::setOrganizationName(QStringLiteral("kvt-tests")); }
    void cleanup();

    void filter_data();
    void filter();
    void liveTreeUnderFilter();
    void choosingAndContextMenu_data()
    {
        QTest::addColumn<bool>("nodes");
        QTest::newRow("nodes") << true;
        QTest::newRow("elements") << false;
    }
    void choosingAndContextMenu();
    void settingsPerType();

private:
    std::unique_ptr<RecordingModule> module;
    ListRoot *root = nullptr;
    std::unique_ptr<QAbstractItemModelTester> tester;

    void build(int columns = 3)
    {
        module.reset(new RecordingModule(QStringLiteral("users")));
        root = new ListRoot(*module, columns);
        root->setParent(module.get());
        // x is a supplement (flag 1); dave's children are not listed.
        ElementTreeString::build(*module, root, QStringLiteral("alice bob Carol dave[d1 d2] x#1"));
    }
    // Made, kept by the module (which deletes it), shown for the root and watched.
    template <class W>
    W *show(const QString &type = QStringLiteral("group"))
    {
        auto *widget = new W(type, *module, rightsYes);
        module->insertElementWidget(widget);
        widget->setElement(root, EditElementRole);
        tester.reset(new QAbstractItemModelTester(widget->proxy(),
                                                  QAbstractItemModelTester::FailureReportingMode::QtTest));
        widget->resize(400, 300);
        widget->show();
        return widget;
    }
    static QString rows(const ListElementWidget *widget)
    {
        QStringList titles;
        const ListWidgetProxyModel *proxy = widget->proxy();
        if (proxy->columnCount() == 0) // no index to name a row by
            return QStringLiteral("%1 rows").arg(proxy->rowCount());
        for (int row = 0; row < proxy->rowCount(); ++row) {
            const Element *element = proxy->toElement(proxy->index(row, 0));
            titles.append(element ? element->title() : QStringLiteral("?"));
        }
        titles.sort();
        return titles.join(QLatin1Char(' '));
    }
    static QComboBox *typeBox(QWidget *w) { return w->findChild<QComboBox *>("_patternTypeComboBox"); }
    static QLineEdit *patternEdit(QWidget *w) { return w->findChild<QLineEdit *>("_patternLineEdit"); }
    static void type(QWidget *w, int mode, const QString &pattern)
    {
        typeBox(w)->setCurrentIndex(mode);
        patternEdit(w)->setFocus();
        QTest::keyClicks(patternEdit(w), pattern);
    }
};

void ListWidgetsTest::cleanup()
{
    tester.reset();
    module.reset();
    // The line edit's clear button fades in by an animation that frees itself
    // at the next animation tick once its button is gone.
    QTest::qWait(50);
    QSettings().clear();
}

void ListWidgetsTest::filter_data()
{
    QTest::addColumn<int>("columns");
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("expected");
    // Column n of an element shows "<title>:<n>"; column 0 its title only.
    QTest::newRow("no filter: first level, no supplement") << 3 << 0 << "" << "Carol alice bob dave";
    QTest::newRow("wildcard, any case") << 3 << 0 << "C*L" << "Carol";
    QTest::newRow("regexp matching column 0 only") << 3 << 1 << "^alice$" << "";
    QTest::newRow("last column searched") << 3 << 1 << "e:2$" << "alice dave";
    QTest::newRow("fixed string a.") << 3 << 2 << "a." << "";
    QTest::newRow("single column, filter") << 1 << 2 << "a" << "0 rows";
}

void ListWidgetsTest::filter()
{
    QFETCH(int, columns);
    QFETCH(int, mode);
    QFETCH(QString, pattern);
    QFETCH(QString, expected);
    build(columns);
    auto *widget = show<ElementsElementWidget>();
    type(widget, mode, pattern);
    QCOMPARE(rows(widget), expected);
    // Column 0 is never shown.
    QCOMPARE(widget->proxy()->columnCount(), columns - 1);
}

void ListWidgetsTest::liveTreeUnderFilter()
{
    build();
    auto *widget = show<ElementsElementWidget>();
    type(widget, 0, QStringLiteral("O"));
    QCOMPARE(rows(widget), QStringLiteral("Carol bob"));

    ElementTreeString::build(*module, root, QStringLiteral("olga ivan"));
    ElementTreeString::build(*module, ElementTreeString::find(root, "Carol"), QStringLiteral("oscar"));
    delete ElementTreeString::find(root, "bob");
    static_cast<Element *>(ElementTreeString::find(root, "dave"))->setTitle(QStringLiteral("otto"));
    static_cast<Element *>(ElementTreeString::find(root, "Carol"))->setTitle(QStringLiteral("karl"));
    QCOMPARE(rows(widget), QStringLiteral("olga otto"));

    patternEdit(widget)->clear();
    QCOMPARE(rows(widget), QStringLiteral("alice ivan karl olga otto"));
    QVERIFY(keepScreenshot(widget, QStringLiteral("elementselementwidget")));
}

void ListWidgetsTest::choosingAndContextMenu()
{
    QFETCH(bool, nodes);
    build();
    ListElementWidget *widget = nodes ? static_cast<ListElementWidget *>(show<NodesElementWidget>())
                                      : show<ElementsElementWidget>();
    QVERIFY(QTest::qWaitForWindowExposed(widget));
    QCOMPARE(rows(widget), QStringLiteral("Carol alice bob dave"));
    ElementTreeView *view = widget->elementTreeView();
    QCOMPARE(view->isHeaderHidden(), nodes);

    // A double click on any cell of bob's row makes bob current, unselected.
    TreeNode *bob = ElementTreeString::find(root, "bob");
    QSignalSpy current(bob, SIGNAL(setCurrentNode(TreeNode*)));
    const QModelIndex index = widget->proxy()->treeNodeToIndex(bob);
    const QPoint centre = view->visualRect(index.sibling(index.row(), view->model()->columnCount() - 1)).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, centre);
    QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, centre);
    QCOMPARE(current.count(), 1);
    QVERIFY(!view->selectionModel()->hasSelection());

    // The module relays the menu request in global coordinates, measured
    // from the top of the view: below a shown header, at the point of a
    // hidden one.
    module->connectElementWidgets();
    QSignalSpy menu(module.get(), SIGNAL(customContextMenuRequested(QPoint)));
    Q_EMIT view->customContextMenuRequested(QPoint(5, 7));
    const int header = nodes ? 0 : view->header()->height();
    QVERIFY(menu.count() == 1 && (nodes || header > 0));
    QCOMPARE(menu.first().first().toPoint(), view->mapToGlobal(QPoint(5, 7 + header)));
}

void ListWidgetsTest::settingsPerType()
{
    build();
    QSettings settings;
    settings.setValue("elementsElementWidget/hostFilterValue", "b");

    auto *group = show<ElementsElementWidget>();
    type(group, 1, QStringLiteral("^[ab]"));
    QVERIFY(group->elementTreeView()->header()->isSortIndicatorShown());
    group->elementTreeView()->sortByColumn(1, Qt::DescendingOrder);
    delete new ElementsElementWidget(QStringLiteral("user"), *module, rightsYes); // never shown
    delete group;
    QCOMPARE(settings.value("elementsElementWidget/groupFilterType").toInt(), 1);
    QCOMPARE(settings.value("elementsElementWidget/groupFilterValue").toString(), QStringLiteral("^[ab]"));
    QVERIFY(!settings.value("elementsElementWidget/groupHeaderState").toByteArray().isEmpty());
    QVERIFY(settings.allKeys().filter("elementsElementWidget/user").isEmpty());

    // A new widget of the same type finds its filter and sorting again; a
    // widget of another type has its own.
    group = show<ElementsElementWidget>();
    QCOMPARE(typeBox(group)->currentIndex(), 1);
    QCOMPARE(rows(group), QStringLiteral("alice bob"));
    QCOMPARE(group->elementTreeView()->header()->sortIndicatorSection(), 1);
    QCOMPARE(group->elementTreeView()->header()->sortIndicatorOrder(), Qt::DescendingOrder);
    auto *host = show<ElementsElementWidget>(QStringLiteral("host"));
    QCOMPARE(rows(host), QStringLiteral("bob"));
}

QTEST_MAIN(ListWidgetsTest)
#include "tst_listwidgets.moc"
