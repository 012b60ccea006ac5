// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/choicefiltertreenodesortfilterproxymodel.h>
#include <kvt-common/choicetreenodeproxymodel.h>
#include <kvt-common/choicetreenodesortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;
using Names = QSet<QString>;

static Names names(const QString &text)
{
    const QStringList list = text.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    return Names(list.cbegin(), list.cend());
}

class ChoiceTreeNodeProxyModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init() { makeModels(QStringLiteral("a[a1 a2] b c d")); }
    void cleanup() { keep.clear(); choice.reset(); model.reset(); root.reset(); }

    void bookkeeping_data()
    {
        QTest::addColumn<QString>("checked");
        QTest::addColumn<QString>("blocked");
        QTest::addColumn<QString>("clicks"); // "+x" ticks x, "-x" unticks it
        QTest::addColumn<QString>("accepted"); // one digit per click
        QTest::addColumn<QString>("add");
        QTest::addColumn<QString>("remove");

        QTest::newRow("tick then untick leaves nothing") << "" << "" << "+b -b" << "11" << "" << "";
        QTest::newRow("untick a name ticked at reset") << "a b" << "" << "-a" << "1" << "" << "a";
        QTest::newRow("several names") << "a b" << "" << "+c -b +d -a" << "1111" << "c d" << "a b";
        QTest::newRow("same state twice is refused") << "a" << "" << "+a -b +c +c" << "0010" << "c" << "";
        QTest::newRow("blocked name is refused") << "a" << "b c" << "+b -a +c -c" << "0100" << "" << "a";
    }

    void bookkeeping()
    {
        QFETCH(QString, checked);
        QFETCH(QString, blocked);
        QFETCH(QString, clicks);
        QFETCH(QString, accepted);
        QFETCH(QString, add);
        QFETCH(QString, remove);

        choice->setCheckedBlockedNames(names(checked), names(blocked));
        QSignalSpy changed(choice.get(), SIGNAL(dataChanged(QModelIndex, QModelIndex, QVector<int>)));
        QString results;
        for (const QString &click : clicks.split(QLatin1Char(' ')))
            results += tick(click.mid(1), click[0] == QLatin1Char('+')) ? '1' : '0';
        QCOMPARE(results, accepted);
        // Each accepted click is announced; a refused one is silent.
        QCOMPARE(changed.count(), accepted.count(QLatin1Char('1')));
        QCOMPARE(choice->addNames(), names(add));
        QCOMPARE(choice->removeNames(), names(remove));
    }

    void settingTheSets()
    {
        SignalLog log;
        log.watchModel(choice.get());
        QSignalSpy state(choice.get(), SIGNAL(stateChanged()));
        const QStringList reset{"aboutToReset", "reset"};
        choice->setCheckedBlockedNames(names(QStringLiteral("a")), names(QStringLiteral("d")));
        choice->setBlockedNames(names(QStringLiteral("d"))); // the same set again changes nothing
        // Blocking keeps the record of changes; a new set of ticks restarts it.
        QVERIFY(tick(QStringLiteral("b"), true) && tick(QStringLiteral("a"), false));
        choice->setBlockedNames(names(QStringLiteral("c")));
        QCOMPARE(choice->addNames() + choice->removeNames(), names(QStringLiteral("a b")));
        choice->setCheckedNames(names(QStringLiteral("b d")));
        QVERIFY(choice->addNames().isEmpty() && choice->removeNames().isEmpty());
        QCOMPARE(log.take(), reset + QStringList({"changed(b:0, b:0)", "changed(a:0, a:0)"}) + reset + reset);
        QCOMPARE(state.count(), 5);
    }

    void blockedRowsFollowTheirAncestor_data()
    {
        QTest::addColumn<QString>("checked");
        QTest::addColumn<QString>("blocked");
        QTest::addColumn<QString>("ticked"); // rows of "a[a1[a11]] b" that read as ticked

        QTest::newRow("blocked child of a ticked parent") << "a" << "a1" << "a a1";
        QTest::newRow("nearest unblocked ancestor decides") << "a1" << "a11" << "a1 a11";
        QTest::newRow("blocked all the way up") << "" << "a a1 a11 b" << "a a1 a11 b";
    }

    void blockedRowsFollowTheirAncestor()
    {
        QFETCH(QString, checked);
        QFETCH(QString, blocked);
        QFETCH(QString, ticked);

        makeModels(QStringLiteral("a[a1[a11]] b"));
        choice->setCheckedBlockedNames(names(checked), names(blocked));
        Names shown;
        for (const char *path : {"a", "a/a1", "a/a1/a11", "b"}) {
            const QModelIndex index = indexOf(QLatin1String(path));
            const QString name = index.data().toString();
            if (index.data(Qt::CheckStateRole).toInt() == Qt::Checked)
                shown.insert(name);
            QCOMPARE(index.data(choice->blockRole()).toBool(), shown.contains(name));
            // A blocked row has no flags at all, in every column.
            const bool isBlocked = choice->blockedNames().contains(name);
            for (const QModelIndex &cell : {index, index.sibling(index.row(), 1)})
                QCOMPARE(choice->flags(cell), isBlocked ? Qt::ItemFlags() : model->flags(choice->mapToSource(cell)));
        }
        QCOMPARE(shown, names(ticked));
    }

    void viewsFollowLiveTree()
    {
        choice->setCheckedNames(names(QStringLiteral("a b x")));
        auto *on = watched(new ChoiceTreeNodeSortFilterProxyModel(true));
        auto *off = watched(new ChoiceFilterTreeNodeSortFilterProxyModel(false));
        auto check = [&](const char *ticked, const char *unticked) {
            QCOMPARE(TreeString::fromModel(on), QLatin1String(ticked));
            QCOMPARE(TreeString::fromModel(off), QLatin1String(unticked));
        };

        TreeString::build(node("b"), QStringLiteral("x y"));
        root->insert(0, new TestTreeNode(QStringLiteral("x"), root.get()));
        check("x a b[x]", "c d");
        root->removeAt(1, 2);
        // An edit in another role goes to the node: a row renamed into a ticked name moves over.
        QVERIFY(choice->setData(indexOf(QStringLiteral("c")), QStringLiteral("a"), Qt::EditRole));
        check("x a", "d");

        model->nodesAboutToBeReset();
        root->clear();
        TreeString::build(root.get(), QStringLiteral("b[y x] z zed w"));
        node("w")->specialFlags = node("b/x")->specialFlags = 1; // hidden by the filtering view only
        model->nodesReset();
        check("b[x]", "z zed");
        off->setFilterRegExp(QStringLiteral("^ze"));
        check("b[x]", "zed");
    }

