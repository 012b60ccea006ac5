// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/elementdata.h>
#include <kvt-common/serviceconfigureheavyelementdata.h>
#include <kvt-common/serviceheavyelementdata.h>
#include <kvt-common/servicelightelementdata.h>

#include "testtreenode.h"

#include <QtTest>

using VariantMap = QMap<QString, QVariant>;
Q_DECLARE_METATYPE(VariantMap)

namespace {

// A detached tree r[a[a1 a2] b], each node counting its destruction in
// *deaths; its nodes in the order r a b a1 a2.
QList<TreeNode *> detachedTree(int *deaths)
{
    QList<TreeNode *> nodes;
    for (const QString name : {"r", "a", "b", "a1", "a2"}) {
        auto *n = new TestTreeNode(name);
        n->destructionCount = deaths;
        nodes << n;
    }
    nodes[0]->append(QList<TreeNode *>{nodes[1], nodes[2]});
    nodes[1]->append(QList<TreeNode *>{nodes[3], nodes[4]});
    return nodes;
}

} // namespace

class ElementDataTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void importFrom_data()
    {
        // The source: a record of its own, a copy of the receiver changed
        // afterwards (shared data), or the receiver itself.
        QTest::addColumn<QString>("relation");
        QTest::newRow("own") << "own";
        QTest::newRow("changed copy") << "copy";
        QTest::newRow("itself") << "self";
    }

    void importFrom()
    {
        QFETCH(QString, relation);

        // Only keys the receiver has take the source's values; typed fields,
        // which live beside the map and not in it, are left alone.
        ServiceLightElementData a;
        a.setState(true, QStringLiteral("running"));
        a.insert(QStringLiteral("k1"), 1);
        a.insert(QStringLiteral("k2"), 2);
        ServiceLightElementData b = relation == "copy" ? a : ServiceLightElementData();
        b.setState(false, QStringLiteral("dead"));
        b.insert(QStringLiteral("k2"), 20);
        b.insert(QStringLiteral("k3"), 30);
        const VariantMap sourceBefore = b;
        QCOMPARE(&a.importFrom(relation == "self" ? a : b), &a);
        QCOMPARE(VariantMap(a), (VariantMap{{"k1", 1}, {"k2", relation == "self" ? 2 : 20}}));
        QCOMPARE(a.textState(), QStringLiteral("running"));
        // Shared data must not carry the import back into the source.
        QCOMPARE(VariantMap(b), sourceBefore);
    }

    void copiesCarryEveryField()
    {
        // The map and every typed field as one text.
        const auto fields = [](ServiceConfigureHeavyElementData &x) {
            QString text;
            QDebug(&text) << VariantMap(x) << x.state() << x.textState() << x.scriptModeCommands() << x.headers()
                          << x.descriptions() << x.tasks() << x.user() << x.password() << x.checkedItems()
                          << x.uncheckedItems();
            return text;
        };
        ServiceConfigureHeavyElementData configure, other;
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
        other.incompatibleModes() << QStringLiteral("old");
        ServiceConfigureHeavyElementData copy(configure);
        other = configure;
        ServiceConfigureHeavyElementData &self = other;
        other = self;
        QCOMPARE(fields(copy), fields(configure));
        QCOMPARE(fields(other), fields(configure));
        // A copy starts without incompatible modes; an assignment takes them.
        QVERIFY(copy.incompatibleModes().isEmpty());
        QCOMPARE(other.incompatibleModes(), QSet<QString>{QStringLiteral("c")});
    }

    void heavyDestroysEachNodeOnce_data()
    {
        // Which nodes of the detached tree the record holds.
        QTest::addColumn<QList<int>>("listed");
        QTest::addColumn<int>("expectedDeaths");

        QTest::newRow("inner node only") << QList<int>{1} << 3;
        QTest::newRow("listed twice") << QList<int>{0, 0} << 5;
        QTest::newRow("descendant first") << QList<int>{3, 1, 0} << 5;
    }

    void heavyDestroysEachNodeOnce()
    {
        QFETCH(QList<int>, listed);

        int deaths = 0;
        const QList<TreeNode *> nodes = detachedTree(&deaths);
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
        QTEST(deaths, "expectedDeaths");
        // What the record did not own still hangs beneath the root: freeing
        // it must reach every remaining node exactly once.
        if (!listed.contains(0)) {
            nodes[0]->clearDeleteAll();
            delete nodes[0];
        }
        QCOMPARE(deaths, 5);
    }
};

QTEST_GUILESS_MAIN(ElementDataTest)
#include "tst_elementdata.moc"
