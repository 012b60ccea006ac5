#include <kvt-common/elementmodel.h>
#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/groupinvisibleelementsortfilterproxymodel.h>
#include <kvt-common/selectableelementsortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>

#include "elementtreestring.h"
#include "signallog.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QStandardItemModel>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;

class ElementModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void toElement_data();
    void toElement();
    void groupFilter_data();
    void groupFilter();
    void groupFilterForce();
    void selectable_data();
    void selectable();
    void proxiesFollowLiveTree();

private:
    std::unique_ptr<RecordingModule> module;
    std::unique_ptr<ListedRoot> root;
    std::unique_ptr<ElementModel> model;
    std::vector<std::unique_ptr<QObject>> keep; // proxies and testers, destroyed first

    void makeModel(const QString &tree, int columns = 1)
    {
        root.reset(new ListedRoot(columns));
        ElementTreeString::build(*module, root.get(), tree);
        model.reset(new ElementModel(root.get()));
        keep.emplace_back(new Tester(model.get(), Tester::FailureReportingMode::QtTest));
    }
    TreeNode *node(const QString &name) { return ElementTreeString::find(root.get(), name); }
    Element *element(const QString &name) { return qobject_cast<Element *>(node(name)); }

    template <typename Proxy>
    Proxy *watched(Proxy *proxy, QAbstractItemModel *source)
    {
        proxy->setSourceModel(source);
        keep.emplace_back(new Tester(proxy, Tester::FailureReportingMode::QtTest));
        keep.emplace_back(proxy);
        return proxy;
    }
    // The models a view may hold over the same element tree.
    QAbstractItemModel *stacked(const QString &kind)
    {
        if (kind == "model")
            return model.get();
        if (kind == "proxy")
            return watched(new ElementSortFilterProxyModel(0), model.get());
        if (kind == "group over proxy") {
            auto *group = watched(new GroupInvisibleElementSortFilterProxyModel,
                                  watched(new ElementSortFilterProxyModel(0), model.get()));
            group->sort(0, Qt::DescendingOrder);
            return group;
        }
        if (kind == "selectable")
            return watched(new SelectableElementSortFilterProxyModel, model.get());
        return nullptr;
    }
};

void ElementModelTest::init()
{
    module.reset(new RecordingModule(QStringLiteral("users")));
}

void ElementModelTest::cleanup()
{
    while (!keep.empty())
        keep.pop_back();
    model.reset();
    root.reset();
    module.reset();
}

void ElementModelTest::toElement_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("element model") << "model";
    QTest::newRow("element proxy") << "proxy";
    QTest::newRow("sorted group proxy over element proxy") << "group over proxy";
    QTest::newRow("selectable proxy") << "selectable";
}

void ElementModelTest::toElement()
{
    QFETCH(QString, kind);
    makeModel(QStringLiteral("staff#2[bob#2 ~note#2] carl#2"), 3);
    // Views find the extension by a cast from the model they hold.
    auto *extension = dynamic_cast<ElementModelExtension *>(stacked(kind));
    QVERIFY(extension);
    for (const char *name : {"staff", "bob", "carl"}) {
        const QModelIndex index = extension->treeNodeToIndex(node(name));
        QCOMPARE(extension->toElement(index), element(name));
        QCOMPARE(extension->toElement(index.sibling(index.row(), 2)), element(name));
    }
    // A plain node, the root (invalid index) and indexes of other models
    // give no element.
    const QModelIndex note = extension->treeNodeToIndex(node("note"));
    QCOMPARE(extension->toTreeNode(note), node("note"));
    QVERIFY(!extension->toElement(note));
    QVERIFY(!extension->toElement(QModelIndex()));
    QStandardItemModel other(3, 3);
    QVERIFY(!extension->toElement(other.index(0, 0)));
    if (kind != "model")
        QVERIFY(!extension->toElement(model->treeNodeToIndex(node("carl"))));

    // A selection is named by its first range that maps to a node, even a
    // node that is no element; ranges of other models are passed over.
    const QModelIndex carl = extension->treeNodeToIndex(node("carl"));
    QItemSelection selection(other.index(0, 0), other.index(1, 1));
    selection.select(carl.sibling(carl.row(), 1), carl.sibling(carl.row(), 2));
    selection.select(note, note);
    QCOMPARE(extension->toElement(selection), element("carl"));
    QItemSelection noteFirst(note, note);
    noteFirst.append(selection);
    QVERIFY(!extension->toElement(noteFirst));
}

