// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/treenodemodel.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QPointer>
#include <QtTest>

#include <functional>
#include <memory>

class TreeNodeModelTest;
using Action = std::function<void(TreeNodeModelTest *)>;
Q_DECLARE_METATYPE(Action)

class TreeNodeModelTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<TestTreeNode> root;
    std::unique_ptr<TreeNodeModel> model;
    std::unique_ptr<QAbstractItemModelTester> tester;
    SignalLog *log = nullptr;

    TestTreeNode *node(const char *path)
    {
        return static_cast<TestTreeNode *>(TreeString::find(root.get(), QLatin1String(path)));
    }
    QModelIndex index(const char *path) { return model->treeNodeToIndex(node(path)); }
    TestTreeNode *added(const char *id) { return new TestTreeNode(QLatin1String(id), root.get()); }
    void makeModel(const QString &tree, bool withTester = true)
    {
        tester.reset();
        root.reset(TreeString::makeTree(tree));
        model.reset(new TreeNodeModel(root.get()));
        if (withTester)
            tester.reset(new QAbstractItemModelTester(model.get(),
                                                      QAbstractItemModelTester::FailureReportingMode::QtTest));
        log = new SignalLog(model.get());
        log->watchModel(model.get());
    }

private Q_SLOTS:
    void init() { makeModel(QStringLiteral("a[a1 a2[x]] b c")); }
    void cleanup()
    {
        tester.reset();
        model.reset();
        root.reset();
    }

    void emptyWithoutRoot()
    {
        TreeNodeModel empty;
        QAbstractItemModelTester watch(&empty, QAbstractItemModelTester::FailureReportingMode::QtTest);
        QVERIFY(!empty.toTreeNode(QModelIndex()));
        // Slots are inert without a root.
        empty.nodesAboutToBeInserted(nullptr, 0, 0);
        empty.nodesInserted();
        QCOMPARE(empty.rowCount(), 0);
    }

    void shapeAndMapping()
    {
        QCOMPARE(TreeString::fromModel(model.get()), QStringLiteral("a[a1 a2[x]] b c"));
        const QModelIndex x = index("a/a2/x");
        QCOMPARE(x.sibling(0, 1).data().toString(), QStringLiteral("x:1"));
        QCOMPARE(x.parent(), index("a/a2"));
        for (const char *path : {"a", "a/a1", "a/a2", "a/a2/x", "b", "c"})
            QCOMPARE(model->toTreeNode(index(path)), node(path));
        QCOMPARE(model->toTreeNode(QModelIndex()), root.get());
        QVERIFY(!model->treeNodeToIndex(root.get()).isValid());
        QVERIFY(!model->treeNodeToIndex(nullptr).isValid());
        QVERIFY(!model->setData(QModelIndex(), QStringLiteral("no"), Qt::EditRole));
        // A node of another tree has no index.
        TestTreeNode outsider(QStringLiteral("outsider"));
        TestTreeNode outsiderChild(QStringLiteral("child"));
        outsider.append(&outsiderChild);
        QVERIFY(!model->treeNodeToIndex(&outsiderChild).isValid());
    }

    // Every change of the tree reaches views as the matching model signals.
    void changesBecomeModelSignals_data()
    {
        QTest::addColumn<Action>("action");
        QTest::addColumn<QStringList>("expectedSignals");
        QTest::addColumn<QString>("expectedTree");
        const QString unchanged = QStringLiteral("a[a1 a2[x]] b c");

        QTest::newRow("insert and remove below a node")
            << Action([](TreeNodeModelTest *t) {
                   t->node("a/a2")->insert(0, QList<TreeNode *>{t->added("w"), t->added("v")});
                   t->node("a")->removeAt(0, 5);
               })
            << QStringList{"aboutToInsert(a2, 0, 1)", "inserted(a2, 0, 1)", "aboutToRemove(a, 0, 1)", "removed(a, 0, 1)"}
            << "a b c";
        QTest::newRow("detached subtree is silent until attached again")
            << Action([](TreeNodeModelTest *t) {
                   TreeNode *a2 = t->node("a/a2");
                   t->node("a")->removeOne(a2);
                   a2->append(t->added("u"));
                   t->node("c")->append(a2);
                   a2->emitNodeDataChanged();
               })
            << QStringList{"aboutToRemove(a, 1, 1)", "removed(a, 1, 1)", "aboutToInsert(c, 0, 0)", "inserted(c, 0, 0)",
                           "changed(a2:0, a2:1)"}
            << "a[a1] b c[a2[x u]]";
        QTest::newRow("destroyed node")
            << Action([](TreeNodeModelTest *t) { delete t->node("b"); })
            << QStringList{"aboutToRemove(root, 1, 1)", "removed(root, 1, 1)"} << "a[a1 a2[x]] c";
        QTest::newRow("node data")
            << Action([](TreeNodeModelTest *t) { t->node("a/a2/x")->emitNodeDataChanged(); })
            << QStringList{"changed(x:0, x:1)"} << unchanged;
        QTest::newRow("children data, none for a leaf")
            << Action([](TreeNodeModelTest *t) {
                   t->node("a")->emitNodeChildsDataChanged();
                   t->node("a/a1")->emitNodeChildsDataChanged();
               })
            << QStringList{"changed(a1:0, a2:1)"} << unchanged;
        QTest::newRow("same root again")
            << Action([](TreeNodeModelTest *t) { t->model->setRootNode(t->root.get()); }) << QStringList() << unchanged;
    }
    void changesBecomeModelSignals()
    {
        QFETCH(Action, action);
        action(this);
        QTEST(log->entries, "expectedSignals");
        QTEST(TreeString::fromModel(model.get()), "expectedTree");
    }

    // Extra nodes are shown before the root's children; changes below them
    // are heard until they are replaced or deleted.
    void extraRowsComeFirst()
    {
        TestTreeNode *e1 = added("e1");
        TestTreeNode *e2 = added("e2");
        e2->append(added("e2child"));
        model->setExtraRootChildNodes({e1, e2});
        QCOMPARE(TreeString::fromModel(model.get()), QStringLiteral("e1 e2[e2child] a[a1 a2[x]] b c"));
        QCOMPARE(index("b").row(), 3);
        root->insert(0, added("new"));
        root->removeAt(1, 1);
        e1->append(added("e1child"));
        root->emitNodeChildsDataChanged();
        QCOMPARE(log->take(), (QStringList{"aboutToReset", "reset", "aboutToInsert(root, 2, 2)", "inserted(root, 2, 2)",
                                           "aboutToRemove(root, 3, 3)", "removed(root, 3, 3)",
                                           "aboutToInsert(e1, 0, 0)", "inserted(e1, 0, 0)", "changed(e1:0, c:1)"}));

        model->setExtraRootChildNodes({e2});
        log->take();
        e1->append(added("quiet"));
        QVERIFY(log->entries.isEmpty());
        model->deleteExtraRootChildNodes();
        model->deleteExtraRootChildNodes();
        QCOMPARE(log->take(), (QStringList{"aboutToReset", "reset"}));
        QCOMPARE(TreeString::fromModel(model.get()), QStringLiteral("new b c"));
    }

    // A new root resets the model, and only the current root is heard; a
    // destroyed root or extra node leaves the model, not a dangling pointer.
    void rootReplacementAndDestruction()
    {
        std::unique_ptr<TestTreeNode> other(TreeString::makeTree(QStringLiteral("o1 o2")));
        model->setRootNode(other.get());
        root->append(added("ignored"));
        other->append(new TestTreeNode(QStringLiteral("o3"), other.get()));
        QCOMPARE(log->take(), (QStringList{"aboutToReset", "reset", "aboutToInsert(root, 2, 2)", "inserted(root, 2, 2)"}));
        QCOMPARE(TreeString::fromModel(model.get()), QStringLiteral("o1 o2 o3"));

        QPointer<TreeNode> extra = new TestTreeNode(QStringLiteral("e"));
        model->setExtraRootChildNodes({extra});
        other.reset();
        QCOMPARE(model->rowCount(), 0);
        QVERIFY(!model->rootNode());
        delete extra;
        QVERIFY(model->extraRootChildNodes().isEmpty());
    }

    // Two deliberate departures from the usual model rules, so run without
    // the tester: a node flagged as leaf (4) has rows but reports no
    // children, and a change of the root, which has no row, is announced
    // with two invalid indexes.
    void leafFlagAndRootChangeOddities()
    {
        makeModel(QStringLiteral("a[a1] b[b1]"), false);
        node("a")->specialFlags = 4;
        node("b")->specialFlags = 2 | 8;
        QVERIFY(!model->hasChildren(index("a")));
        QCOMPARE(model->rowCount(index("a")), 1);
        QVERIFY(model->hasChildren(index("b")));
        // Any column of a row asks that row's node whether it can fetch more.
        node("b/b1")->fetchable = true;
        const QModelIndex b1 = index("b/b1");
        QVERIFY(model->canFetchMore(b1) && model->canFetchMore(b1.sibling(b1.row(), 1)));
        QVERIFY(!model->canFetchMore(index("a").sibling(0, 1)));
        root->emitNodeDataChanged();
        QCOMPARE(log->take(), QStringList{"changed(root, root)"});
    }
};

QTEST_GUILESS_MAIN(TreeNodeModelTest)
#include "tst_treenodemodel.moc"
