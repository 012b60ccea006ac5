// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/acceptormodule.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/supplementmodule.h>

#include "recordingmodule.h"

#include <QtTest>

using User = TestElement<OrdinaryElement>;

class AcceptorSupplementTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void noForceReread()
    {
        RecordingModule donor("users");
        AcceptorModule acceptor("quotas", 2, "users", QString());
        SupplementModule supplement("quotas", 2, "users", QString(), "user", &donor);
        for (Module *module : {static_cast<Module *>(&acceptor), static_cast<Module *>(&supplement)}) {
            // The "Reread" column is empty and cannot be ticked.
            QVERIFY(!module->data(1, Qt::CheckStateRole).isValid());
            QVERIFY(!(module->flags(1) & Qt::ItemIsUserCheckable));
            QVERIFY(!module->setData(1, Qt::Checked, Qt::CheckStateRole));
        }
    }

    void elementFromDonor_data()
    {
        QTest::addColumn<QString>("placement");
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("expected");

        QTest::newRow("below the donor") << "donor" << "user_alice" << "user_alice";
        QTest::newRow("a node of the donor that is no element") << "donor" << "plain" << "";
        QTest::newRow("below the module root") << "root" << "user_alice" << "";
    }

    void elementFromDonor()
    {
        QFETCH(QString, placement);
        QFETCH(QString, name);

        ModuleRootTreeNode root;
        RecordingModule donor("users");
        User alice(donor, rightsYes, "user", "alice");
        TreeNode plain;
        plain.setId("plain");
        donor.elementNodesRef() << &plain << &alice;
        root.append(&donor);
        AcceptorModule acceptor("quotas", 2, "users", QString());
        (placement == QLatin1String("donor") ? static_cast<TreeNode &>(donor) : root).append(&acceptor);

        Element *element = acceptor.elementFromDonor(name);

        QTEST(element ? element->id() : QString(), "expected");
        root.clear();
        donor.clear();
    }

    void supplementPassesInsertions_data()
    {
        QTest::addColumn<int>("context"); // user, group
        QTest::addColumn<int>("operation");
        QTest::addColumn<QStringList>("donorLog");

        QTest::newRow("insertion of a user")
            << 0 << int(InsertedOperation) << QStringList{"Inserted(user_alice) flags=7"};
        QTest::newRow("insertion of a group") << 1 << int(InsertedOperation) << QStringList();
        QTest::newRow("removal of a user") << 0 << int(RemovedOperation) << QStringList();
    }

    void supplementPassesInsertions()
    {
        QFETCH(int, context);
        QFETCH(int, operation);
        QFETCH(QStringList, donorLog);

        RecordingModule donor("users");
        SupplementModule supplement("mail", 2, "users", QString(), "user", &donor);
        // A module below the supplement hears nothing: operations stop there.
        RecordingModule below("below");
        supplement.append(&below);
        User user(supplement, rightsYes, "user", "alice");
        User group(supplement, rightsYes, "group", "staff");
        ContextOperation *contexts[] = {&user, &group};
        ElementData data;

        supplement.performOperation(contexts[context], OperationType(operation), &data, 7);

        QCOMPARE(donor.log, donorLog);
        // The record is passed on as it is.
        QCOMPARE(donor.dataLog, donorLog.isEmpty() ? QList<ElementData *>() : QList<ElementData *>{&data});
        QVERIFY(below.log.isEmpty());
        supplement.clear();
    }
};

QTEST_MAIN(AcceptorSupplementTest)
#include "tst_acceptorsupplement.moc"
