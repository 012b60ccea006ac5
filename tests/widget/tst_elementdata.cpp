#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/serviceconfigureheavyelementdata.h>
#include <kvt-common/serviceheavyelementdata.h>
#include <kvt-common/servicelightelementdata.h>

#include "testtreenode.h"
#include "treestring.h"

#include <QtTest>

#include <memory>

using VariantMap = QMap<QString, QVariant>;
Q_DECLARE_METATYPE(VariantMap)

namespace {

ElementData record(const VariantMap &values)
{
    ElementData data;
    for (auto it = values.cbegin(); it != values.cend(); ++it)
        data.insert(it.key(), it.value());
    return data;
}

// Counts, in *deaths, every destruction of a node of the subtree of root.
void countDeaths(TreeNode *root, int *deaths)
{
    if (auto *node = qobject_cast<TestTreeNode *>(root))
        node->destructionCount = deaths;
    for (TreeNode *child : root->childNodes())
        countDeaths(child, deaths);
}

// A tree of five nodes built detached: the tree, not the QObject parent,
// is what the record has to follow when it destroys its nodes.
TestTreeNode *detachedTree(const QString &id, int *deaths)
{
    auto *root = new TestTreeNode(id);
    auto *a = new TestTreeNode(id + QStringLiteral(".a"));
    auto *b = new TestTreeNode(id + QStringLiteral(".b"));
    auto *a1 = new TestTreeNode(id + QStringLiteral(".a1"));
    auto *a2 = new TestTreeNode(id + QStringLiteral(".a2"));
    root->append(QList<TreeNode *>{a, b});
    a->append(QList<TreeNode *>{a1, a2});
    countDeaths(root, deaths);
    return root;
}

} // namespace

class ElementDataTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void name_data();
    void name();
    void importFrom_data();
    void importFrom();
    void importFromSelfAndSharedCopies();
    void importLeavesTypedFields();
    void setState_data();
    void setState();
    void changeDisplayCopies();
    void serviceLightCopies();
    void heavyCopiesNeverShareNodes();
    void heavyDestroysEachNodeOnce_data();
    void heavyDestroysEachNodeOnce();
    void configureHeavyCopyAsymmetry();
    void kindsThroughBasePointer();
};

void ElementDataTest::name_data()
{
    QTest::addColumn<VariantMap>("values");
    QTest::addColumn<QString>("expected");

    QTest::newRow("empty") << VariantMap() << QString();
    QTest::newRow("other keys only") << VariantMap{{"user", "alice"}} << QString();
    QTest::newRow("string") << VariantMap{{"name", "alice"}} << "alice";
    QTest::newRow("number") << VariantMap{{"name", 42}} << "42";
    QTest::newRow("list is not a name") << VariantMap{{"name", QStringList{"a", "b"}}} << QString();
}

void ElementDataTest::name()
{
    QFETCH(VariantMap, values);
    QFETCH(QString, expected);
    const ElementData data = record(values);
    QCOMPARE(data.name(), expected);
}

void ElementDataTest::importFrom_data()
{
    QTest::addColumn<VariantMap>("receiver");
    QTest::addColumn<VariantMap>("source");
    QTest::addColumn<VariantMap>("expected");

    QTest::newRow("overlap")
        << VariantMap{{"k1", 1}, {"k2", 2}} << VariantMap{{"k2", 20}, {"k3", 30}}
        << VariantMap{{"k1", 1}, {"k2", 20}};
    QTest::newRow("empty receiver gains nothing")
        << VariantMap() << VariantMap{{"k", 1}} << VariantMap();
    QTest::newRow("empty source changes nothing")
        << VariantMap{{"k", 1}} << VariantMap() << VariantMap{{"k", 1}};
    QTest::newRow("value type follows the source")
        << VariantMap{{"k", 1}} << VariantMap{{"k", "one"}} << VariantMap{{"k", "one"}};
    QTest::newRow("invalid value is imported")
        << VariantMap{{"k", 1}} << VariantMap{{"k", QVariant()}} << VariantMap{{"k", QVariant()}};
    QTest::newRow("all keys")
        << VariantMap{{"a", 1}, {"b", 2}, {"c", 3}} << VariantMap{{"a", 10}, {"b", 20}, {"c", 30}}
        << VariantMap{{"a", 10}, {"b", 20}, {"c", 30}};
}

