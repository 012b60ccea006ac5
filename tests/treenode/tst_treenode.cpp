#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>
#include <kvt-common/treenode.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QPointer>
#include <QtTest>

#include <memory>

class TreeNodeTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void defaults();
    void insertClamps_data();
    void insertClamps();
    void removeAtClamps_data();
    void removeAtClamps();
    void insertMovesAttachedNode();
    void forwardingReachesRootAndEndsAfterRemoval();
    void rowFollowsInsertionsAndRemovals();
    void clearDeleteVariants();
    void destructionDetaches();
    void allChildNodesIsOneLevelDeep();
    void loadTreeFromList_data();
    void loadTreeFromList();
    void loadTreeFromListAfterLoadOrderAndReload();
    void confNodes();
};

void TreeNodeTest::defaults()
{
    TreeNode plain;
    QCOMPARE(plain.expectedDepth(), -1);
    QCOMPARE(int(plain.flags(0)), int(Qt::ItemIsSelectable | Qt::ItemIsEnabled));
    // The id roles answer whatever the column; other roles answer nothing.
    TreeNode expecting(3, QStringLiteral("parent"));
    expecting.setId(QStringLiteral("me"));
    QCOMPARE(expecting.data(5, Qt::UserRole + 2).toString(), QStringLiteral("me"));
    QCOMPARE(expecting.data(0, Qt::UserRole + 3).toString(), QStringLiteral("parent"));
    QVERIFY(!expecting.data(0, Qt::DisplayRole).isValid());
}

void TreeNodeTest::insertClamps_data()
{
    QTest::addColumn<QString>("tree");
    QTest::addColumn<int>("position");
    QTest::addColumn<int>("count");
    QTest::addColumn<QString>("expectedTree");
    QTest::addColumn<QStringList>("expectedSignals");

    QTest::newRow("empty list") << "a b" << 1 << 0 << "a b" << QStringList();
    QTest::newRow("negative") << "a b" << -5 << 1 << "n0 a b"
                              << QStringList{"nodesAboutToBeInserted(root, 0, 0)", "nodesInserted"};
    QTest::newRow("past the end") << "a b" << 99 << 1 << "a b n0"
                                  << QStringList{"nodesAboutToBeInserted(root, 2, 2)", "nodesInserted"};
    QTest::newRow("middle, several") << "a b" << 1 << 3 << "a n0 n1 n2 b"
                                     << QStringList{"nodesAboutToBeInserted(root, 1, 3)", "nodesInserted"};
    QTest::newRow("into empty") << "" << 4 << 2 << "n0 n1"
                                << QStringList{"nodesAboutToBeInserted(root, 0, 1)", "nodesInserted"};
}

void TreeNodeTest::insertClamps()
{
    QFETCH(QString, tree);
    QFETCH(int, position);
    QFETCH(int, count);
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(tree));
    QList<TreeNode *> nodes;
    for (int i = 0; i < count; ++i)
        nodes.append(new TestTreeNode(QStringLiteral("n%1").arg(i), root.get()));

    SignalLog log;
    log.watchNode(root.get());
    root->insert(position, nodes);

    QTEST(TreeString::fromTree(root.get()), "expectedTree");
    QTEST(log.entries, "expectedSignals");
    for (TreeNode *node : nodes)
        QCOMPARE(node->parentNode(), root.get());
}

void TreeNodeTest::removeAtClamps_data()
{
    QTest::addColumn<int>("position");
    QTest::addColumn<int>("count");
    QTest::addColumn<QString>("expectedTree");
    QTest::addColumn<QStringList>("expectedSignals");

    const QStringList none;
    QTest::newRow("count past the end") << 1 << 10 << "a"
                                        << QStringList{"nodesAboutToBeRemoved(root, 1, 2)", "nodesRemoved"};
    QTest::newRow("position at the end") << 3 << 1 << "a b c" << none;
    QTest::newRow("negative position") << -1 << 2 << "a b c" << none;
    QTest::newRow("zero count") << 0 << 0 << "a b c" << none;
    QTest::newRow("exact") << 0 << 2 << "c"
                           << QStringList{"nodesAboutToBeRemoved(root, 0, 1)", "nodesRemoved"};
}

