#include <kvt-common/containerelement.h>
#include <kvt-common/elementcontainer.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "signallog.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QSignalSpy>
#include <QtTest>

#include <memory>

namespace {

// A top-level group that a module wants to hear about once the tree is
// built: it offers ResetOperation and hands it to its module.
class ResettableElement : public TestElement<ContainerElement>
{
public:
    using TestElement<ContainerElement>::TestElement;
    // Leaves the tree while it can still describe itself: views asked about
    // the removed row may want its tool tip.
    ~ResettableElement() override { reset(); }

    quint64 availableOperations() const override
    {
        return ContainerElement::availableOperations() | ResetOperation;
    }
    void performOperation(OperationType type, ElementData *data, int flags) override
    {
        if (type == ResetOperation)
            _module.performOperation(this, type, data, flags);
        else
            ContainerElement::performOperation(type, data, flags);
    }
};

class Item : public TestElement<OrdinaryElement>
{
public:
    using TestElement<OrdinaryElement>::TestElement;
    ~Item() override { reset(); }
};

QStringList resetsIn(const QStringList &log)
{
    return log.filter(QStringLiteral("Reset("));
}

} // namespace

class ElementContainerTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();

    void gatherElements();
    void nullModulesRoot();
    void resetAgain();
    void requestsReachContainer_data();
    void requestsReachContainer();
    void modulesGoing();

private:
    // Three modules as a plugin container hangs them:
    //   users (depth 1)
    //     groups (depth 2, below users)
    //       extras (depth 3, below groups: beyond the two levels gathered)
    void buildModules();

    std::unique_ptr<ModuleRootTreeNode> modulesRoot;
    RecordingModule *users = nullptr;
    RecordingModule *groups = nullptr;
    RecordingModule *extras = nullptr;
    std::unique_ptr<ElementContainer> container;
    std::unique_ptr<QAbstractItemModelTester> tester;
    SignalLog *modelLog = nullptr;
};

void ElementContainerTest::buildModules()
{
    modulesRoot.reset(new ModuleRootTreeNode);
    users = new RecordingModule(QStringLiteral("users"), modulesRoot.get());
    groups = new RecordingModule(QStringLiteral("groups"), modulesRoot.get());
    extras = new RecordingModule(QStringLiteral("extras"), modulesRoot.get());
    modulesRoot->append(users);
    users->append(groups);
    groups->append(extras);

    // users: a resettable top-level group "all" with one user below it, and
    // a plain top-level element "guests" that offers no reset.
    auto *all = new ResettableElement(*users, rightsYes, QStringLiteral("user"), QStringLiteral("all"));
    all->setExpected(1, QString());
    auto *alice = new Item(*users, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
    alice->setExpected(2, QStringLiteral("user_all"));
    auto *guests = new Item(*users, rightsYes, QStringLiteral("user"), QStringLiteral("guests"));
    guests->setExpected(1, QString());
    users->elementNodesRef() << all << alice << guests;

    // groups: hangs one element below the other module's group, and has a
    // resettable group of its own.
    auto *staff = new Item(*groups, rightsYes, QStringLiteral("group"), QStringLiteral("staff"));
    staff->setExpected(2, QStringLiteral("user_all"));
    auto *groupRoot = new ResettableElement(*groups, rightsYes, QStringLiteral("group"), QStringLiteral("groups"));
    groupRoot->setExpected(1, QString());
    groups->elementNodesRef() << staff << groupRoot;

    auto *hidden = new ResettableElement(*extras, rightsYes, QStringLiteral("extra"), QStringLiteral("hidden"));
    hidden->setExpected(1, QString());
    extras->elementNodesRef() << hidden;

    for (RecordingModule *module : {users, groups, extras}) {
        for (TreeNode *node : module->elementNodesRef())
            node->setParent(module);
    }
}

void ElementContainerTest::initTestCase()
{
    qRegisterMetaType<TreeNode *>();
}

void ElementContainerTest::init()
{
    buildModules();
    container.reset(new ElementContainer);
    tester.reset(new QAbstractItemModelTester(container->treeNodeModel(),
                                              QAbstractItemModelTester::FailureReportingMode::QtTest));
    modelLog = new SignalLog(container.get());
    modelLog->watchModel(container->treeNodeModel());
}

void ElementContainerTest::cleanup()
{
    tester.reset();
    container.reset();
    modulesRoot.reset();
}

void ElementContainerTest::gatherElements()
{
    QVERIFY(qobject_cast<ElementRootTreeNode *>(container->rootNode()));
    QCOMPARE(container->rootNode()->parent(), container.get());

    container->pluginContainerReset(modulesRoot.get());

    // Elements of two modules share the group "all"; the module three
    // levels down is not reached.
    QCOMPARE(TreeString::fromTree(container->rootNode()),
             QStringLiteral("group_groups user_all[group_staff user_alice] user_guests"));
    QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2),
             QStringLiteral("group_groups user_all[group_staff user_alice] user_guests"));
    // The rebuild reaches views as one reset, not as row moves.
    QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
    // Only the top-level elements offering the reset get it, each once and
    // after the whole tree is there.
    QCOMPARE(resetsIn(users->log), QStringList({"Reset(user_all)"}));
    // The second one is handed down by users, as a module does with every
    // operation.
    QCOMPARE(resetsIn(groups->log), QStringList({"Reset(group_groups)", "Reset(user_all)"}));
    QVERIFY(!extras->log.contains(QStringLiteral("Reset(extra_hidden)")));
}