void ElementDataTest::importFrom()
{
    QFETCH(VariantMap, receiver);
    QFETCH(VariantMap, source);
    QFETCH(VariantMap, expected);

    ElementData a = record(receiver);
    const ElementData b = record(source);
    ElementData &result = a.importFrom(b);
    QCOMPARE(&result, &a);
    QCOMPARE(VariantMap(a), expected);
    QCOMPARE(VariantMap(b), source);
}

void ElementDataTest::importFromSelfAndSharedCopies()
{
    ElementData a = record({{"k1", 1}, {"k2", 2}});
    a.importFrom(a);
    QCOMPARE(VariantMap(a), (VariantMap{{"k1", 1}, {"k2", 2}}));

    // b starts as a shared copy of a: importing must not write through the
    // shared data into b, nor read a's values back into itself.
    ElementData b = a;
    b.insert(QStringLiteral("k2"), 20);
    b.insert(QStringLiteral("k3"), 30);
    a.importFrom(b);
    QCOMPARE(VariantMap(a), (VariantMap{{"k1", 1}, {"k2", 20}}));
    QCOMPARE(VariantMap(b), (VariantMap{{"k1", 1}, {"k2", 20}, {"k3", 30}}));

    ElementData c = a;
    c.importFrom(record({{"k1", 100}}));
    QCOMPARE(a.value(QStringLiteral("k1")).toInt(), 1);
    QCOMPARE(c.value(QStringLiteral("k1")).toInt(), 100);
}

void ElementDataTest::importLeavesTypedFields()
{
    ServiceLightElementData target;
    target.setState(true, QStringLiteral("running"));
    target.insert(QStringLiteral("name"), QStringLiteral("old"));

    ServiceLightElementData source;
    source.setState(false, QStringLiteral("dead"));
    source.setName(QStringLiteral("new"));

    target.importFrom(source);
    QCOMPARE(target.name(), QStringLiteral("new"));
    QCOMPARE(target.state(), true);
    QCOMPARE(target.textState(), QStringLiteral("running"));

    ChangeDisplayElementData display(4);
    display.setName(QStringLiteral("x"));
    display.importFrom(source);
    QCOMPARE(display.displayType(), 4);
    QCOMPARE(display.name(), QStringLiteral("new"));
}

void ElementDataTest::setState_data()
{
    QTest::addColumn<bool>("state");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("expectedText");

    QTest::newRow("running, no text") << true << QString() << "started";
    QTest::newRow("stopped, no text") << false << QString() << "stopped";
    QTest::newRow("stopped, own text") << false << "inactive (dead)" << "inactive (dead)";
    QTest::newRow("running, own text") << true << "active" << "active";
    QTest::newRow("blank is a text") << true << " " << " ";
}

void ElementDataTest::setState()
{
    QFETCH(bool, state);
    QFETCH(QString, text);
    QFETCH(QString, expectedText);

    ServiceLightElementData data;
    QCOMPARE(data.state(), false);
    QVERIFY(data.textState().isEmpty());
    // Start from the opposite state so a setter that ignores its argument
    // is caught.
    data.setState(!state, QStringLiteral("before"));
    data.setState(state, text);
    QCOMPARE(data.state(), state);
    QCOMPARE(data.textState(), expectedText);
    QVERIFY(data.isEmpty());
}

void ElementDataTest::changeDisplayCopies()
{
    QCOMPARE(ChangeDisplayElementData().displayType(), 0);

    ChangeDisplayElementData source(3);
    source.setName(QStringLiteral("variant"));
    QCOMPARE(source.displayType(), 3);

    const ChangeDisplayElementData copy(source);
    QCOMPARE(copy.displayType(), 3);
    QCOMPARE(copy.name(), QStringLiteral("variant"));

    ChangeDisplayElementData assigned(7);
    assigned.insert(QStringLiteral("stale"), true);
    assigned = source;
    QCOMPARE(assigned.displayType(), 3);
    QCOMPARE(VariantMap(assigned), VariantMap(source));

    source.setDisplayType(5);
    source.setName(QStringLiteral("changed"));
    QCOMPARE(copy.displayType(), 3);
    QCOMPARE(assigned.name(), QStringLiteral("variant"));
}

