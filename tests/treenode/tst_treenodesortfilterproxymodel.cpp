#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>
#include <kvt-common/treenodesortfilterproxymodel.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QStandardItemModel>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;

class TreeNodeSortFilterProxyModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void cleanup();

    void specialFlagsFilter_data();
    void specialFlagsFilter();
    void acceptColumns();
    void textFilter_data();
    void textFilter();
    void followsLiveTree();
    void flagChangeRefilters();
    void nodeMapping();
    void mappingWithHiddenFirstColumn();
    void mappingThroughStackedProxies();
    void sourceThatIsNoTreeModel();

private:
    std::unique_ptr<TestTreeNode> root;
    std::unique_ptr<TreeNodeModel> model;
    std::vector<std::unique_ptr<QObject>> keep; // proxies and testers, destroyed first

    TestTreeNode *node(const QString &path)
    {
        return static_cast<TestTreeNode *>(TreeString::find(root.get(), path));
    }
    // "a/a1=1 b=2": special flags per node path.
    void setFlags(const QString &flags)
    {
        const QStringList items = flags.split(QLatin1Char(' '), Qt::SkipEmptyParts);
        for (const QString &item : items) {
            const QStringList parts = item.split(QLatin1Char('='));
            node(parts.at(0))->specialFlags = parts.at(1).toInt();
        }
    }
    void makeModel(const QString &tree, int columns = 2)
    {
        root.reset(TreeString::makeTree(tree));
        root->columns = columns;
        model.reset(new TreeNodeModel(root.get()));
    }
    template<typename Proxy>
    Proxy *watched(Proxy *proxy, QAbstractItemModel *source)
    {
        proxy->setSourceModel(source);
        keep.emplace_back(new Tester(proxy, Tester::FailureReportingMode::QtTest));
        keep.emplace_back(proxy);
        return proxy;
    }
};

void TreeNodeSortFilterProxyModelTest::cleanup()
{
    // Testers and proxies go before the model they watch.
    while (!keep.empty())
        keep.pop_back();
    model.reset();
    root.reset();
}

void TreeNodeSortFilterProxyModelTest::specialFlagsFilter_data()
{
    QTest::addColumn<int>("filter");
    QTest::addColumn<QString>("expected");

    // Flags: a/a1=1 b=2 c=3 c/c1=2
    QTest::newRow("0 shows everything") << 0 << "a[a1 a2] b c[c1]";
    QTest::newRow("1 hides bit 1 with its subtree") << 1 << "a[a2] b";
    QTest::newRow("2 shows only bit 2") << 2 << "b c[c1]";
    QTest::newRow("3 hides bit 1 among bit 2") << 3 << "b";
    QTest::newRow("other bits are ignored") << (4 | 8) << "a[a1 a2] b c[c1]";
}

void TreeNodeSortFilterProxyModelTest::specialFlagsFilter()
{
    QFETCH(int, filter);
    QFETCH(QString, expected);

    makeModel(QStringLiteral("a[a1 a2] b c[c1]"));
    setFlags(QStringLiteral("a/a1=1 b=2 c=3 c/c1=2"));
    auto *proxy = watched(new TreeNodeSortFilterProxyModel(filter), model.get());
    QCOMPARE(proxy->specialFlagsFilter(), filter);
    QCOMPARE(TreeString::fromModel(proxy), expected);
}

void TreeNodeSortFilterProxyModelTest::acceptColumns()
{
    makeModel(QStringLiteral("a[a1] b"), 3);
    auto *proxy = watched(new TreeNodeSortFilterProxyModel(QSet<int>{0, 2}, 0), model.get());
    QCOMPARE(proxy->columnCount(), 2);
    QCOMPARE(proxy->headerData(1, Qt::Horizontal).toString(), QStringLiteral("column 2"));
    const QModelIndex a1 = proxy->treeNodeToIndex(node("a/a1"));
    QCOMPARE(a1.sibling(a1.row(), 1).data().toString(), QStringLiteral("a1:2"));
    QCOMPARE(proxy->columnCount(a1.parent()), 2);

    // A new set rebuilds the columns in one reset; the same set again is silent.
    SignalLog log;
    log.watchModel(proxy);
    proxy->setAcceptColumns({1});
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    QCOMPARE(proxy->columnCount(), 1);
    QCOMPARE(proxy->index(1, 0).data().toString(), QStringLiteral("b:1"));
    proxy->setAcceptColumns({1});
    QVERIFY(log.entries.isEmpty());
    proxy->setAcceptColumns({});
    QCOMPARE(proxy->columnCount(), 3);
    QCOMPARE(proxy->acceptColumns(), QSet<int>());
}