void TreeNodeTest::removeAtClamps()
{
    QFETCH(int, position);
    QFETCH(int, count);
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QStringLiteral("a b c")));
    const QList<TreeNode *> before = root->childNodes();

    SignalLog log;
    log.watchNode(root.get());
    root->removeAt(position, count);

    QTEST(TreeString::fromTree(root.get()), "expectedTree");
    QTEST(log.entries, "expectedSignals");
    // Removed children are detached, not destroyed.
    for (TreeNode *node : before)
        QCOMPARE(node->parentNode(), root->contains(node) ? root.get() : nullptr);

    TreeNode empty;
    SignalLog emptyLog;
    emptyLog.watchNode(&empty);
    empty.removeAt(0, 1);
    QVERIFY(emptyLog.entries.isEmpty());
}

void TreeNodeTest::insertMovesAttachedNode()
{
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QStringLiteral("a[x y] b")));
    TreeNode *a = TreeString::find(root.get(), QStringLiteral("a"));
    TreeNode *b = TreeString::find(root.get(), QStringLiteral("b"));
    TreeNode *x = TreeString::find(root.get(), QStringLiteral("a/x"));

    SignalLog log;
    log.watchNode(root.get());
    b->append(x);
    QCOMPARE(TreeString::fromTree(root.get()), QStringLiteral("a[y] b[x]"));
    QCOMPARE(log.take(), (QStringList{"nodesAboutToBeRemoved(a, 0, 0)", "nodesRemoved",
                                      "nodesAboutToBeInserted(b, 0, 0)", "nodesInserted"}));

    // The old parent no longer relays the moved node's signals.
    SignalLog aLog;
    aLog.watchNode(a);
    x->emitNodeDataChanged();
    QVERIFY(aLog.entries.isEmpty());
    QCOMPARE(log.take(), QStringList{"nodeDataChanged(x)"});

    // Null pointers and duplicates in one call are ignored.
    auto *z = new TestTreeNode(QStringLiteral("z"), root.get());
    b->insert(0, QList<TreeNode *>{z, nullptr, z});
    QCOMPARE(TreeString::fromTree(root.get()), QStringLiteral("a[y] b[z x]"));
}

void TreeNodeTest::forwardingReachesRootAndEndsAfterRemoval()
{
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QStringLiteral("a[b[c]]")));
    TreeNode *a = TreeString::find(root.get(), QStringLiteral("a"));
    TreeNode *b = TreeString::find(root.get(), QStringLiteral("a/b"));
    TreeNode *c = TreeString::find(root.get(), QStringLiteral("a/b/c"));

    SignalLog log;
    log.watchNode(root.get());
    c->emitNodeDataChanged();
    b->emitNodeChildsDataChanged();
    c->emitSetCurrentNode();
    c->emitExpandCurrentNode();
    c->append(new TestTreeNode(QStringLiteral("d"), root.get()));
    b->removeAt(0, 1);
    QCOMPARE(log.take(), (QStringList{"nodeDataChanged(c)", "nodeChildsDataChanged(b)",
                                      "setCurrentNode(c)", "expandCurrentNode(c)",
                                      "nodesAboutToBeInserted(c, 0, 0)", "nodesInserted",
                                      "nodesAboutToBeRemoved(b, 0, 0)", "nodesRemoved"}));

    // c is detached: whatever happens below it stays there.
    c->emitNodeDataChanged();
    c->clear();
    QVERIFY(log.entries.isEmpty());

    // Re-attached, it is heard again, once.
    a->append(c);
    log.take();
    c->emitNodeDataChanged();
    QCOMPARE(log.take(), QStringList{"nodeDataChanged(c)"});
}

void TreeNodeTest::rowFollowsInsertionsAndRemovals()
{
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QString()));
    QList<TreeNode *> nodes;
    for (int i = 0; i < 50; ++i)
        nodes.append(new TestTreeNode(QString::number(i), root.get()));
    root->append(nodes);
    QVERIFY(root->removeOne(nodes.at(40)));
    QVERIFY(!root->removeOne(nodes.at(40)));
    QCOMPARE(nodes.at(40)->row(), -1);

    // Many nodes coming and going, hints remembered and forgotten in between:
    // every row must still be exact.
    std::unique_ptr<TestTreeNode> big(TreeString::makeTree(QString()));
    QList<TreeNode *> many;
    for (int i = 0; i < 3000; ++i)
        many.append(new TestTreeNode(QString::number(i)));
    big->append(many);
    for (int i = 0; i < many.size(); i += 3)
        delete many.at(i);
    for (int i = 0; i < 200; ++i)
        big->insert(i * 7, new TestTreeNode(QStringLiteral("x%1").arg(i), big.get()));
    for (int i = big->childNodesCount() - 1; i >= 0; i -= 5)
        QCOMPARE(big->childNodes().at(i)->row(), i);
    for (int i = 0; i < big->childNodesCount(); ++i)
        QCOMPARE(big->childNodes().at(i)->row(), i);
    for (int i = 0; i < many.size(); ++i) {
        if (i % 3)
            delete many.at(i);
    }
}