void ElementDataTest::serviceLightCopies()
{
    ServiceLightElementData source;
    source.setState(true, QString());
    source.setName(QStringLiteral("cron"));

    const ServiceLightElementData copy(source);
    QCOMPARE(copy.state(), true);
    QCOMPARE(copy.textState(), QStringLiteral("started"));
    QCOMPARE(copy.name(), QStringLiteral("cron"));

    ServiceLightElementData assigned;
    assigned.setState(false, QStringLiteral("x"));
    assigned.insert(QStringLiteral("stale"), 1);
    assigned = source;
    QCOMPARE(assigned.state(), true);
    QCOMPARE(assigned.textState(), QStringLiteral("started"));
    QCOMPARE(VariantMap(assigned), VariantMap(source));

    auto &self = assigned;
    assigned = self;
    QCOMPARE(assigned.textState(), QStringLiteral("started"));
    QCOMPARE(assigned.name(), QStringLiteral("cron"));
}

void ElementDataTest::heavyCopiesNeverShareNodes()
{
    int deaths = 0;
    {
        ServiceHeavyElementData source;
        source.setState(true, QStringLiteral("up"));
        source.setConfigFile(QStringLiteral("/etc/x.conf"));
        source.setConfigData(QStringLiteral("port = 1"));
        source.setName(QStringLiteral("x"));
        source.data() << detachedTree(QStringLiteral("s"), &deaths);

        ServiceHeavyElementData copy(source);
        QVERIFY(copy.data().isEmpty());
        QCOMPARE(copy.state(), true);
        QCOMPARE(copy.textState(), QStringLiteral("up"));
        QCOMPARE(copy.configFile(), QStringLiteral("/etc/x.conf"));
        QCOMPARE(copy.configData(), QStringLiteral("port = 1"));
        QCOMPARE(copy.name(), QStringLiteral("x"));

        // The target of an assignment keeps the nodes it owns.
        ServiceHeavyElementData target;
        TestTreeNode *kept = detachedTree(QStringLiteral("t"), &deaths);
        target.data() << kept;
        target = source;
        QCOMPARE(target.data(), QList<TreeNode *>{kept});
        QCOMPARE(target.configFile(), QStringLiteral("/etc/x.conf"));
        QCOMPARE(target.configData(), QStringLiteral("port = 1"));
        QCOMPARE(target.textState(), QStringLiteral("up"));

        target = target;
        QCOMPARE(target.data(), QList<TreeNode *>{kept});
        QCOMPARE(target.configFile(), QStringLiteral("/etc/x.conf"));
        QCOMPARE(deaths, 0);
    }
    QCOMPARE(deaths, 10);
}

void ElementDataTest::heavyDestroysEachNodeOnce_data()
{
    // Indexes into the nodes of one detached tree: 0 root, 1 a, 2 b, 3 a1,
    // 4 a2. Each case lists which of them the record holds.
    QTest::addColumn<QList<int>>("listed");
    QTest::addColumn<int>("expectedDeaths");

    QTest::newRow("empty") << QList<int>() << 0;
    QTest::newRow("root") << QList<int>{0} << 5;
    QTest::newRow("inner node only") << QList<int>{1} << 3;
    QTest::newRow("leaf only") << QList<int>{4} << 1;
    QTest::newRow("listed twice") << QList<int>{0, 0} << 5;
    QTest::newRow("ancestor first") << QList<int>{0, 3} << 5;
    QTest::newRow("descendant first") << QList<int>{3, 1, 0} << 5;
    QTest::newRow("siblings") << QList<int>{1, 2} << 4;
}