void TreeNodeSortFilterProxyModelTest::textFilter_data()
{
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QList<int>>("columns");
    QTest::addColumn<int>("flagsFilter");
    QTest::addColumn<QString>("expected");

    // Every row shows "id" in column 0 and "id:n" in column n.
    const QList<int> all;
    QTest::newRow("empty pattern") << "" << all << 0 << "a[a1 a2] b c[c1]";
    QTest::newRow("invalid pattern filters nothing") << "a[" << all << 0 << "a[a1 a2] b c[c1]";
    QTest::newRow("match in column 0") << "^b" << all << 0 << "b";
    QTest::newRow("match anywhere in the text") << "2" << all << 0 << "a[a1 a2] b c[c1]";
    QTest::newRow("only the accepted columns are searched") << ":2" << QList<int>{0, 1} << 0 << "";
    QTest::newRow("second accepted column") << ":2$" << QList<int>{0, 2} << 0 << "a[a1 a2] b c[c1]";
    QTest::newRow("children of a hidden parent are not searched") << "1$" << QList<int>{0} << 0 << "";
    QTest::newRow("matching parent keeps matching children") << "^a" << all << 0 << "a[a1 a2]";
    QTest::newRow("flags still apply") << "^[ab]" << all << 1 << "a[a2]";
}

void TreeNodeSortFilterProxyModelTest::textFilter()
{
    QFETCH(QString, pattern);
    QFETCH(QList<int>, columns);
    QFETCH(int, flagsFilter);
    QFETCH(QString, expected);

    makeModel(QStringLiteral("a[a1 a2] b c[c1]"), 3);
    setFlags(QStringLiteral("a/a1=1 b=1"));
    const QSet<int> accept(columns.cbegin(), columns.cend());
    auto *proxy = watched(new FilterTreeNodeSortFilterProxyModel(accept, flagsFilter), model.get());
    proxy->setFilterRegExp(QRegExp(pattern));
    QCOMPARE(TreeString::fromModel(proxy), expected);

    // Clearing the pattern brings every row (that the flags allow) back.
    proxy->setFilterRegExp(QString());
    QCOMPARE(TreeString::fromModel(proxy),
             flagsFilter ? QStringLiteral("a[a2] c[c1]") : QStringLiteral("a[a1 a2] b c[c1]"));
}

void TreeNodeSortFilterProxyModelTest::followsLiveTree()
{
    makeModel(QStringLiteral("apple[ant axe] bee cat[arc]"));
    auto *plain = watched(new TreeNodeSortFilterProxyModel(1), model.get());
    auto *text = watched(new FilterTreeNodeSortFilterProxyModel(1), model.get());
    text->setFilterRegExp(QStringLiteral("^a"));
    auto *sorted = watched(new TreeNodeSortFilterProxyModel(0), plain);
    sorted->sort(0, Qt::DescendingOrder);

    auto check = [&](const char *all, const char *filtered, const char *descending) {
        QCOMPARE(TreeString::fromModel(plain), QLatin1String(all));
        QCOMPARE(TreeString::fromModel(text), QLatin1String(filtered));
        QCOMPARE(TreeString::fromModel(sorted), QLatin1String(descending));
    };
    check("apple[ant axe] bee cat[arc]", "apple[ant axe]", "cat[arc] bee apple[axe ant]");

    TreeString::build(node("cat"), QStringLiteral("ape[a1]"));
    root->insert(1, new TestTreeNode(QStringLiteral("ash"), root.get()));
    check("apple[ant axe] ash bee cat[arc ape[a1]]", "apple[ant axe] ash",
          "cat[arc ape[a1]] bee ash apple[axe ant]");

    node("apple")->removeAt(0, 1);
    root->removeAt(2, 5);
    check("apple[axe] ash", "apple[axe] ash", "ash apple[axe]");

    // A renamed row is filtered and sorted again.
    const QModelIndex ash = model->treeNodeToIndex(node("ash"));
    QVERIFY(model->setData(ash, QStringLiteral("zoo"), Qt::EditRole));
    check("apple[axe] zoo", "apple[axe]", "zoo apple[axe]");

    // A whole reload is one reset for every proxy.
    SignalLog log;
    log.watchModel(text);
    model->nodesAboutToBeReset();
    root->clear();
    TreeString::build(root.get(), QStringLiteral("x[ay] ab"));
    model->nodesReset();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    check("x[ay] ab", "ab", "x[ay] ab");
}

void TreeNodeSortFilterProxyModelTest::flagChangeRefilters()
{
    makeModel(QStringLiteral("a[a1] b"));
    auto *proxy = watched(new TreeNodeSortFilterProxyModel(1), model.get());
    node("a")->specialFlags = 1;
    node("a")->emitNodeDataChanged();
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("b"));
    node("a")->specialFlags = 0;
    root->emitNodeChildsDataChanged();
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("a[a1] b"));
}