void ElementModelTest::groupFilter_data()
{
    QTest::addColumn<QString>("group");
    QTest::addColumn<QString>("expected");

    // staff declares users, bob declares admins; alice, x and the plain node
    // declare nothing; s is hidden by its flags in every case.
    QTest::newRow("Undefined shows every group")
        << "Undefined" << "staff[alice bob[x] note] guests[carl] dave misc[y] note";
    QTest::newRow("a group, inherited by the undefined") << "users" << "staff[alice note] note";
    QTest::newRow("a nested group below another is cut off with its parent")
        << "admins" << "guests[carl] note";
    QTest::newRow("All is an ordinary group name") << "All" << "misc[y] note";
    QTest::newRow("a group nobody has") << "nobody" << "note";
}

void ElementModelTest::groupFilter()
{
    QFETCH(QString, group);
    QFETCH(QString, expected);

    makeModel(QStringLiteral("staff@users[alice bob@admins[x] ~note s#1] guests@admins[carl] "
                             "dave misc@All[y] ~note s#1"));
    auto *base = watched(new ElementSortFilterProxyModel(1), model.get());
    auto *proxy = watched(new GroupInvisibleElementSortFilterProxyModel, model.get());
    QCOMPARE(proxy->groupElementType(), QStringLiteral("Undefined"));
    QCOMPARE(TreeString::fromModel(proxy), TreeString::fromModel(base));

    proxy->setGroupElementType(group);
    QCOMPARE(proxy->groupElementType(), group);
    QCOMPARE(TreeString::fromModel(proxy), expected);

    // A group proxy over any other kind of model filters nothing but the
    // flags. Over a plain tree-node model the same tree shows every row.
    TreeNodeModel plainModel(root.get());
    auto *plain = watched(new GroupInvisibleElementSortFilterProxyModel, &plainModel);
    plain->setGroupElementType(group);
    QCOMPARE(TreeString::fromModel(plain), TreeString::fromModel(base));
    keep.clear(); // before plainModel goes
}

void ElementModelTest::groupFilterForce()
{
    makeModel(QStringLiteral("staff@users[alice] guests@admins[carl]"));
    auto *proxy = watched(new GroupInvisibleElementSortFilterProxyModel, model.get());
    proxy->setGroupElementType(QStringLiteral("users"));
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice]"));

    // Groups are read when rows are filtered; a group changed without any
    // notification is seen only when the filter runs again.
    static_cast<ListedElement *>(node("guests"))->setGroupType(QStringLiteral("users"));
    SignalLog log;
    log.watchModel(proxy);
    proxy->setGroupElementType(QStringLiteral("users"), false);
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice]"));
    proxy->setGroupElementType(QStringLiteral("users"), true);
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice] guests[carl]"));
    QVERIFY(!log.entries.isEmpty());

}

void ElementModelTest::selectable_data()
{
    QTest::addColumn<int>("displayRole");
    QTest::addColumn<QString>("expected");
    QTest::addColumn<QString>("carlSecondColumn");

    // The second column shown is source column 2, whose display text is
    // "<title>:2" and which has no tool tip.
    QTest::newRow("display") << 0 << "staff[bob] carl" << "carl:2";
    QTest::newRow("title") << 260 << "staff[bob] carl" << "carl";
    QTest::newRow("element type") << 261 << "group[user] user" << "user";
    QTest::newRow("tool tip") << int(Qt::ToolTipRole) << "tip:staff[tip:bob] tip:carl" << "";
}