void TreeNodeTest::clearDeleteVariants()
{
    int destroyed = 0;
    auto make = [&destroyed](const QString &tree) {
        auto *root = TreeString::makeTree(tree);
        for (QObject *child : root->children()) {
            if (auto *node = qobject_cast<TestTreeNode *>(child))
                node->destructionCount = &destroyed;
        }
        return root;
    };

    // clearDelete destroys the direct children only; their children are
    // detached by the dying parent and survive.
    std::unique_ptr<TestTreeNode> root(make(QStringLiteral("a[a1 a2] b")));
    TreeNode *a1 = TreeString::find(root.get(), QStringLiteral("a/a1"));
    root->clearDelete();
    QCOMPARE(destroyed, 2);
    QCOMPARE(root->childNodesCount(), 0);
    QVERIFY(!a1->parentNode());

    destroyed = 0;
    std::unique_ptr<TestTreeNode> full(make(QStringLiteral("a[a1[x] a2] b")));
    SignalLog log;
    log.watchNode(full.get());
    full->clearDeleteAll();
    QCOMPARE(destroyed, 5);
    QCOMPARE(full->childNodesCount(), 0);
    QCOMPARE(log.entries.first(), QStringLiteral("nodesAboutToBeRemoved(root, 0, 1)"));
}

void TreeNodeTest::destructionDetaches()
{
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QStringLiteral("a[x y] b")));
    TreeNode *a = TreeString::find(root.get(), QStringLiteral("a"));
    TreeNode *x = TreeString::find(root.get(), QStringLiteral("a/x"));
    TreeNode *y = TreeString::find(root.get(), QStringLiteral("a/y"));

    SignalLog log;
    log.watchNode(root.get());
    delete a;
    QCOMPARE(log.take(), (QStringList{"nodesAboutToBeRemoved(root, 0, 0)", "nodesRemoved"}));
    QCOMPARE(TreeString::fromTree(root.get()), QStringLiteral("b"));
    QVERIFY(!x->parentNode());
    QVERIFY(!y->parentNode());

    // A configuration root owns and destroys its whole subtree.
    auto *confRoot = new ConfRootTreeNode;
    QPointer<ConfTreeNode> port = new ConfTreeNode(QStringLiteral("port"), QStringLiteral("1"));
    QPointer<ConfTreeNode> deep = new ConfTreeNode(QStringLiteral("deep"), QStringLiteral("2"));
    confRoot->append(port);
    port->append(deep);
    delete confRoot;
    QVERIFY(port.isNull());
    QVERIFY(deep.isNull());
}

void TreeNodeTest::allChildNodesIsOneLevelDeep()
{
    std::unique_ptr<TestTreeNode> root(TreeString::makeTree(QStringLiteral("a[a1[deep] a2] b[b1]")));
    QStringList ids;
    for (TreeNode *node : root->allChildNodes())
        ids.append(node->id());
    QCOMPARE(ids, (QStringList{"a", "b", "a1", "a2", "b1"}));
}

