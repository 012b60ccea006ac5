// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QPointer>
#include <QtTest>

#include <memory>

using Tree = std::unique_ptr<TestTreeNode>;

class TreeNodeTest : public QObject
{
    Q_OBJECT

    static Tree tree(const QString &description) { return Tree(TreeString::makeTree(description)); }
    static TreeNode *find(const Tree &root, const char *path) { return TreeString::find(root.get(), QLatin1String(path)); }

private Q_SLOTS:
    // Insertion clamps the position into range; removal ignores a start out of
    // range and shortens a count that runs past the end. Removed children are
    // detached, not destroyed.
    void insertAndRemoveClamp_data()
    {
        QTest::addColumn<bool>("insert");
        QTest::addColumn<int>("position");
        QTest::addColumn<int>("count");
        QTest::addColumn<QString>("expectedTree");
        QTest::addColumn<QStringList>("expectedSignals");
        auto announced = [](const char *what, int first, int last) {
            return QStringList{QStringLiteral("nodesAboutToBe%1(root, %2, %3)").arg(QLatin1String(what)).arg(first).arg(last),
                               QStringLiteral("nodes%1").arg(QLatin1String(what))};
        };
        QTest::newRow("insert before the start") << true << -5 << 1 << "n0 a b c" << announced("Inserted", 0, 0);
        QTest::newRow("insert past the end") << true << 99 << 1 << "a b c n0" << announced("Inserted", 3, 3);
        QTest::newRow("insert several") << true << 1 << 3 << "a n0 n1 n2 b c" << announced("Inserted", 1, 3);
        QTest::newRow("remove past the end") << false << 1 << 10 << "a" << announced("Removed", 1, 2);
        QTest::newRow("remove at the end") << false << 3 << 1 << "a b c" << QStringList();
        QTest::newRow("remove before the start") << false << -1 << 2 << "a b c" << QStringList();
        QTest::newRow("remove exactly") << false << 0 << 2 << "c" << announced("Removed", 0, 1);
    }
    void insertAndRemoveClamp()
    {
        QFETCH(bool, insert);
        QFETCH(int, position);
        QFETCH(int, count);
        const Tree root = tree(QStringLiteral("a b c"));
        const QList<TreeNode *> nodes = root->childNodes();
        QList<TreeNode *> added;
        for (int i = 0; insert && i < count; ++i)
            added << new TestTreeNode(QStringLiteral("n%1").arg(i), root.get());
        SignalLog log;
        log.watchNode(root.get());
        if (insert)
            root->insert(position, added);
        else
            root->removeAt(position, count);
        QTEST(TreeString::fromTree(root.get()), "expectedTree");
        QTEST(log.entries, "expectedSignals");
        for (TreeNode *node : nodes + added)
            QCOMPARE(node->parentNode(), root->contains(node) ? root.get() : nullptr);
    }

    // Adding a node that has a parent moves it; the old parent no longer
    // relays its signals. Nulls and repeats within one call are skipped.
    void insertMovesAttachedNode()
    {
        const Tree root = tree(QStringLiteral("a[x y] b"));
        TreeNode *x = find(root, "a/x");
        SignalLog log, oldParentLog;
        log.watchNode(root.get());
        oldParentLog.watchNode(find(root, "a"));
        find(root, "b")->append(x);
        x->emitNodeDataChanged();
        QCOMPARE(log.entries, (QStringList{"nodesAboutToBeRemoved(a, 0, 0)", "nodesRemoved",
                                           "nodesAboutToBeInserted(b, 0, 0)", "nodesInserted", "nodeDataChanged(x)"}));
        QCOMPARE(oldParentLog.entries, (QStringList{"nodesAboutToBeRemoved(a, 0, 0)", "nodesRemoved"}));

        auto *z = new TestTreeNode(QStringLiteral("z"), root.get());
        find(root, "b")->insert(0, QList<TreeNode *>{z, nullptr, z});
        QCOMPARE(TreeString::fromTree(root.get()), QStringLiteral("a[y] b[z x]"));
    }

    // Every signal of a descendant reaches the root.
    void forwardingReachesRoot()
    {
        const Tree root = tree(QStringLiteral("a[b[c]]"));
        TreeNode *b = find(root, "a/b");
        TreeNode *c = find(root, "a/b/c");
        SignalLog log;
        log.watchNode(root.get());
        c->emitNodeDataChanged();
        b->emitNodeChildsDataChanged();
        c->emitSetCurrentNode();
        c->emitExpandCurrentNode();
        c->append(new TestTreeNode(QStringLiteral("d"), root.get()));
        b->removeAt(0, 1);
        QCOMPARE(log.take(), (QStringList{"nodeDataChanged(c)", "nodeChildsDataChanged(b)", "setCurrentNode(c)",
                                          "expandCurrentNode(c)", "nodesAboutToBeInserted(c, 0, 0)", "nodesInserted",
                                          "nodesAboutToBeRemoved(b, 0, 0)", "nodesRemoved"}));
    }