void ElementModelTest::selectable()
{
    QFETCH(int, displayRole);
    QFETCH(QString, expected);
    QFETCH(QString, carlSecondColumn);

    // Only the rows marked with special flag bit 2 are shown; carl is
    // marked hidden too, which this proxy does not look at.
    makeModel(QStringLiteral("staff:group#2[alice bob#2 ~note] carl#3 dave#1"), 3);
    auto *proxy = watched(new SelectableElementSortFilterProxyModel(QSet<int>{0, 2}), model.get());
    QCOMPARE(proxy->selectionDisplayRole(), 0);

    proxy->setSelectionDisplayRole(displayRole);
    QCOMPARE(TreeString::fromModel(proxy), expected);
    const QModelIndex carl = proxy->treeNodeToIndex(node("carl"));
    QCOMPARE(carl.sibling(carl.row(), 1).data().toString(), carlSecondColumn);
    QCOMPARE(carl.data(Qt::ToolTipRole).toString(), QStringLiteral("tip:carl")); // passed on
    QCOMPARE(proxy->toElement(carl), element("carl"));
}

void ElementModelTest::proxiesFollowLiveTree()
{
    makeModel(QStringLiteral("staff@users[bob alice#2] guests@admins[carl] sam#1"));
    auto *all = watched(new ElementSortFilterProxyModel(1), model.get());
    auto *users = watched(new GroupInvisibleElementSortFilterProxyModel, all);
    users->setGroupElementType(QStringLiteral("users"));
    users->sort(0);
    auto *text = watched(new FilterTreeNodeSortFilterProxyModel(0), users);
    text->setFilterRegExp(QStringLiteral("^[sa]"));
    auto *choice = watched(new SelectableElementSortFilterProxyModel, model.get());
    choice->setSelectionDisplayRole(261);

    auto check = [&](const char *allRows, const char *userRows, const char *textRows,
                     const char *choiceRows) {
        QCOMPARE(TreeString::fromModel(all), QLatin1String(allRows));
        QCOMPARE(TreeString::fromModel(users), QLatin1String(userRows));
        QCOMPARE(TreeString::fromModel(text), QLatin1String(textRows));
        QCOMPARE(TreeString::fromModel(choice), QLatin1String(choiceRows));
    };
    check("staff[bob alice] guests[carl]", "staff[alice bob]", "staff[alice]", "");

    // Insertions: under a group the new element inherits the group.
    ElementTreeString::build(*module, node("guests"), QStringLiteral("dan@users[eve]"));
    ElementTreeString::build(*module, node("staff"), QStringLiteral("abe:admin#2 zed@admins"));
    ElementTreeString::build(*module, root.get(), QStringLiteral("ops@users#2[al#2]"));
    check("staff[bob alice abe zed] guests[carl dan[eve]] ops[al]",
          "ops[al] staff[abe alice bob]", "staff[abe alice]", "user[user]");

    // A moved element takes the group of its new place.
    node("guests")->append(node("bob"));
    check("staff[alice abe zed] guests[carl dan[eve] bob] ops[al]",
          "ops[al] staff[abe alice]", "staff[abe alice]", "user[user]");

    // Renaming re-sorts and re-filters.
    element("abe")->setTitle(QStringLiteral("ted"));
    check("staff[alice ted zed] guests[carl dan[eve] bob] ops[al]",
          "ops[al] staff[alice ted]", "staff[alice]", "user[user]");

    // Removals.
    node("staff")->removeOne(node("alice"));
    root->removeOne(node("guests"));
    check("staff[ted zed] ops[al]", "ops[al] staff[ted]", "staff", "user[user]");

    // A whole reload is one reset for every proxy.
    SignalLog log;
    log.watchModel(users);
    model->nodesAboutToBeReset();
    root->clear();
    ElementTreeString::build(*module, root.get(), QStringLiteral("sue@users#2 tom@admins#2"));
    model->nodesReset();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    check("sue tom", "sue", "sue", "user user");
}

QTEST_MAIN(ElementModelTest)

#include "tst_elementmodel.moc"