void ElementContainerTest::nullModulesRoot()
{
    container->pluginContainerReset(modulesRoot.get());
    modelLog->take();
    users->log.clear();
    groups->log.clear();

    container->pluginContainerReset(nullptr);

    QCOMPARE(TreeString::fromTree(container->rootNode()),
             QStringLiteral("group_groups user_all[group_staff user_alice] user_guests"));
    QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
    QVERIFY(users->log.isEmpty());
    QVERIFY(groups->log.isEmpty());
}

void ElementContainerTest::resetAgain()
{
    container->pluginContainerReset(modulesRoot.get());
    modelLog->take();
    users->log.clear();

    // As after every reload: the same modules again give the same tree,
    // with nothing doubled, and one more reset for the modules.
    container->pluginContainerReset(modulesRoot.get());

    QCOMPARE(TreeString::fromTree(container->rootNode()),
             QStringLiteral("group_groups user_all[group_staff user_alice] user_guests"));
    QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
    QCOMPARE(resetsIn(users->log), QStringList({"Reset(user_all)"}));
}

void ElementContainerTest::requestsReachContainer_data()
{
    QTest::addColumn<QString>("path");
    QTest::addColumn<bool>("expand");

    QTest::newRow("current, top level") << "user_guests" << false;
    QTest::newRow("current, three levels down") << "user_all/user_alice/deep" << false;
    QTest::newRow("expand, three levels down") << "user_all/user_alice/deep" << true;
}

void ElementContainerTest::requestsReachContainer()
{
    QFETCH(QString, path);
    QFETCH(bool, expand);

    auto *deep = new Item(*users, rightsYes, QStringLiteral("x"), QStringLiteral("y"));
    deep->setParent(users);
    deep->setId(QStringLiteral("deep"));
    container->pluginContainerReset(modulesRoot.get());
    TreeString::find(container->rootNode(), QStringLiteral("user_all/user_alice"))->append(deep);

    TreeNode *node = TreeString::find(container->rootNode(), path);
    QVERIFY(node);
    QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
    QSignalSpy expanded(container.get(), SIGNAL(expandCurrentNode(TreeNode *)));

    if (expand)
        node->emitExpandCurrentNode();
    else
        node->emitSetCurrentNode();

    QSignalSpy &heard = expand ? expanded : current;
    QCOMPARE(heard.count(), 1);
    QCOMPARE(heard.at(0).at(0).value<TreeNode *>(), node);
    QCOMPARE((expand ? current : expanded).count(), 0);
}

void ElementContainerTest::modulesGoing()
{
    container->pluginContainerReset(modulesRoot.get());
    modelLog->take();

    // Unloading a plugin destroys its modules and, with them, their
    // elements: the tree and the model follow, nothing dangles.
    delete groups;
    groups = nullptr;
    QCOMPARE(TreeString::fromTree(container->rootNode()), QStringLiteral("user_all[user_alice] user_guests"));
    QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2),
             QStringLiteral("user_all[user_alice] user_guests"));

    modulesRoot.reset();
    QCOMPARE(TreeString::fromTree(container->rootNode()), QString());
    QCOMPARE(container->treeNodeModel()->rowCount(), 0);
}

QTEST_MAIN(ElementContainerTest)
#include "tst_elementcontainer.moc"
