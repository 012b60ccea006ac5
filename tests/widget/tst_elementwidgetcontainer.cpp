// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/elementmodel.h>
#include <kvt-common/elementwidgetcontainer2.h>

#include "editwidget.h"
#include "elementtreestring.h"
#include "screenshot.h"

#include <QtTest>
#include <QtWidgets>

#include <memory>

namespace {

// A widget standing for the supplement elements of one type.
struct SupplementWidget : ElementWidget {
    SupplementWidget(Module &module, const QString &type, const QString &supplementType, int priority)
        : ElementWidget(module, rightsYes)
    {
        _elementType = type;
        _supplementElementWidgetType = supplementType;
        _priority = priority;
    }
    QString toolTipText() const override { return windowTitle(); }
};

QString nameOf(const Element *element) { return element ? element->title() : QStringLiteral("null"); }
// "Title(element)", starred when it is the widget on display.
QString describe(const QString &title, QWidget *w, ElementWidget *current)
{
    return title + '(' + nameOf(static_cast<ElementWidget *>(w)->element()) + ')' + (w == current ? "*" : "");
}

} // namespace

class ElementWidgetContainerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordingModule> module;
    std::unique_ptr<ListedRoot> root;
    std::unique_ptr<ElementModel> model;
    ElementWidgetContainer2 *container = nullptr;
    QStringList log;

    void select(const QString &name, ElementWidgetRole role = EditElementRole)
    {
        const QModelIndex index = name.isEmpty() ? QModelIndex() : model->treeNodeToIndex(ElementTreeString::find(root.get(), name));
        container->setCurrentElementWidget(QItemSelection(index, index), role); // none for an invalid index
    }
    QTabWidget *tabs() const { return container->findChild<QTabWidget *>("_tabWidget"); }
    // "empty", "single[Title(element)]" or "tabs[Title(element) ...]" with
    // the widget on display starred, then the caption.
    QString shown() const
    {
        QStringList widgets;
        ElementWidget *current = container->currentElementWidget();
        const int page = container->findChild<QStackedWidget *>("_stackedWidget")->currentIndex();
        for (int i = 0; page == 1 && i < tabs()->count(); ++i)
            widgets.append(describe(tabs()->tabText(i), tabs()->widget(i), current));
        if (page == 2)
            widgets.append(describe(current->windowTitle(), current, current));
        const QString caption = container->findChild<QLineEdit *>("_captionLineEdit")->text();
        const QString form = page == 0 ? "empty%1" : page == 1 ? "tabs[%1]" : "single[%1]";
        return form.arg(widgets.join(' ')) + (caption.isEmpty() ? QString() : " caption=" + caption);
    }

