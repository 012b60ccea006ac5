// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/containerelement.h>
#include <kvt-common/elementcontainer.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "signallog.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QSignalSpy>
#include <QtTest>

#include <memory>

namespace {

// An element as a plugin makes it, id "<type>_<title>": it offers
// ResetOperation and hands it to its module, and leaves the tree in its own
// destructor while it can still describe itself (views told of the removal
// may ask for a tool tip).
class Item : public TestElement<ContainerElement>
{
public:
    Item(RecordingModule &module, const QString &id, int depth, const QString &parentId = QString())
        : TestElement<ContainerElement>(module, rightsYes, id.section('_', 0, 0), id.section('_', 1))
    {
        setExpected(depth, parentId);
        setParent(&module);
        module.elementNodesRef().append(this);
    }
    ~Item() override { reset(); }
    quint64 availableOperations() const override { return ContainerElement::availableOperations() | ResetOperation; }
    void performOperation(OperationType type, ElementData *data, int flags) override
    {
        if (type == ResetOperation)
            _module.performOperation(this, type, data, flags);
    }
};

const QString fullTree = QStringLiteral("group_groups user_all[group_staff user_alice] user_guests");

} // namespace

class ElementContainerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<ModuleRootTreeNode> modulesRoot;
    RecordingModule *users = nullptr;
    RecordingModule *groups = nullptr;
    std::unique_ptr<ElementContainer> container;
    std::unique_ptr<QAbstractItemModelTester> tester;
    SignalLog *modelLog = nullptr;

private Q_SLOTS:
    void initTestCase() { qRegisterMetaType<TreeNode *>(); }

    void init()
    {
        // Modules as a plugin container hangs them: users, groups below users,
        // extras below groups (beyond the two levels gathered).
        modulesRoot.reset(new ModuleRootTreeNode);
        users = new RecordingModule("users", modulesRoot.get());
        groups = new RecordingModule("groups", modulesRoot.get());
        auto *extras = new RecordingModule("extras", modulesRoot.get());
        modulesRoot->append(users);
        users->append(groups);
        groups->append(extras);
        new Item(*users, "user_all", 1);
        new Item(*users, "user_alice", 2, "user_all");
        new Item(*users, "user_guests", 1);
        // A module hangs an element below another module's element.
        new Item(*groups, "group_staff", 2, "user_all");
        new Item(*groups, "group_groups", 1);
        new Item(*extras, "extra_hidden", 1);

        container.reset(new ElementContainer);
        tester.reset(new QAbstractItemModelTester(container->treeNodeModel(),
                                                  QAbstractItemModelTester::FailureReportingMode::QtTest));
        modelLog = new SignalLog(container.get());
        modelLog->watchModel(container->treeNodeModel());
    }

    void cleanup()
    {
        tester.reset();
        container.reset();
        modulesRoot.reset();
    }

    void gatherElements()
    {
        for (int pass = 0; pass < 2; ++pass) {
            users->log.clear();
            groups->log.clear();

            container->pluginContainerReset(modulesRoot.get());

            // The same tree every time, reaching views as one reset.
            QCOMPARE(TreeString::fromTree(container->rootNode()), fullTree);
            QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2), fullTree);
            QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
            // Only top-level elements get the reset, once each; groups hears
            // those of users too, handed down as modules do.
            QCOMPARE(users->log.filter("Reset("), QStringList({"Reset(user_all)", "Reset(user_guests)"}));
            QCOMPARE(groups->log.filter("Reset("),
                     QStringList({"Reset(group_groups)", "Reset(user_all)", "Reset(user_guests)"}));
        }

        // Without modules the tree stays as it is; only the model is reset.
        users->log.clear();
        container->pluginContainerReset(nullptr);
        QCOMPARE(TreeString::fromTree(container->rootNode()), fullTree);
        QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
        QVERIFY(users->log.isEmpty());
    }

    void requestsReachContainer()
    {
        container->pluginContainerReset(modulesRoot.get());
        TreeNode *alice = TreeString::find(container->rootNode(), "user_all/user_alice");
        QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
        QSignalSpy expanded(container.get(), SIGNAL(expandCurrentNode(TreeNode *)));

        // Asked below the top level, each heard once from the container.
        alice->emitSetCurrentNode();
        alice->emitExpandCurrentNode();

        QCOMPARE(current.count(), 1);
        QCOMPARE(current.at(0).at(0).value<TreeNode *>(), alice);
        QCOMPARE(expanded.count(), 1);
        QCOMPARE(expanded.at(0).at(0).value<TreeNode *>(), alice);
    }

    void modulesGoing()
    {
        container->pluginContainerReset(modulesRoot.get());

        // Unloading a plugin destroys its modules and their elements: the tree
        // and the model follow, nothing dangles.
        delete groups;
        const QString left = QStringLiteral("user_all[user_alice] user_guests");
        QCOMPARE(TreeString::fromTree(container->rootNode()), left);
        QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2), left);
        modulesRoot.reset();
        QCOMPARE(container->treeNodeModel()->rowCount(), 0);
    }
};

QTEST_MAIN(ElementContainerTest)
#include "tst_elementcontainer.moc"
