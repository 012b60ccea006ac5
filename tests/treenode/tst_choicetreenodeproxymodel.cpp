#include <kvt-common/choicefiltertreenodesortfilterproxymodel.h>
#include <kvt-common/choicetreenodeproxymodel.h>
#include <kvt-common/choicetreenodesortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>

#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QRandomGenerator>
#include <QStandardItemModel>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;
using Names = QSet<QString>;

namespace {

Names names(const QString &text)
{
    const QStringList list = text.split(QLatin1Char(' '), Qt::SkipEmptyParts);
    return Names(list.cbegin(), list.cend());
}

QString sorted(const Names &set)
{
    QStringList list = set.values();
    list.sort();
    return list.join(QLatin1Char(' '));
}

} // namespace

class ChoiceTreeNodeProxyModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void bookkeeping_data();
    void bookkeeping();
    void bookkeepingIsAlwaysTheNetDifference();
    void tickSignals();
    void stateByRole_data();
    void stateByRole();
    void blockedRowsFollowTheirAncestor_data();
    void blockedRowsFollowTheirAncestor();
    void blockedRowsHaveNoFlags();
    void settingTheSets();
    void otherEditsReachTheSource();
    void choiceViews_data();
    void choiceViews();
    void choiceViewsFollowLiveTree();
    void filterViewAppliesTextAndFlags();
    void mappingThroughTheChoiceStack();
    void withoutTreeSource();

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

    void makeModels(const QString &tree, int choiceRole = Qt::CheckStateRole, int blockRole = Qt::UserRole + 20)
    {
        keep.clear();
        choice.reset();
        root.reset(TreeString::makeTree(tree));
        model.reset(new TreeNodeModel(root.get()));
        choice.reset(new ChoiceTreeNodeProxyModel(0, choiceRole, blockRole));
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

void ChoiceTreeNodeProxyModelTest::init()
{
    makeModels(QStringLiteral("a[a1 a2] b c d"));
}

void ChoiceTreeNodeProxyModelTest::cleanup()
{
    keep.clear();
    choice.reset();
    model.reset();
    root.reset();
}

void ChoiceTreeNodeProxyModelTest::bookkeeping_data()
{
    QTest::addColumn<QString>("checked");
    QTest::addColumn<QString>("blocked");
    QTest::addColumn<QString>("clicks"); // "+x" ticks x, "-x" unticks it
    QTest::addColumn<QString>("accepted"); // one digit per click
    QTest::addColumn<QString>("add");
    QTest::addColumn<QString>("remove");

    QTest::newRow("tick then untick leaves nothing") << "" << "" << "+b -b" << "11" << "" << "";
    QTest::newRow("untick a name ticked at reset") << "a b" << "" << "-a" << "1" << "" << "a";
    QTest::newRow("and tick it again") << "a b" << "" << "-a +a" << "11" << "" << "";
    QTest::newRow("several names") << "a b" << "" << "+c -b +a2 -a" << "1111" << "a2 c" << "a b";
    QTest::newRow("same state twice is refused") << "a" << "" << "+a -b +c +c" << "0010" << "c" << "";
    QTest::newRow("blocked name is refused") << "a" << "b c" << "+b -a +c -c" << "0100" << "" << "a";
    QTest::newRow("child names are tracked too") << "" << "" << "+a1 +a2 -a1" << "111" << "a2" << "";
}

void ChoiceTreeNodeProxyModelTest::bookkeeping()
{
    QFETCH(QString, checked);
    QFETCH(QString, blocked);
    QFETCH(QString, clicks);
    QFETCH(QString, accepted);
    QFETCH(QString, add);
    QFETCH(QString, remove);

    const QHash<QString, QString> paths{{"a1", "a/a1"}, {"a2", "a/a2"}};
    choice->setCheckedBlockedNames(names(checked), names(blocked));
    QString results;
    for (const QString &click : clicks.split(QLatin1Char(' '))) {
        const QString name = click.mid(1);
        results += tick(paths.value(name, name), click.startsWith(QLatin1Char('+'))) ? '1' : '0';
    }
    QCOMPARE(results, accepted);
    QCOMPARE(sorted(choice->addNames()), add);
    QCOMPARE(sorted(choice->removeNames()), remove);
}

void ChoiceTreeNodeProxyModelTest::bookkeepingIsAlwaysTheNetDifference()
{
    const QStringList paths{"a", "a/a1", "a/a2", "b", "c", "d"};
    const Names initial = names(QStringLiteral("a a2 d"));
    choice->setCheckedNames(initial);
    QRandomGenerator random(20240601);
    for (int i = 0; i < 500; ++i) {
        tick(paths.at(random.bounded(paths.size())), random.bounded(2));
        const Names now = choice->checkedNames();
        QCOMPARE(choice->addNames(), Names(now).subtract(initial));
        QCOMPARE(choice->removeNames(), Names(initial).subtract(now));
    }
}

void ChoiceTreeNodeProxyModelTest::tickSignals()
{
    SignalLog log;
    log.watchModel(choice.get());
    connect(choice.get(), &ChoiceTreeNodeProxyModel::stateChanged, &log,
            [&log] { log.entries.append(QStringLiteral("stateChanged")); });

    QVERIFY(tick(QStringLiteral("a/a2"), true));
    QCOMPARE(log.take(), (QStringList{"changed(a2:0, a2:0)", "stateChanged"}));
    QVERIFY(!tick(QStringLiteral("a/a2"), true));
    choice->setBlockedNames(names(QStringLiteral("b")));
    log.take();
    QVERIFY(!tick(QStringLiteral("b"), true));
    QVERIFY(log.entries.isEmpty());

    // Forgetting the changes is silent and keeps the ticks.
    choice->clearAddRemoveNames();
    QVERIFY(log.entries.isEmpty());
    QVERIFY(choice->addNames().isEmpty());
    QCOMPARE(choice->checkedNames(), names(QStringLiteral("a2")));
}

void ChoiceTreeNodeProxyModelTest::stateByRole_data()
{
    QTest::addColumn<int>("choiceRole");
    QTest::addColumn<QVariant>("ticked");
    QTest::addColumn<QVariant>("unticked");

    QTest::newRow("check state role") << int(Qt::CheckStateRole) << QVariant(int(Qt::Checked))
                                      << QVariant(int(Qt::Unchecked));
    QTest::newRow("user role") << int(Qt::UserRole + 7) << QVariant(true) << QVariant(false);
}

void ChoiceTreeNodeProxyModelTest::stateByRole()
{
    QFETCH(int, choiceRole);
    QFETCH(QVariant, ticked);
    QFETCH(QVariant, unticked);

    const int blockRole = Qt::UserRole + 20;
    makeModels(QStringLiteral("a b"), choiceRole, blockRole);
    choice->setCheckedNames(names(QStringLiteral("a")));
    const QModelIndex a = indexOf(QStringLiteral("a"));
    const QModelIndex b = indexOf(QStringLiteral("b"));
    QCOMPARE(a.data(choiceRole), ticked);
    QCOMPARE(b.data(choiceRole), unticked);
    QCOMPARE(a.data(blockRole).toBool(), true);
    QCOMPARE(b.data(blockRole).toBool(), false);

    // Other columns and other roles are the source's.
    QCOMPARE(a.sibling(a.row(), 1).data(choiceRole), model->index(0, 1).data(choiceRole));
    QCOMPARE(a.data(Qt::DisplayRole).toString(), QStringLiteral("a"));
    QVERIFY(!choice->data(model->index(0, 0), choiceRole).isValid()); // not our index

    // Whatever the role, any true value ticks.
    QVERIFY(choice->setData(b, true, choiceRole));
    QCOMPARE(b.data(choiceRole), ticked);
}

void ChoiceTreeNodeProxyModelTest::blockedRowsFollowTheirAncestor_data()
{
    QTest::addColumn<QString>("checked");
    QTest::addColumn<QString>("blocked");
    QTest::addColumn<QString>("ticked"); // rows of "a[a1[a11]] b" that read as ticked

    QTest::newRow("nothing blocked") << "a a11" << "" << "a a11";
    QTest::newRow("blocked child of a ticked parent") << "a" << "a1" << "a a1";
    QTest::newRow("blocked child of an unticked parent") << "a1" << "a1" << "";
    QTest::newRow("two blocked levels") << "a" << "a1 a11" << "a a1 a11";
    QTest::newRow("nearest unblocked ancestor decides") << "a1" << "a11" << "a1 a11";
    QTest::newRow("blocked all the way up") << "" << "a a1 a11 b" << "a a1 a11 b";
}

void ChoiceTreeNodeProxyModelTest::blockedRowsFollowTheirAncestor()
{
    QFETCH(QString, checked);
    QFETCH(QString, blocked);
    QFETCH(QString, ticked);

    makeModels(QStringLiteral("a[a1[a11]] b"));
    choice->setCheckedBlockedNames(names(checked), names(blocked));
    Names shown;
    for (const char *path : {"a", "a/a1", "a/a1/a11", "b"}) {
        const QModelIndex index = indexOf(QLatin1String(path));
        if (index.data(Qt::CheckStateRole).toInt() == Qt::Checked)
            shown.insert(index.data().toString());
        QCOMPARE(index.data(Qt::CheckStateRole).toInt() == Qt::Checked,
                 index.data(choice->blockRole()).toBool());
    }
    QCOMPARE(sorted(shown), ticked);
}

void ChoiceTreeNodeProxyModelTest::blockedRowsHaveNoFlags()
{
    choice->setBlockedNames(names(QStringLiteral("b a2")));
    for (int column = 0; column < 2; ++column) {
        const QModelIndex b = indexOf(QStringLiteral("b"));
        QCOMPARE(choice->flags(b.sibling(b.row(), column)), Qt::NoItemFlags);
        const QModelIndex a2 = indexOf(QStringLiteral("a/a2"));
        QCOMPARE(choice->flags(a2.sibling(a2.row(), column)), Qt::NoItemFlags);
        const QModelIndex c = indexOf(QStringLiteral("c"));
        QCOMPARE(choice->flags(c.sibling(c.row(), column)), model->flags(model->index(c.row(), column)));
    }
    QCOMPARE(choice->flags(model->index(0, 0)), Qt::NoItemFlags); // not our index
}

void ChoiceTreeNodeProxyModelTest::settingTheSets()
{
    SignalLog log;
    log.watchModel(choice.get());
    QSignalSpy state(choice.get(), SIGNAL(stateChanged()));
    const QStringList reset{"aboutToReset", "reset"};

    choice->setCheckedBlockedNames(names(QStringLiteral("a")), names(QStringLiteral("d")));
    QCOMPARE(log.take(), reset);
    QCOMPARE(state.count(), 1);
    choice->setCheckedBlockedNames(names(QStringLiteral("a")), names(QStringLiteral("d")));
    choice->setCheckedNames(names(QStringLiteral("a")));
    choice->setBlockedNames(names(QStringLiteral("d")));
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(state.count(), 1);

    // Blocking keeps the record of changes; new ticks from outside restart it.
    QVERIFY(tick(QStringLiteral("b"), true));
    QVERIFY(tick(QStringLiteral("a"), false));
    log.take();
    choice->setBlockedNames(names(QStringLiteral("c")));
    QCOMPARE(log.take(), reset);
    QCOMPARE(sorted(choice->addNames()), QStringLiteral("b"));
    QCOMPARE(sorted(choice->removeNames()), QStringLiteral("a"));
    choice->setCheckedNames(names(QStringLiteral("c d")));
    QCOMPARE(log.take(), reset);
    QVERIFY(choice->addNames().isEmpty());
    QVERIFY(choice->removeNames().isEmpty());
    QCOMPARE(choice->blockedNames(), names(QStringLiteral("c")));
    QVERIFY(tick(QStringLiteral("b"), true));
    choice->setCheckedBlockedNames(names(QStringLiteral("c d")), Names());
    QVERIFY(choice->addNames().isEmpty());
    QCOMPARE(state.count(), 7);
}

void ChoiceTreeNodeProxyModelTest::otherEditsReachTheSource()
{
    // An edit in another role goes to the node: here it renames the row.
    const QModelIndex b = indexOf(QStringLiteral("b"));
    QVERIFY(choice->setData(b, QStringLiteral("bee"), Qt::EditRole));
    QCOMPARE(b.data().toString(), QStringLiteral("bee"));
    QVERIFY(!choice->setData(b.sibling(b.row(), 1), true, Qt::CheckStateRole));
    QVERIFY(choice->checkedNames().isEmpty());
    QVERIFY(!choice->setData(model->index(0, 0), true, Qt::CheckStateRole));
    QVERIFY(choice->checkedNames().isEmpty());
}

void ChoiceTreeNodeProxyModelTest::choiceViews_data()
{
    QTest::addColumn<int>("choiceRole");
    QTest::newRow("check state role") << int(Qt::CheckStateRole);
    QTest::newRow("user role") << int(Qt::UserRole + 7);
}

void ChoiceTreeNodeProxyModelTest::choiceViews()
{
    QFETCH(int, choiceRole);
    makeModels(QStringLiteral("a[a1 a2] b c d"), choiceRole);
    choice->setCheckedBlockedNames(names(QStringLiteral("a a2 c")), names(QStringLiteral("a1")));
    node("d")->specialFlags = 1; // not a concern of the row test
    auto *ticked = watched(new ChoiceTreeNodeSortFilterProxyModel(true));
    auto *unticked = watched(new ChoiceTreeNodeSortFilterProxyModel(false));
    QVERIFY(ticked->checked());
    QVERIFY(!unticked->checked());

    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("a[a1 a2] c"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("b d"));

    // A tick moves the row from one view to the other.
    QVERIFY(tick(QStringLiteral("b"), true));
    QVERIFY(tick(QStringLiteral("c"), false));
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("a[a1 a2] b"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("c d"));
}

void ChoiceTreeNodeProxyModelTest::choiceViewsFollowLiveTree()
{
    choice->setCheckedNames(names(QStringLiteral("a b x")));
    auto *ticked = watched(new ChoiceTreeNodeSortFilterProxyModel(true));
    auto *unticked = watched(new ChoiceFilterTreeNodeSortFilterProxyModel(false));

    TreeString::build(node("b"), QStringLiteral("x y"));
    root->insert(0, new TestTreeNode(QStringLiteral("x"), root.get()));
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("x a b[x]"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("c d"));

    root->removeAt(1, 2);
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("x"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("c d"));

    // A row renamed into a ticked name moves over.
    QVERIFY(model->setData(model->treeNodeToIndex(node("c")), QStringLiteral("a"), Qt::EditRole));
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("x a"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("d"));

    model->nodesAboutToBeReset();
    root->clear();
    TreeString::build(root.get(), QStringLiteral("b[y x] z"));
    model->nodesReset();
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("b[x]"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("z"));

    // Both views are rebuilt when the names are set again.
    choice->setCheckedNames(names(QStringLiteral("z y")));
    QCOMPARE(TreeString::fromModel(ticked), QStringLiteral("z"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("b[x]"));
}

void ChoiceTreeNodeProxyModelTest::filterViewAppliesTextAndFlags()
{
    makeModels(QStringLiteral("alpha[al] beta gamma almond"));
    choice->setCheckedNames(names(QStringLiteral("gamma")));
    node("almond")->specialFlags = 1;
    auto *unticked = watched(new ChoiceFilterTreeNodeSortFilterProxyModel(false));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("alpha[al] beta"));
    unticked->setFilterRegExp(QStringLiteral("^al"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("alpha[al]"));
    unticked->setFilterFixedString(QStringLiteral("a"));
    QCOMPARE(TreeString::fromModel(unticked), QStringLiteral("alpha[al] beta"));
}

void ChoiceTreeNodeProxyModelTest::mappingThroughTheChoiceStack()
{
    choice->setCheckedNames(names(QStringLiteral("a a2 d")));
    auto *ticked = watched(new ChoiceTreeNodeSortFilterProxyModel(true));
    QCOMPARE(choice->rootNode(), root.get());
    QCOMPARE(ticked->rootNode(), root.get());
    const QModelIndex a2 = ticked->treeNodeToIndex(node("a/a2"));
    QCOMPARE(a2.model(), ticked);
    QCOMPARE(a2.row(), 0);
    QCOMPARE(ticked->toTreeNode(a2), node("a/a2"));
    QCOMPARE(choice->toTreeNode(indexOf(QStringLiteral("d"))), node("d"));
    QVERIFY(!ticked->treeNodeToIndex(node("b")).isValid());

    QItemSelection selection;
    selection.select(ticked->treeNodeToIndex(node("d")), ticked->treeNodeToIndex(node("d")));
    QCOMPARE(ticked->toTreeNode(selection), node("d"));
    QItemSelection inChoice;
    inChoice.select(indexOf(QStringLiteral("c")), indexOf(QStringLiteral("c")));
    QCOMPARE(choice->toTreeNode(inChoice), node("c"));
    QVERIFY(!ticked->toTreeNode(inChoice));
}

void ChoiceTreeNodeProxyModelTest::withoutTreeSource()
{
    ChoiceTreeNodeProxyModel lonely(0, Qt::CheckStateRole, Qt::CheckStateRole);
    QVERIFY(!lonely.rootNode());
    QVERIFY(!lonely.data(QModelIndex(), Qt::CheckStateRole).isValid());

    // Over another kind of model the choice state reads, but cannot be set.
    QStandardItemModel items;
    items.appendRow(new QStandardItem(QStringLiteral("one")));
    items.appendRow(new QStandardItem(QStringLiteral("two")));
    ChoiceTreeNodeProxyModel over(0, Qt::CheckStateRole, Qt::CheckStateRole);
    over.setSourceModel(&items);
    Tester tester(&over, Tester::FailureReportingMode::QtTest);
    over.setCheckedNames(names(QStringLiteral("two")));
    QCOMPARE(over.index(1, 0).data(Qt::CheckStateRole).toInt(), int(Qt::Checked));
    QVERIFY(!over.setData(over.index(0, 0), Qt::Checked, Qt::CheckStateRole));
    QVERIFY(!over.toTreeNode(over.index(0, 0)));

    // Choice views over a source that is no choice model show every row.
    ChoiceTreeNodeSortFilterProxyModel all(true);
    all.setSourceModel(&items);
    QCOMPARE(all.rowCount(), 2);
}

QTEST_GUILESS_MAIN(ChoiceTreeNodeProxyModelTest)
#include "tst_choicetreenodeproxymodel.moc"