void TreeNodeSortFilterProxyModelTest::nodeMapping()
{
    makeModel(QStringLiteral("a[a1 a2[x]] b c"));
    setFlags(QStringLiteral("b=1"));
    auto *proxy = watched(new TreeNodeSortFilterProxyModel(1), model.get());
    proxy->sort(0, Qt::DescendingOrder);

    QCOMPARE(proxy->rootNode(), root.get());
    for (const char *path : {"a", "a/a1", "a/a2", "a/a2/x", "c"}) {
        TreeNode *n = node(QLatin1String(path));
        const QModelIndex index = proxy->treeNodeToIndex(n);
        QVERIFY2(index.isValid(), path);
        QCOMPARE(index.model(), proxy);
        QCOMPARE(proxy->toTreeNode(index), n);
        // Every column of the row names the same node.
        QCOMPARE(proxy->toTreeNode(index.sibling(index.row(), 1)), n);
    }
    QCOMPARE(proxy->treeNodeToIndex(node("c")).row(), 0);
    QVERIFY(!proxy->treeNodeToIndex(node("b")).isValid()); // hidden
    QVERIFY(!proxy->treeNodeToIndex(nullptr).isValid());
    QVERIFY(!proxy->treeNodeToIndex(root.get()).isValid());
    TestTreeNode outsider(QStringLiteral("outsider"));
    QVERIFY(!proxy->treeNodeToIndex(&outsider).isValid());

    QCOMPARE(proxy->toTreeNode(QModelIndex()), root.get());
    QVERIFY(!proxy->toTreeNode(model->treeNodeToIndex(node("a")))); // not our index

    const QModelIndex c = proxy->treeNodeToIndex(node("c"));
    const QModelIndex a1 = proxy->treeNodeToIndex(node("a/a1"));
    QItemSelection selection;
    selection.select(c.sibling(c.row(), 1), c.sibling(c.row(), 1));
    selection.select(a1, a1);
    QCOMPARE(proxy->toTreeNode(selection.first()), node("c"));
    QCOMPARE(proxy->toTreeNode(selection), node("c"));
    QItemSelection foreign;
    foreign.select(model->index(0, 0), model->index(0, 0));
    QVERIFY(!proxy->toTreeNode(foreign));
    foreign.select(a1, a1);
    QCOMPARE(proxy->toTreeNode(foreign), node("a/a1"));
}

void TreeNodeSortFilterProxyModelTest::mappingWithHiddenFirstColumn()
{
    makeModel(QStringLiteral("a b"), 3);
    auto *proxy = watched(new TreeNodeSortFilterProxyModel(QSet<int>{2}, 0), model.get());
    const QModelIndex b = proxy->treeNodeToIndex(node("b"));
    QVERIFY(b.isValid());
    QCOMPARE(b.data().toString(), QStringLiteral("b:2"));
    QCOMPARE(proxy->toTreeNode(b), node("b"));
}

void TreeNodeSortFilterProxyModelTest::mappingThroughStackedProxies()
{
    makeModel(QStringLiteral("a[a1 a2] b[b1]"));
    auto *inner = watched(new FilterTreeNodeSortFilterProxyModel(0), model.get());
    inner->setFilterRegExp(QStringLiteral("^(a|a2|b)$"));
    auto *outer = watched(new TreeNodeSortFilterProxyModel(0), inner);
    QCOMPARE(TreeString::fromModel(outer), QStringLiteral("a[a2] b"));
    QCOMPARE(outer->rootNode(), root.get());
    const QModelIndex a2 = outer->treeNodeToIndex(node("a/a2"));
    QCOMPARE(a2.model(), outer);
    QCOMPARE(a2.row(), 0);
    QCOMPARE(outer->toTreeNode(a2), node("a/a2"));
    QVERIFY(!outer->treeNodeToIndex(node("a/a1")).isValid());
}

void TreeNodeSortFilterProxyModelTest::sourceThatIsNoTreeModel()
{
    TreeNodeSortFilterProxyModel empty(1);
    QVERIFY(!empty.rootNode());
    QVERIFY(!empty.toTreeNode(QModelIndex()));
    TestTreeNode loose(QStringLiteral("loose"));
    QVERIFY(!empty.treeNodeToIndex(&loose).isValid());

    // Any other model is shown whole, and nothing maps to nodes.
    QStandardItemModel items;
    items.appendRow(new QStandardItem(QStringLiteral("one")));
    items.appendRow(new QStandardItem(QStringLiteral("two")));
    items.item(0)->appendRow(new QStandardItem(QStringLiteral("three")));
    auto *proxy = watched(new FilterTreeNodeSortFilterProxyModel(3), &items);
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("one[three] two"));
    proxy->setFilterRegExp(QStringLiteral("w"));
    QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("two"));
    QVERIFY(!proxy->toTreeNode(proxy->index(0, 0)));
    QVERIFY(!proxy->rootNode());
    keep.clear(); // before the items go
}

QTEST_GUILESS_MAIN(TreeNodeSortFilterProxyModelTest)
#include "tst_treenodesortfilterproxymodel.moc"