private Q_SLOTS:
    void init()
    {
        module.reset(new RecordingModule(QStringLiteral("users")));
        root.reset(new ListedRoot(3));
        ElementTreeString::build(*module, root.get(),
                                 "staff:group[alice s1:extra s2:note s3:other] lone:solo[t1:extra t2:note t4:memo] bob ~plain");
        model.reset(new ElementModel(root.get()));
        auto keep = [this](auto *widget, const char *title) { widget->setWindowTitle(QLatin1String(title)); module->insertElementWidget(widget); };
        keep(new EditWidget(*module, rightsYes, "group"), "Group");
        keep(new EditWidget(*module, rightsYes, "user"), "User");
        keep(new SupplementWidget(*module, "extra", "group", 800), "Extra");
        keep(new SupplementWidget(*module, "note", ContextOperation::allElementType, 100), "Note");
        keep(new SupplementWidget(*module, "memo", ContextOperation::allElementType, 300), "Memo");
        keep(new SupplementWidget(*module, "other", "host", 50), "Other");
        container = new ElementWidgetContainer2;
        container->resize(480, 320);
        container->show();
        QVERIFY(QTest::qWaitForWindowExposed(container));
        connect(container, &ElementWidgetContainer2::elementContextOperationChanged, this,
                [this](Element *e) { log.append("context(" + nameOf(e) + ')'); });
        connect(container, &ElementWidgetContainer2::elementWidgetChanged, this,
                [this](ElementWidget *w) { log.append("widget(" + (w ? w->windowTitle() : "null") + ')'); });
        connect(root.get(), &TreeNode::setCurrentNode, this,
                [this](TreeNode *n) { log.append("current(" + nameOf(qobject_cast<Element *>(n)) + ')'); });
    }
    void cleanup()
    {
        delete container;
        model.reset();
        module.reset(); // with the widgets, before the elements they point at
        root.reset();
    }

    void selecting_data()
    {
        QTest::addColumn<QString>("before");
        QTest::addColumn<QString>("name");
        QTest::addColumn<int>("role");
        QTest::addColumn<QString>("expected");
        QTest::addColumn<QStringList>("signals");
        const QStringList cleared{"context(null)", "widget(null)"};
        const QString staffTabs("tabs[Note(s2) Group(staff)* Extra(s1)] caption=staff");

        // The element's own widget and the supplements of its type or of any
        // type, by priority; "other" stands for another type, alice is no supplement.
        QTest::newRow("own widget and supplements") << "" << "staff" << 1 << staffTabs
                                                    << QStringList{"context(staff)", "widget(Group)"};
        QTest::newRow("supplement: its parent's set") << "bob" << "s1" << 1 << staffTabs
                                                      << cleared + QStringList{"context(staff)", "widget(Group)"};
        QTest::newRow("no own widget: supplements of any type")
            << "" << "lone" << 1 << "tabs[Note(t2)* Memo(t4)] caption=lone" << QStringList{"context(t2)", "widget(Note)"};
        QTest::newRow("single widget") << "staff" << "bob" << 1 << "single[User(bob)*] caption=bob"
                                       << cleared + QStringList{"context(bob)", "widget(User)"};
        QTest::newRow("create") << "staff" << "bob" << 2 << "single[User(null)*]" << cleared + QStringList{"widget(User)"};
        QTest::newRow("empty selection") << "staff" << "" << 1 << "empty" << cleared;
    }
    void selecting()
    {
        QFETCH(QString, before);
        QFETCH(QString, name);
        QFETCH(int, role);
        if (!before.isEmpty())
            select(before);
        log.clear();
        select(name, ElementWidgetRole(role));
        QTEST(shown(), "expected");
        QTEST(log, "signals");
        QCOMPARE(static_cast<EditWidget *>(module->elementWidget("user"))->hooks.contains("beforeCreation"), role == 2);
    }

    void tabsAndHandingBack()
    {
        select("staff");
        log.clear();
        QTabBar *bar = tabs()->tabBar();
        QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(2).center());
        QCOMPARE(log, (QStringList{"current(s1)", "context(s1)", "widget(Extra)"}));
        QVERIFY(keepScreenshot(container, QStringLiteral("elementwidgetcontainer2")));
        // Tabs other than the current one are locked, e.g. while changes wait.
        container->enableTabChange(false);
        QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(0).center());
        QCOMPARE(container->currentElementWidget()->windowTitle(), QStringLiteral("Extra"));

        // Selecting another element hands the widgets back to the module.
        select("bob");
        for (const char *type : {"group", "extra", "note"}) {
            ElementWidget *widget = module->elementWidget(type);
            QVERIFY2(widget && !widget->parent() && !widget->element() && widget->role() == NoElementRole, type);
        }
    }

    void deletedElementIsLetGo()
    {
        // An element deleted while its widget is shown (as a delete task does
        // outside force-reread mode, its parent staying on display with tabs):
        // the widget lets go of it, and neither the tab nor the caption
        // reaches it again.
        select("staff");
        Element *s1 = qobject_cast<Element *>(ElementTreeString::find(root.get(), "s1"));
        s1->parentNode()->removeOne(s1);
        delete s1;
        QVERIFY(!module->elementWidget("extra")->element());
        log.clear();
        QTabBar *bar = tabs()->tabBar();
        QTest::mouseClick(bar, Qt::LeftButton, {}, bar->tabRect(2).center());
        QCOMPARE(log, QStringList());
        QCOMPARE(shown(), QStringLiteral("tabs[Note(s2) Group(staff) Extra(null)*] caption=staff"));

        // The element behind a single widget and its caption.
        select("bob");
        delete ElementTreeString::find(root.get(), "bob");
        QVERIFY(!module->elementWidget("user")->element());
        container->updateCaption();
        QCOMPARE(shown(), QStringLiteral("single[User(null)*]"));
    }
};

QTEST_MAIN(ElementWidgetContainerTest)
#include "tst_elementwidgetcontainer.moc"