private:
    std::unique_ptr<TestTreeNode> root;
    std::unique_ptr<TreeNodeModel> model;
    std::unique_ptr<ChoiceTreeNodeProxyModel> choice;
    std::vector<std::unique_ptr<QObject>> keep; // proxies over the choice model and testers

    TestTreeNode *node(const QString &path)
    {
        return static_cast<TestTreeNode *>(TreeString::find(root.get(), path));
    }
    QModelIndex indexOf(const QString &path) { return choice->treeNodeToIndex(node(path)); }
    void makeModels(const QString &tree)
    {
        cleanup();
        root.reset(TreeString::makeTree(tree));
        model.reset(new TreeNodeModel(root.get()));
        choice.reset(new ChoiceTreeNodeProxyModel(0, Qt::CheckStateRole, Qt::UserRole + 20));
        choice->setSourceModel(model.get());
        keep.emplace_back(new Tester(choice.get(), Tester::FailureReportingMode::QtTest));
    }
    template<typename Proxy>
    Proxy *watched(Proxy *proxy)
    {
        proxy->setSourceModel(choice.get());
        keep.emplace_back(new Tester(proxy, Tester::FailureReportingMode::QtTest));
        keep.emplace_back(proxy);
        return proxy;
    }
    bool tick(const QString &path, bool ticked)
    {
        return choice->setData(indexOf(path), ticked ? Qt::Checked : Qt::Unchecked, choice->choiceRole());
    }
};

QTEST_GUILESS_MAIN(ChoiceTreeNodeProxyModelTest)
#include "tst_choicetreenodeproxymodel.moc"
