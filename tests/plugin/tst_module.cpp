// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/elementdata.h>
#include <kvt-common/module.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QSettings>
#include <QtTest>

namespace {

// Module data as a plugin leaves it: an entry set, or removed (invalid value).
void setEntry(RecordingModule &module, const QString &key, const QVariant &value)
{
    if (value.isValid())
        module.moduleDataRef()->insert(key, value);
    else
        module.moduleDataRef()->remove(key);
}

// A module placed in the module tree where its plugin says.
struct PlacedModule : RecordingModule {
    PlacedModule(const QString &name, int depth, const QString &parentId, QObject *owner)
        : RecordingModule(name, owner, true)
    {
        _expectedDepth = depth;
        _expectedParentId = parentId;
    }
};

} // namespace

class ModuleTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init() { QSettings().clear(); }

    void moduleTreeThroughModel()
    {
        QObject owner;
        auto *users = new PlacedModule(QStringLiteral("users"), 1, QString(), &owner);
        auto *groups = new PlacedModule(QStringLiteral("groups"), 1, QString(), &owner);
        auto *quota = new PlacedModule(QStringLiteral("quota"), 2, QStringLiteral("users"), &owner);
        users->moduleDataRef()->insert(QStringLiteral("description"), QStringLiteral("Accounts"));
        ModuleRootTreeNode root;
        root.loadTreeFromList({quota, users, groups});

        TreeNodeModel model(&root);
        QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::QtTest);
        QCOMPARE(TreeString::fromModel(&model), QStringLiteral("groups users[quota]"));
        QStringList headers;
        for (int section = 0; section < 4; ++section)
            headers << model.headerData(section, Qt::Horizontal).toString();
        QCOMPARE(headers, (QStringList{"Name", "Reread", "Description", ""}));
        QCOMPARE(model.index(1, 1).data(Qt::ToolTipRole).toString() + '|' + model.index(1, 2).data(Qt::ToolTipRole).toString(),
                 QStringLiteral("Force reread mode|Accounts"));

        QSignalSpy changed(&model, SIGNAL(dataChanged(QModelIndex, QModelIndex, QVector<int>)));
        const QModelIndex check = model.index(1, 1);
        QVERIFY(model.setData(check, Qt::Unchecked, Qt::CheckStateRole));
        // A no-op announces nothing.
        QVERIFY(!model.setData(check, Qt::Unchecked, Qt::CheckStateRole));
        QCOMPARE(changed.count(), 1);
        root.clear();
        users->clear();
    }

    void rereadCheck_data()
    {
        // The entry before, the check state given, and the entry after; an
        // invalid one when the change must be refused.
        QTest::addColumn<QVariant>("before");
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<QVariant>("after");

        QTest::newRow("check") << QVariant(false) << QVariant(Qt::Checked) << QVariant(true);
        QTest::newRow("boolean true is not checked") << QVariant(true) << QVariant(true) << QVariant(false);
        QTest::newRow("no entry") << QVariant() << QVariant(Qt::Checked) << QVariant();
    }

    void rereadCheck()
    {
        QFETCH(QVariant, before);
        QFETCH(QVariant, value);
        QFETCH(QVariant, after);

        RecordingModule module(QStringLiteral("users"));
        setEntry(module, QStringLiteral("paranoid"), before);
        // The check state is given as a boolean, not as a Qt::CheckState.
        QCOMPARE(module.data(1, Qt::CheckStateRole), before);
        QCOMPARE(module.data(1, Qt::CheckStateRole).userType(), before.userType());
        QCOMPARE(bool(module.flags(1) & Qt::ItemIsUserCheckable), before.isValid());
        QCOMPARE(module.setData(1, value, Qt::CheckStateRole), after.isValid());
        QCOMPARE(module.getData(QStringLiteral("paranoid")), after);
        // Nothing is saved before the module goes.
        QVERIFY(QSettings().allKeys().isEmpty());
    }

    void settings()
    {
        {
            RecordingModule users(QStringLiteral("users"), nullptr, true);
            QVERIFY(users.setData(1, int(Qt::Unchecked), Qt::CheckStateRole));
        }
        // The key runs the group and the name together.
        QCOMPARE(QSettings().allKeys(), QStringList{"module/usersparanoid"});
        QCOMPARE(QSettings().value(QStringLiteral("module/usersparanoid")), QVariant(false));
        {
            // The stored value wins over the default the plugin gives.
            RecordingModule again(QStringLiteral("users"), nullptr, true);
            QCOMPARE(again.data(1, Qt::CheckStateRole), QVariant(false));
            QVERIFY(again.setData(1, int(Qt::Checked), Qt::CheckStateRole));
        }
        QCOMPARE(RecordingModule(QStringLiteral("users")).getData("paranoid"), QVariant(true));
        // What a settings file gives back at the next start is text.
        QSettings().setValue(QStringLiteral("module/usersparanoid"), QStringLiteral("false"));
        QCOMPARE(RecordingModule(QStringLiteral("users"), nullptr, true).getData("paranoid"), QVariant(false));
    }

    void rightsFromHierarchy_data()
    {
        // The entries of grandparent and parent (invalid: none; the module
        // has none), and whether the parent is a module or a plain node.
        QTest::addColumn<QVariant>("grandparent");
        QTest::addColumn<QVariant>("parent");
        QTest::addColumn<bool>("parentIsModule");
        QTest::addColumn<bool>("expected");

        const QVariant none, yes(true), no(false);
        QTest::newRow("from grandparent") << yes << none << true << true;
        QTest::newRow("nearest wins") << yes << no << true << false;
        // Only a boolean true grants the right; any other value ends the search.
        QTest::newRow("text stops the search") << yes << QVariant("true") << true << false;
        QTest::newRow("plain node between") << yes << none << false << false;
    }

    void rightsFromHierarchy()
    {
        QFETCH(QVariant, grandparent);
        QFETCH(QVariant, parent);
        QFETCH(bool, parentIsModule);
        QFETCH(bool, expected);

        for (const QString key : {"administrator", "macAdministrator"}) {
            RecordingModule top(QStringLiteral("top")), middleModule(QStringLiteral("middle"));
            RecordingModule module(QStringLiteral("module"));
            TestTreeNode middleNode(QStringLiteral("middle"));
            TreeNode *middle = parentIsModule ? static_cast<TreeNode *>(&middleModule) : &middleNode;
            top.append(middle);
            middle->append(&module);
            setEntry(top, key, grandparent);
            setEntry(middleModule, key, parent);
            setEntry(module, key, QVariant());

            // Each check reads its own key only.
            QCOMPARE(Module::isAdministratorHierarchy(module), key == "administrator" && expected);
            QCOMPARE(Module::isMacAdministratorHierarchy(module), key == "macAdministrator" && expected);
            QVERIFY(Module::defaultTrue(module));
            middle->clear();
            top.clear();
        }
    }

    void performOperationReachesChildModules()
    {
        Module parent(QStringLiteral("parent"));
        RecordingModule a(QStringLiteral("a")), b(QStringLiteral("b")), aChild(QStringLiteral("aChild"));
        TestTreeNode plain(QStringLiteral("plain"));
        parent.append(QList<TreeNode *>{&a, &plain, &b});
        a.append(&aChild);
        // One module dropping a later sibling while it is told must not
        // break the walk.
        a.onOperation = [&parent, &b](ContextOperation *, OperationType, ElementData *) {
            parent.removeOne(&b);
        };
        ElementData data;
        parent.performOperation(nullptr, UpdateOperation, &data, 9);
        QCOMPARE(a.log + aChild.log + b.log, (QStringList{"Update(null) flags=9", "Update(null) flags=9",
                                                          "Update(null) flags=9"}));
        QCOMPARE(aChild.dataLog, QList<ElementData *>{&data});
        a.clear();
        parent.clear();
    }
};

QTEST_GUILESS_MAIN(ModuleTest)
#include "tst_module.moc"
