#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/serviceconfigureheavyelementdata.h>
#include <kvt-common/serviceheavyelementdata.h>
#include <kvt-common/servicelightelementdata.h>

#include "testtreenode.h"

#include <QtTest>

using VariantMap = QMap<QString, QVariant>;
Q_DECLARE_METATYPE(VariantMap)

namespace {

// A tree of five nodes built detached, each counting its destruction in
// *deaths: the tree, not the QObject parent, is what a heavy record has to
// follow when it destroys its nodes.
TestTreeNode *detachedTree(const QString &id, int *deaths)
{
    auto node = [&](const char *suffix) {
        auto *n = new TestTreeNode(id + QLatin1String(suffix));
        n->destructionCount = deaths;
        return n;
    };
    TestTreeNode *root = node("");
    TestTreeNode *a = node(".a");
    root->append(QList<TreeNode *>{a, node(".b")});
    a->append(QList<TreeNode *>{node(".a1"), node(".a2")});
    return root;
}

// The map and every typed field of a record (the nodes of a heavy record
// aside) as one text, so that two records compare in one QCOMPARE.
QString fields(ElementData &d)
{
    QString text;
    QDebug out(&text);
    out << VariantMap(d);
    if (auto *x = dynamic_cast<ChangeDisplayElementData *>(&d))
        out << x->displayType();
    if (auto *x = dynamic_cast<ServiceLightElementData *>(&d))
        out << x->state() << x->textState();
    if (auto *x = dynamic_cast<ServiceHeavyElementData *>(&d))
        out << x->configFile() << x->configData();
    if (auto *x = dynamic_cast<ServiceConfigureHeavyElementData *>(&d))
        out << x->scriptModeCommands() << x->headers() << x->descriptions() << x->tasks()
            << x->user() << x->password() << x->checkedItems() << x->uncheckedItems();
    return text;
}

// A copy, an assignment over a record with other values, and an assignment
// to itself all end equal to source.
template <class Record>
void checkCopies(Record &source, Record &other)
{
    Record copy(source);
    QCOMPARE(fields(copy), fields(source));
    other = source;
    QCOMPARE(fields(other), fields(source));
    Record &self = other;
    other = self;
    QCOMPARE(fields(other), fields(source));
}

} // namespace

class ElementDataTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void importFrom_data()
    {
        // How the source relates to the receiver: a record of its own, a
        // copy of the receiver changed afterwards, or the receiver itself.
        QTest::addColumn<QString>("relation");
        QTest::addColumn<VariantMap>("receiver");
        QTest::addColumn<VariantMap>("source");
        QTest::addColumn<VariantMap>("expected");

        const VariantMap k12{{"k1", 1}, {"k2", 2}};
        QTest::newRow("overlap") << "own" << k12 << VariantMap{{"k2", 20}, {"k3", 30}}
                                 << VariantMap{{"k1", 1}, {"k2", 20}};
        QTest::newRow("value type follows the source")
            << "own" << VariantMap{{"k", 1}} << VariantMap{{"k", "one"}} << VariantMap{{"k", "one"}};
        QTest::newRow("invalid value is imported") << "own" << VariantMap{{"k", 1}}
                                                   << VariantMap{{"k", QVariant()}}
                                                   << VariantMap{{"k", QVariant()}};
        QTest::newRow("changed copy") << "copy" << k12 << VariantMap{{"k2", 20}, {"k3", 30}}
                                      << VariantMap{{"k1", 1}, {"k2", 20}};
        QTest::newRow("itself") << "self" << k12 << VariantMap() << k12;
    }

    void importFrom()
    {
        QFETCH(QString, relation);
        QFETCH(VariantMap, receiver);
        QFETCH(VariantMap, source);
        QFETCH(VariantMap, expected);

        // Records of a kind with typed fields: the import leaves them alone.
        ServiceLightElementData a;
        a.setState(true, QStringLiteral("running"));
        static_cast<VariantMap &>(a) = receiver;
        ServiceLightElementData b = relation == "copy" ? a : ServiceLightElementData();
        b.setState(false, QStringLiteral("dead"));
        for (auto it = source.cbegin(); it != source.cend(); ++it)
            b.insert(it.key(), it.value());
        const VariantMap sourceBefore = b;
        QCOMPARE(&a.importFrom(relation == "self" ? a : b), &a);
        QCOMPARE(VariantMap(a), expected);
        QCOMPARE(a.textState(), QStringLiteral("running"));
        // Shared data must not carry the import back into the source.
        QCOMPARE(VariantMap(b), sourceBefore);
    }

    void stateTexts()
    {
        // Without a text of its own, the state gives one.
        ServiceLightElementData data;
        data.setState(true);
        QCOMPARE(data.textState(), QStringLiteral("started"));
        data.setState(false);
        QCOMPARE(data.textState(), QStringLiteral("stopped"));
        data.setState(true, QStringLiteral(" "));
        QCOMPARE(data.textState(), QStringLiteral(" "));
        // The state lives beside the map, not in it.
        QVERIFY(data.isEmpty());
    }

    void copiesCarryEveryField()
    {
        ChangeDisplayElementData display(3), otherDisplay(7);
        display.setName(QStringLiteral("variant"));
        otherDisplay.insert(QStringLiteral("stale"), true);
        checkCopies(display, otherDisplay);

        ServiceHeavyElementData heavy, otherHeavy;
        heavy.setConfigFile(QStringLiteral("/etc/x.conf"));
        heavy.setConfigData(QStringLiteral("port = 1"));
        checkCopies(heavy, otherHeavy);

        ServiceConfigureHeavyElementData configure, otherConfigure;
        configure.setState(true, QStringLiteral("on"));
        configure.setName(QStringLiteral("svc"));
        configure.scriptModeCommands() << QStringLiteral("start");
        configure.headers() << QStringLiteral("Mode");
        configure.descriptions() << QStringLiteral("The mode");
        configure.tasks().insert(QStringLiteral("t"), QStringLiteral("task"));
        configure.setUser(QStringLiteral("postgres"));
        configure.setPassword(QStringLiteral("secret"));
        configure.checkedItems() << QStringLiteral("a");
        configure.uncheckedItems() << QStringLiteral("b");
        configure.incompatibleModes() << QStringLiteral("c");
        otherConfigure.incompatibleModes() << QStringLiteral("old");
        checkCopies(configure, otherConfigure);
        // A copy starts without incompatible modes; an assignment takes them.
        QVERIFY(ServiceConfigureHeavyElementData(configure).incompatibleModes().isEmpty());
        QCOMPARE(otherConfigure.incompatibleModes(), QSet<QString>{QStringLiteral("c")});
    }

    void heavyDestroysEachNodeOnce_data()
    {
        // Indexes into the nodes of one detached tree: 0 root, 1 a, 2 b,
        // 3 a1, 4 a2. Each case lists which of them the record holds.
        QTest::addColumn<QList<int>>("listed");
        QTest::addColumn<int>("expectedDeaths");

        QTest::newRow("inner node only") << QList<int>{1} << 3;
        QTest::newRow("listed twice") << QList<int>{0, 0} << 5;
        QTest::newRow("descendant first") << QList<int>{3, 1, 0} << 5;
        QTest::newRow("siblings") << QList<int>{1, 2} << 4;
    }

    void heavyDestroysEachNodeOnce()
    {
        QFETCH(QList<int>, listed);
        QFETCH(int, expectedDeaths);

        int deaths = 0;
        TestTreeNode *root = detachedTree(QStringLiteral("r"), &deaths);
        TreeNode *a = root->childNodes().at(0);
        const QList<TreeNode *> nodes{root, a, root->childNodes().at(1), a->childNodes().at(0),
                                      a->childNodes().at(1)};
        auto *heavy = new ServiceHeavyElementData;
        for (int index : listed)
            heavy->data() << nodes.at(index);
        int keptDeaths = 0;
        {
            // Copies never take the nodes; the target of an assignment keeps
            // its own.
            ServiceHeavyElementData copy(*heavy), target;
            auto *kept = new TestTreeNode(QStringLiteral("kept"));
            kept->destructionCount = &keptDeaths;
            target.data() << kept;
            target = *heavy;
            QVERIFY(copy.data().isEmpty());
            QCOMPARE(target.data(), QList<TreeNode *>{kept});
        }
        QCOMPARE(deaths, 0);
        QCOMPARE(keptDeaths, 1);
        // Destroyed through the base class, as the element that owns it does.
        delete static_cast<ElementData *>(heavy);
        QCOMPARE(deaths, expectedDeaths);
        // What the record did not own still hangs beneath the root: freeing
        // it must reach every remaining node exactly once.
        if (!listed.contains(0)) {
            root->clearDeleteAll();
            delete root;
        }
        QCOMPARE(deaths, 5);
    }
};

QTEST_GUILESS_MAIN(ElementDataTest)
#include "tst_elementdata.moc"