    // Rows stay exact while many nodes come and go.
    void rowFollowsInsertionsAndRemovals()
    {
        const Tree root = tree(QString());
        QList<TreeNode *> many;
        for (int i = 0; i < 3000; ++i)
            many << new TestTreeNode(QString::number(i), root.get());
        root->append(many);
        for (int i = 0; i < many.size(); i += 3)
            delete many.at(i);
        for (int i = 0; i < 200; ++i)
            root->insert(i * 7, new TestTreeNode(QStringLiteral("x%1").arg(i), root.get()));
        QVERIFY(root->removeOne(many.at(1)));
        QVERIFY(!root->removeOne(many.at(1)));
        QCOMPARE(many.at(1)->row(), -1);

        // A list holding a node twice (filled through childNodes()) loses the
        // first occurrence, wherever the node was last seen.
        const Tree twice = tree(QString());
        TreeNode *x = new TestTreeNode(QStringLiteral("x"), twice.get());
        TreeNode *a = new TestTreeNode(QStringLiteral("a"), twice.get());
        twice->append({x, a});
        twice->childNodes().prepend(a);
        QSignalSpy removal(twice.get(), &TreeNode::nodesAboutToBeRemoved);
        QVERIFY(twice->removeOne(a));
        QCOMPARE(removal.value(0).value(1).toInt(), 0);
        QCOMPARE(twice->childNodes(), (QList<TreeNode *>{x, a}));
        for (int i = root->childNodesCount() - 1; i >= 0; i -= 5)
            QCOMPARE(root->childNodes().at(i)->row(), i);
        for (int i = 0; i < root->childNodesCount(); ++i)
            QCOMPARE(root->childNodes().at(i)->row(), i);
    }

    // clearDelete destroys the direct children only (theirs survive,
    // detached); clearDeleteAll destroys the whole subtree. A destroyed node
    // leaves its parent, announced.
    void deletion()
    {
        int destroyed = 0;
        const Tree root = tree(QStringLiteral("a[a1[x] a2] b"));
        for (auto *node : root->findChildren<TestTreeNode *>())
            node->destructionCount = &destroyed;
        TreeNode *a1 = find(root, "a/a1");
        TreeNode *a2 = find(root, "a/a2");
        root->clearDelete();
        QCOMPARE(destroyed, 2);
        QVERIFY(!a1->parentNode() && !a2->parentNode());

        root->append(QList<TreeNode *>{a1, a2});
        SignalLog log;
        log.watchNode(root.get());
        delete a2;
        root->clearDeleteAll();
        QCOMPARE(destroyed, 5);
        QCOMPARE(root->childNodesCount(), 0);
        QCOMPARE(log.entries, (QStringList{"nodesAboutToBeRemoved(root, 1, 1)", "nodesRemoved",
                                           "nodesAboutToBeRemoved(root, 0, 0)", "nodesRemoved"}));
    }

    // Despite its name, allChildNodes() goes one level below the children.
    void allChildNodesIsOneLevelDeep()
    {
        const Tree root = tree(QStringLiteral("a[a1[deep] a2] b[b1]"));
        QStringList ids;
        for (TreeNode *node : root->allChildNodes())
            ids << node->id();
        QCOMPARE(ids, (QStringList{"a", "b", "a1", "a2", "b1"}));
    }

