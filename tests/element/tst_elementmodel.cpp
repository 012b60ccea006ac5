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
    void toElementOfSelections();
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
    ListedElement *element(const QString &name) { return dynamic_cast<ListedElement *>(node(name)); }

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
    // Testers and proxies go before the model they watch, the tree after it.
    while (!keep.empty())
        keep.pop_back();
    model.reset();
    root.reset();
    module.reset();
}

void ElementModelTest::toElement_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<QStringList>("elements"); // the rows that map to elements

    QTest::newRow("element model") << "model" << QStringList{"staff", "alice", "bob", "carl"};
    QTest::newRow("element proxy") << "proxy" << QStringList{"staff", "alice", "bob", "carl"};
    QTest::newRow("group proxy over element proxy")
        << "group over proxy" << QStringList{"staff", "alice", "bob", "carl"};
    QTest::newRow("selectable proxy") << "selectable" << QStringList{"staff", "bob", "carl"};
}

void ElementModelTest::toElement()
{
    QFETCH(QString, kind);
    QFETCH(QStringList, elements);

    makeModel(QStringLiteral("staff#2[alice bob#2 ~note#2] carl#2"), 3);
    QAbstractItemModel *shown = stacked(kind);
    // Views find the extension by a cast from the model they hold.
    auto *extension = dynamic_cast<ElementModelExtension *>(shown);
    QVERIFY(extension);
    QCOMPARE(extension->rootNode(), static_cast<TreeNode *>(root.get()));

    for (const QString &name : elements) {
        const QModelIndex index = extension->treeNodeToIndex(node(name));
        QVERIFY2(index.isValid(), qPrintable(name));
        QCOMPARE(extension->toElement(index), static_cast<Element *>(element(name)));
        // Any column of the row names the same element.
        QCOMPARE(extension->toElement(index.sibling(index.row(), 2)), static_cast<Element *>(element(name)));
    }
    // A node of the tree that is no element, the root (invalid index) and
    // an index of another model give no element.
    const QModelIndex note = extension->treeNodeToIndex(node("note"));
    QVERIFY(note.isValid());
    QCOMPARE(extension->toTreeNode(note), node("note"));
    QVERIFY(!extension->toElement(note));
    QCOMPARE(extension->toTreeNode(QModelIndex()), static_cast<TreeNode *>(root.get()));
    QVERIFY(!extension->toElement(QModelIndex()));
    QStandardItemModel other(3, 3);
    QVERIFY(!extension->toElement(other.index(0, 0)));
    if (shown != model.get())
        QVERIFY(!extension->toElement(model->treeNodeToIndex(node("carl"))));
}

void ElementModelTest::toElementOfSelections()
{
    makeModel(QStringLiteral("~note staff[alice bob] carl"), 2);
    auto *proxy = watched(new ElementSortFilterProxyModel(0), model.get());
    auto index = [&](const char *name) { return proxy->treeNodeToIndex(node(QLatin1String(name))); };
    const QModelIndex note = index("note");
    const QModelIndex carl = index("carl");
    const QModelIndex bob = index("bob");

    // A range from column 1 of carl still names carl.
    QCOMPARE(proxy->toElement(QItemSelectionRange(carl.sibling(carl.row(), 1))),
             static_cast<Element *>(element("carl")));
    // The first range that maps to a node decides: a plain node first gives
    // no element although an element follows.
    QItemSelection noteFirst;
    noteFirst.select(note, note);
    noteFirst.select(bob, bob);
    QVERIFY(!proxy->toElement(noteFirst));
    QItemSelection elementFirst;
    elementFirst.select(bob, bob.sibling(bob.row(), 1));
    elementFirst.select(note, note);
    QCOMPARE(proxy->toElement(elementFirst), static_cast<Element *>(element("bob")));
    // Ranges of another model are passed over.
    QStandardItemModel other(2, 2);
    QItemSelection mixed;
    mixed.select(other.index(0, 0), other.index(1, 1));
    mixed.select(carl, carl);
    QCOMPARE(proxy->toElement(mixed), static_cast<Element *>(element("carl")));
    QVERIFY(!proxy->toElement(QItemSelection()));
    QVERIFY(!model->toElement(QItemSelectionRange(other.index(0, 0))));
}

