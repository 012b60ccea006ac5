// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>
#include <kvt-common/treenodesortfilterproxymodel.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;

class TreeNodeSortFilterProxyModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void cleanup()
    {
        while (!keep.empty()) // testers and proxies go before the model they watch
            keep.pop_back();
        model.reset();
        root.reset();
    }

    void filtering_data()
    {
        QTest::addColumn<int>("flagsFilter");
        QTest::addColumn<QList<int>>("columns");
        QTest::addColumn<QString>("pattern");
        QTest::addColumn<QString>("expected");

        // Special flags: a/a1=1 b=2 c=3 c/c1=2. Every row shows "id" in column 0
        // and "id:n" in column n.
        const QList<int> all;
        const QString everything = QStringLiteral("a[a1 a2] b c[c1]");
        QTest::newRow("flags 0 shows everything") << 0 << all << "" << everything;
        QTest::newRow("flags 1 hides bit 1 with its subtree") << 1 << all << "" << "a[a2] b";
        QTest::newRow("flags 2 shows only bit 2") << 2 << all << "" << "b c[c1]";
        QTest::newRow("other flag bits are ignored") << (4 | 8) << all << "" << everything;
        QTest::newRow("invalid pattern filters nothing") << 0 << all << "a[" << everything;
        QTest::newRow("only accepted columns are searched") << 0 << QList<int>{0, 1} << ":2" << "";
        QTest::newRow("children of a hidden parent are not searched") << 0 << QList<int>{0} << "1$" << "";
        QTest::newRow("matching parent keeps matching children") << 0 << all << "^a" << "a[a1 a2]";
    }

    void filtering()
    {
        QFETCH(int, flagsFilter);
        QFETCH(QList<int>, columns);
        QFETCH(QString, pattern);
        QFETCH(QString, expected);

        makeModel(QStringLiteral("a[a1 a2] b c[c1]"), 3);
        for (const auto &[path, flags] : {std::pair{"a/a1", 1}, {"b", 2}, {"c", 3}, {"c/c1", 2}})
            node(QLatin1String(path))->specialFlags = flags;
        const QSet<int> accept(columns.cbegin(), columns.cend());
        auto *proxy = watched(new FilterTreeNodeSortFilterProxyModel(accept, flagsFilter), model.get());
        proxy->setFilterRegExp(QRegExp(pattern));
        QCOMPARE(TreeString::fromModel(proxy), expected);
    }

    void acceptColumns()
    {
        makeModel(QStringLiteral("a[a1] b"), 3);
        auto *proxy = watched(new TreeNodeSortFilterProxyModel(QSet<int>{0, 2}, 0), model.get());
        // A new set rebuilds the columns in one reset; the same set again is silent.
        SignalLog log;
        log.watchModel(proxy);
        proxy->setAcceptColumns({2});
        proxy->setAcceptColumns({2});
        QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
        // Without column 0 the rows still map to their nodes.
        const QModelIndex b = proxy->treeNodeToIndex(node("b"));
        QCOMPARE(b.data().toString(), QStringLiteral("b:2"));
        QCOMPARE(proxy->toTreeNode(b), node("b"));
    }

    void followsLiveTree()
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
        TreeString::build(node("cat"), QStringLiteral("ape[a1]"));
        root->insert(1, new TestTreeNode(QStringLiteral("ash"), root.get()));
        check("apple[ant axe] ash bee cat[arc ape[a1]]", "apple[ant axe] ash",
              "cat[arc ape[a1]] bee ash apple[axe ant]");

        node("apple")->removeAt(0, 1);
        root->removeAt(3, 1);
        // A node whose flags change is filtered again.
        node("bee")->specialFlags = 1;
        node("bee")->emitNodeDataChanged();
        check("apple[axe] ash", "apple[axe] ash", "ash apple[axe]");

        // A renamed row is filtered and sorted again.
        QVERIFY(model->setData(model->treeNodeToIndex(node("ash")), QStringLiteral("zoo"), Qt::EditRole));
        check("apple[axe] zoo", "apple[axe]", "zoo apple[axe]");
    }

    void nodeMapping()
    {
        makeModel(QStringLiteral("a[a1 a2[x]] b c"));
        node("b")->specialFlags = 1;
        auto *inner = watched(new TreeNodeSortFilterProxyModel(1), model.get());
        inner->sort(0, Qt::DescendingOrder);
        auto *proxy = watched(new FilterTreeNodeSortFilterProxyModel(0), inner);
        proxy->setFilterRegExp(QStringLiteral("^[^x]"));
        QCOMPARE(TreeString::fromModel(proxy), QStringLiteral("c a[a2 a1]"));
        QCOMPARE(proxy->rootNode(), root.get());
        QCOMPARE(proxy->toTreeNode(QModelIndex()), root.get());

        // Through stacked proxies, every column of a row names the same node.
        for (const char *path : {"a", "a/a1", "c"}) {
            TreeNode *n = node(QLatin1String(path));
            const QModelIndex index = proxy->treeNodeToIndex(n);
            QCOMPARE(proxy->toTreeNode(index), n);
            QCOMPARE(proxy->toTreeNode(index.sibling(index.row(), 1)), n);
        }
        for (TreeNode *hidden : QList<TreeNode *>{node("b"), node("a/a2/x"), root.get(), nullptr})
            QVERIFY(!proxy->treeNodeToIndex(hidden).isValid());
    }

private:
    std::unique_ptr<TestTreeNode> root;
    std::unique_ptr<TreeNodeModel> model;
    std::vector<std::unique_ptr<QObject>> keep; // proxies and testers, destroyed first

    TestTreeNode *node(const QString &path)
    {
        return static_cast<TestTreeNode *>(TreeString::find(root.get(), path));
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

QTEST_GUILESS_MAIN(TreeNodeSortFilterProxyModelTest)
#include "tst_treenodesortfilterproxymodel.moc"