    void loadTreeFromList_data()
    {
        // Each node: "id:depth:parent".
        QTest::addColumn<int>("rootDepth");
        QTest::addColumn<QStringList>("nodes");
        QTest::addColumn<QString>("expectedTree");
        QTest::addColumn<QStringList>("expectedAfterLoad");

        QTest::newRow("two levels, sorted by id")
            << 0 << QStringList{"m2:1:", "c:2:m2", "m1:1:"} << "m1 m2[c]" << QStringList{"m1", "m2", "c"};
        QTest::newRow("same depth as root never attached") << 0 << QStringList{"a:0:", "b:1:"} << "b" << QStringList{"b"};
        QTest::newRow("skipped level stays detached") << 0 << QStringList{"a:1:", "deep:3:a"} << "a" << QStringList{"a"};
        QTest::newRow("parent two levels up is not matched")
            << 0 << QStringList{"a:1:", "b:2:a", "c:3:a"} << "a[b]" << QStringList{"a", "b"};
        QTest::newRow("candidate need not be attached")
            << 0 << QStringList{"orphan:1:x", "kid:2:orphan"} << "" << QStringList{"kid"};
        QTest::newRow("first of two equal ids wins")
            << 0 << QStringList{"p:1:", "p:1:", "k:2:p"} << "p[k] p" << QStringList{"p", "p", "k"};
        // Levels are matched only against the level just before them in the
        // sorted list: b (depth 1) comes between the root (depth 2) and a, so a
        // finds no parent, while c still hangs under the detached a.
        QTest::newRow("shallower node shadows the root")
            << 2 << QStringList{"a:3:", "b:1:", "c:4:a"} << "" << QStringList{"c"};
        QTest::newRow("root deeper than zero") << 2 << QStringList{"a:3:", "c:4:a"} << "a[c]" << QStringList{"a", "c"};
    }
    // Loading replaces the former children (detached, announced); loading the
    // same list again gives the same tree.
    void loadTreeFromList()
    {
        QFETCH(int, rootDepth);
        QFETCH(QStringList, nodes);
        TestTreeNode root(QString(), nullptr, rootDepth);
        QStringList afterLoad;
        QList<TreeNode *> list;
        for (const QString &entry : nodes) {
            const QStringList f = entry.split(QLatin1Char(':'));
            auto *node = new TestTreeNode(f.at(0), &root, f.at(1).toInt(), f.at(2));
            node->afterLoadLog = &afterLoad;
            list << node;
        }
        auto *stale = new TestTreeNode(QStringLiteral("stale"), &root, rootDepth + 1);
        root.append(stale);
        SignalLog log;
        log.watchNode(&root);
        for (int pass = 0; pass < 2; ++pass) {
            afterLoad.clear();
            root.loadTreeFromList(list);
            QTEST(TreeString::fromTree(&root), "expectedTree");
            QTEST(afterLoad, "expectedAfterLoad");
        }
        QVERIFY(!stale->parentNode());
        QCOMPARE(log.entries.first(), QStringLiteral("nodesAboutToBeRemoved(, 0, 0)"));
    }

    // Siblings come out in the order of QString's own comparison, also for
    // ids that share long prefixes, are prefixes of each other, hold U+0000
    // or code units above 0x7fff.
    void loadTreeFromListOrdersLikeStrings()
    {
        const QChar nul(0);
        QStringList ids{QStringLiteral("abcd"), QStringLiteral("abcde"), QStringLiteral("abc"),
                        QStringLiteral("abcd") + nul, QStringLiteral("abc") + nul, QStringLiteral("abc") + nul + nul,
                        QStringLiteral("ab") + QChar(0xffff) + QStringLiteral("z"), QStringLiteral("ab") + QChar(0xe9),
                        QStringLiteral("ab") + QChar(0x8000), QStringLiteral("ab") + QChar(0x7fff),
                        QStringLiteral("abcc") + QChar(0xffff), QStringLiteral("abcdefgh1"), QStringLiteral("abcdefgh0"),
                        QString(), QStringLiteral("Z"), QStringLiteral("a"), QString(nul)};
        std::reverse(ids.begin(), ids.end());
        TestTreeNode root(QString(), nullptr, 0);
        QList<TreeNode *> list;
        for (const QString &id : qAsConst(ids))
            list << new TestTreeNode(id, &root, 1);
        root.loadTreeFromList(list);

        QStringList sorted = ids;
        std::sort(sorted.begin(), sorted.end());
        QStringList loaded;
        for (TreeNode *node : root.childNodes())
            loaded << node->id();
        QCOMPARE(loaded, sorted);
    }

    // Any node answers its expected parent id in every column; a configuration
    // entry shows its name and value under fixed headers, one level below its root.
    void rolesAndConfNodes()
    {
        TreeNode expecting(3, QStringLiteral("parent"));
        QCOMPARE(expecting.data(5, Qt::UserRole + 3).toString(), QStringLiteral("parent"));

        auto *root = new ConfRootTreeNode;
        QPointer<ConfTreeNode> node = new ConfTreeNode(QStringLiteral("port"), QStringLiteral("5432"));
        root->append(node);
        QCOMPARE(node->id(), QStringLiteral("Conf_port_5432"));
        QCOMPARE(node->data(0, Qt::DisplayRole).toString(), QStringLiteral("port"));
        QCOMPARE(node->data(1, Qt::ToolTipRole).toString(), QStringLiteral("5432"));
        QVERIFY(!node->data(0, Qt::UserRole + 2).isValid());
        QCOMPARE(node->expectedDepth() - root->expectedDepth(), 1);
        QCOMPARE(root->columnCount(), 2);
        QCOMPARE(root->headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("Name"));
        QCOMPARE(root->headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("Value"));
        // The configuration root owns its subtree.
        delete root;
        QVERIFY(node.isNull());
    }
};

QTEST_GUILESS_MAIN(TreeNodeTest)
#include "tst_treenode.moc"