void ElementModelTest::groupFilter_data()
{
    QTest::addColumn<QString>("group");
    QTest::addColumn<QString>("expected");

    // staff declares users, bob declares admins; alice, x and the plain node
    // declare nothing; s is hidden by its flags in every case.
    QTest::newRow("Undefined shows every group") << "Undefined"
                                                 << "staff[alice bob[x] note] guests[carl] dave misc[y] note";
    QTest::newRow("a group, inherited by the undefined") << "users" << "staff[alice note] note";
    QTest::newRow("a nested group below another is cut off with its parent")
        << "admins" << "guests[carl] note";
    QTest::newRow("All is an ordinary group name") << "All" << "misc[y] note";
    QTest::newRow("a group nobody has") << "nobody" << "note";
    QTest::newRow("the empty name") << "" << "note";
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
    element("guests")->setGroupType(QStringLiteral("users"));
    SignalLog log;
    log.watchModel(proxy);
    proxy->setGroupElementType(QStringLiteral("users"), false);
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice]"));
    proxy->setGroupElementType(QStringLiteral("users"), true);
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice] guests[carl]"));
    QVERIFY(!log.entries.isEmpty());

    proxy->setGroupElementType(QStringLiteral("Undefined"));
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("staff[alice] guests[carl]"));
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
    QTest::newRow("node id") << 258 << "group_staff[user_bob] user_carl" << "user_carl";
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
    QCOMPARE(proxy->specialFlagsFilter(), 2);
    QCOMPARE(proxy->columnCount(), 2);

    SignalLog log;
    log.watchModel(proxy);
    proxy->setSelectionDisplayRole(displayRole);
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(proxy->selectionDisplayRole(), displayRole);

    QCOMPARE(TreeString::fromModel(proxy), expected);
    const QModelIndex carl = proxy->treeNodeToIndex(node("carl"));
    QCOMPARE(carl.sibling(carl.row(), 1).data().toString(), carlSecondColumn);
    // Other roles are passed on unchanged.
    QCOMPARE(carl.data(260).toString(), QStringLiteral("carl"));
    QCOMPARE(carl.data(Qt::ToolTipRole).toString(), QStringLiteral("tip:carl"));
    QCOMPARE(proxy->toElement(carl), static_cast<Element *>(element("carl")));
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
    node("ops")->append(node("bob"));
    check("staff[alice abe zed] guests[carl dan[eve]] ops[al bob]",
          "ops[al bob] staff[abe alice]", "staff[abe alice]", "user[user]");

    // Renaming re-sorts and re-filters.
    element("abe")->setTitle(QStringLiteral("ted"));
    check("staff[alice ted zed] guests[carl dan[eve]] ops[al bob]",
          "ops[al bob] staff[alice ted]", "staff[alice]", "user[user]");

    // Removals.
    node("staff")->removeOne(node("alice"));
    root->removeOne(node("guests"));
    check("staff[ted zed] ops[al bob]", "ops[al bob] staff[ted]", "staff", "user[user]");

    // A whole reload is one reset for every proxy.
    SignalLog log;
    log.watchModel(users);
    model->nodesAboutToBeReset();
    root->clear();
    ElementTreeString::build(*module, root.get(), QStringLiteral("sue@users#2 tom@admins#2"));
    model->nodesReset();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    check("sue tom", "sue", "sue", "user user");

    // A new root is a reset too.
    ListedRoot other;
    ElementTreeString::build(*module, &other, QStringLiteral("amy@users"));
    model->setRootNode(&other);
    check("amy", "amy", "amy", "");
    QCOMPARE(users->toElement(users->index(0, 0)), qobject_cast<Element *>(other.childNodes().at(0)));
    model->setRootNode(root.get());
    check("sue tom", "sue", "sue", "user user");
}

QTEST_MAIN(ElementModelTest)

#include "tst_elementmodel.moc"