void TreeNodeTest::loadTreeFromList_data()
{
    // Each node: "id:depth:parent"; root depth given separately.
    QTest::addColumn<int>("rootDepth");
    QTest::addColumn<QStringList>("nodes");
    QTest::addColumn<QString>("expectedTree");
    QTest::addColumn<QStringList>("expectedAfterLoad");

    QTest::newRow("two levels, sorted by id")
        << 0 << QStringList{"m2:1:", "c:2:m2", "m1:1:"} << "m1 m2[c]" << QStringList{"m1", "m2", "c"};
    QTest::newRow("same depth as root never attached")
        << 0 << QStringList{"a:0:", "b:1:"} << "b" << QStringList{"b"};
    QTest::newRow("skipped level stays detached")
        << 0 << QStringList{"a:1:", "deep:3:a"} << "a" << QStringList{"a"};
    QTest::newRow("parent two levels up is not matched")
        << 0 << QStringList{"a:1:", "b:2:a", "c:3:a"} << "a[b]" << QStringList{"a", "b"};
    QTest::newRow("unknown parent id")
        << 0 << QStringList{"a:1:", "b:2:nobody"} << "a" << QStringList{"a"};
    QTest::newRow("candidate need not be attached")
        << 0 << QStringList{"orphan:1:x", "kid:2:orphan"} << "" << QStringList{"kid"};
    QTest::newRow("first of two equal ids wins")
        << 0 << QStringList{"p:1:", "p:1:", "k:2:p"} << "p[k] p" << QStringList{"p", "p", "k"};
    // Levels are matched only against the level just before them in the
    // sorted list: b (depth 1) comes between the root (depth 2) and a, so a
    // finds no parent, while c still hangs under the detached a.
    QTest::newRow("shallower node shadows the root")
        << 2 << QStringList{"a:3:", "b:1:", "c:4:a"} << "" << QStringList{"c"};
    QTest::newRow("root deeper than zero")
        << 2 << QStringList{"a:3:", "c:4:a"} << "a[c]" << QStringList{"a", "c"};
}

void TreeNodeTest::loadTreeFromList()
{
    QFETCH(int, rootDepth);
    QFETCH(QStringList, nodes);

    TestTreeNode root(QString(), rootDepth, QString());
    QStringList afterLoad;
    QList<TreeNode *> list;
    QList<TreeNode *> owned;
    for (const QString &entry : nodes) {
        const QStringList f = entry.split(QLatin1Char(':'));
        auto *node = new TestTreeNode(f.at(0), f.at(1).toInt(), f.at(2), &root);
        node->afterLoadLog = &afterLoad;
        list.append(node);
    }
    root.loadTreeFromList(list);

    QTEST(TreeString::fromTree(&root), "expectedTree");
    QTEST(afterLoad, "expectedAfterLoad");
}

void TreeNodeTest::loadTreeFromListAfterLoadOrderAndReload()
{
    TestTreeNode root(QString(), 0, QString());
    QStringList afterLoad;
    auto make = [&](const QString &id, int depth, const QString &parent) {
        auto *n = new TestTreeNode(id, depth, parent, &root);
        n->afterLoadLog = &afterLoad;
        return n;
    };
    QList<TreeNode *> list{make("b", 1, ""), make("x", 2, "b"), make("a", 1, "")};
    auto *stale = make("stale", 1, "");
    root.append(stale);

    SignalLog log;
    log.watchNode(&root);
    root.loadTreeFromList(list);
    QCOMPARE(TreeString::fromTree(&root), QStringLiteral("a b[x]"));
    QCOMPARE(afterLoad, (QStringList{"a", "b", "x"}));
    QVERIFY(!stale->parentNode());
    QCOMPARE(log.entries.first(), QStringLiteral("nodesAboutToBeRemoved(, 0, 0)"));

    // Loading the same nodes again gives the same tree, each node once.
    afterLoad.clear();
    root.loadTreeFromList(list);
    QCOMPARE(TreeString::fromTree(&root), QStringLiteral("a b[x]"));
    QCOMPARE(afterLoad, (QStringList{"a", "b", "x"}));
}

void TreeNodeTest::confNodes()
{
    ConfTreeNode node(QStringLiteral("port"), QStringLiteral("5432"));
    QCOMPARE(node.id(), QStringLiteral("Conf_port_5432"));
    QCOMPARE(node.expectedDepth(), 1);
    QVERIFY(node.expectedParentId().isEmpty());
    QCOMPARE(node.data(0, Qt::DisplayRole).toString(), QStringLiteral("port"));
    QCOMPARE(node.data(1, Qt::ToolTipRole).toString(), QStringLiteral("5432"));
    QVERIFY(!node.data(2, Qt::DisplayRole).isValid());
    QVERIFY(!node.data(0, Qt::UserRole + 2).isValid());
    QVERIFY(!node.data(0, Qt::EditRole).isValid());

    ConfRootTreeNode root;
    QCOMPARE(root.expectedDepth(), 0);
    QCOMPARE(root.columnCount(), 2);
    QCOMPARE(root.headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("Name"));
    QCOMPARE(root.headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("Value"));
    QVERIFY(!root.headerData(2, Qt::Horizontal, Qt::DisplayRole).isValid());
    QVERIFY(!root.headerData(0, Qt::Vertical, Qt::DisplayRole).isValid());
}

QTEST_GUILESS_MAIN(TreeNodeTest)
#include "tst_treenode.moc"