void ElementDataTest::heavyDestroysEachNodeOnce()
{
    QFETCH(QList<int>, listed);
    QFETCH(int, expectedDeaths);

    int deaths = 0;
    TestTreeNode *root = detachedTree(QStringLiteral("r"), &deaths);
    TreeNode *a = root->childNodes().at(0);
    const QList<TreeNode *> nodes{root, a, root->childNodes().at(1), a->childNodes().at(0),
                                  a->childNodes().at(1)};
    {
        ServiceHeavyElementData data;
        for (int index : listed)
            data.data() << nodes.at(index);
    }
    QCOMPARE(deaths, expectedDeaths);
    // What the record did not own still hangs beneath the root: freeing it
    // must reach every remaining node exactly once.
    if (!listed.contains(0)) {
        root->clearDeleteAll();
        delete root;
    }
    QCOMPARE(deaths, 5);
}

void ElementDataTest::configureHeavyCopyAsymmetry()
{
    ServiceConfigureHeavyElementData source;
    source.setState(true, QStringLiteral("on"));
    source.setName(QStringLiteral("svc"));
    source.scriptModeCommands() << QStringLiteral("start");
    source.headers() << QStringLiteral("Mode");
    source.descriptions() << QStringLiteral("The mode");
    source.tasks().insert(QStringLiteral("t"), QStringLiteral("task"));
    source.setUser(QStringLiteral("postgres"));
    source.setPassword(QStringLiteral("secret"));
    source.checkedItems() << QStringLiteral("a");
    source.uncheckedItems() << QStringLiteral("b");
    source.incompatibleModes() << QStringLiteral("c");

    auto checkAllButModes = [&source](ServiceConfigureHeavyElementData &d) {
        QCOMPARE(d.state(), true);
        QCOMPARE(d.textState(), QStringLiteral("on"));
        QCOMPARE(d.name(), QStringLiteral("svc"));
        QCOMPARE(d.scriptModeCommands(), source.scriptModeCommands());
        QCOMPARE(d.headers(), source.headers());
        QCOMPARE(d.descriptions(), source.descriptions());
        QCOMPARE(d.tasks(), source.tasks());
        QCOMPARE(d.user(), QStringLiteral("postgres"));
        QCOMPARE(d.password(), QStringLiteral("secret"));
        QCOMPARE(d.checkedItems(), source.checkedItems());
        QCOMPARE(d.uncheckedItems(), source.uncheckedItems());
    };

    ServiceConfigureHeavyElementData copy(source);
    checkAllButModes(copy);
    QVERIFY(copy.incompatibleModes().isEmpty());

    ServiceConfigureHeavyElementData assigned;
    assigned.incompatibleModes() << QStringLiteral("old");
    assigned = source;
    checkAllButModes(assigned);
    QCOMPARE(assigned.incompatibleModes(), QSet<QString>{QStringLiteral("c")});

    auto &self = assigned;
    assigned = self;
    checkAllButModes(assigned);
    QCOMPARE(assigned.incompatibleModes(), QSet<QString>{QStringLiteral("c")});

    // The accessors hand out the record's own containers.
    copy.checkedItems().clear();
    QVERIFY(copy.checkedItems().isEmpty());
    QCOMPARE(source.checkedItems().size(), 1);
}

void ElementDataTest::kindsThroughBasePointer()
{
    int deaths = 0;
    std::unique_ptr<ElementData> heavy(new ServiceHeavyElementData);
    static_cast<ServiceHeavyElementData *>(heavy.get())->data()
        << detachedTree(QStringLiteral("h"), &deaths);

    std::unique_ptr<ElementData> display(new ChangeDisplayElementData(2));
    QVERIFY(dynamic_cast<ChangeDisplayElementData *>(display.get()));
    QVERIFY(!dynamic_cast<ServiceLightElementData *>(display.get()));
    QVERIFY(dynamic_cast<ServiceLightElementData *>(heavy.get()));
    QVERIFY(!dynamic_cast<ServiceConfigureHeavyElementData *>(heavy.get()));

    heavy->configureParams();
    QVERIFY(heavy->isEmpty());
    heavy.reset();
    QCOMPARE(deaths, 5);
}

QTEST_GUILESS_MAIN(ElementDataTest)
#include "tst_elementdata.moc"
