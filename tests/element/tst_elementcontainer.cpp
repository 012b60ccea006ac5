#include <kvt-common/containerelement.h>
#include <kvt-common/elementcontainer.h>
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

// Elements leave the tree in their own destructor, while they can still
// describe themselves: views told of the removal may ask for a tool tip.
template <class Kind>
class Leaving : public TestElement<Kind>
{
public:
    Leaving(Module &module, const QString &type, const QString &title, int depth, const QString &parentId)
        : TestElement<Kind>(module, rightsYes, type, title)
    {
        this->setExpected(depth, parentId);
        this->setParent(&module);
        static_cast<RecordingModule &>(module).elementNodesRef().append(this);
    }
    ~Leaving() override { this->reset(); }
};

using Item = Leaving<OrdinaryElement>;

// A top-level group that wants to hear when the tree is built: it offers
// ResetOperation and hands it to its module.
class Group : public Leaving<ContainerElement>
{
public:
    using Leaving<ContainerElement>::Leaving;
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

private Q_SLOTS:
    void initTestCase() { qRegisterMetaType<TreeNode *>(); }
    void init();
    void cleanup();

    void gatherElements();
    void requestsReachContainer_data();
    void requestsReachContainer();
    void modulesGoing();

private:
    std::unique_ptr<ModuleRootTreeNode> modulesRoot;
    RecordingModule *users = nullptr;
    RecordingModule *groups = nullptr;
    std::unique_ptr<ElementContainer> container;
    std::unique_ptr<QAbstractItemModelTester> tester;
    SignalLog *modelLog = nullptr;
};

void ElementContainerTest::init()
{
    // Modules as a plugin container hangs them: users, groups below users,
    // extras below groups (beyond the two levels gathered).
    modulesRoot.reset(new ModuleRootTreeNode);
    users = new RecordingModule(QStringLiteral("users"), modulesRoot.get());
    groups = new RecordingModule(QStringLiteral("groups"), modulesRoot.get());
    auto *extras = new RecordingModule(QStringLiteral("extras"), modulesRoot.get());
    modulesRoot->append(users);
    users->append(groups);
    groups->append(extras);

    new Group(*users, QStringLiteral("user"), QStringLiteral("all"), 1, QString());
    new Item(*users, QStringLiteral("user"), QStringLiteral("alice"), 2, QStringLiteral("user_all"));
    new Item(*users, QStringLiteral("user"), QStringLiteral("guests"), 1, QString());
    // A module hangs an element below another module's group.
    new Item(*groups, QStringLiteral("group"), QStringLiteral("staff"), 2, QStringLiteral("user_all"));
    new Group(*groups, QStringLiteral("group"), QStringLiteral("groups"), 1, QString());
    new Group(*extras, QStringLiteral("extra"), QStringLiteral("hidden"), 1, QString());

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
    for (int pass = 0; pass < 2; ++pass) {
        users->log.clear();
        groups->log.clear();

        container->pluginContainerReset(modulesRoot.get());

        // The same tree every time, reaching views as one reset.
        QCOMPARE(TreeString::fromTree(container->rootNode()), fullTree);
        QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2), fullTree);
        QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
        // Only top-level elements offering the reset get it, once each; the
        // second one groups hears is handed down by users, as modules do.
        QCOMPARE(users->log.filter("Reset("), QStringList({"Reset(user_all)"}));
        QCOMPARE(groups->log.filter("Reset("), QStringList({"Reset(group_groups)", "Reset(user_all)"}));
    }

    // Without modules the tree stays as it is; only the model is reset.
    users->log.clear();
    container->pluginContainerReset(nullptr);
    QCOMPARE(TreeString::fromTree(container->rootNode()), fullTree);
    QCOMPARE(modelLog->take(), QStringList({"aboutToReset", "reset"}));
    QVERIFY(users->log.isEmpty());
}

void ElementContainerTest::requestsReachContainer_data()
{
    QTest::addColumn<QString>("path");
    QTest::addColumn<bool>("expand");

    QTest::newRow("current, top level") << "user_guests" << false;
    QTest::newRow("current, three levels down") << "user_all/user_alice/x_deep" << false;
    QTest::newRow("expand, three levels down") << "user_all/user_alice/x_deep" << true;
}

void ElementContainerTest::requestsReachContainer()
{
    QFETCH(QString, path);
    QFETCH(bool, expand);
    container->pluginContainerReset(modulesRoot.get());
    auto *deep = new Item(*users, QStringLiteral("x"), QStringLiteral("deep"), -1, QString());
    TreeString::find(container->rootNode(), QStringLiteral("user_all/user_alice"))->append(deep);
    TreeNode *node = TreeString::find(container->rootNode(), path);
    QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
    QSignalSpy expanded(container.get(), SIGNAL(expandCurrentNode(TreeNode *)));

    expand ? node->emitExpandCurrentNode() : node->emitSetCurrentNode();

    QSignalSpy &heard = expand ? expanded : current;
    QCOMPARE(heard.count(), 1);
    QCOMPARE(heard.at(0).at(0).value<TreeNode *>(), node);
    QCOMPARE((expand ? current : expanded).count(), 0);
}

void ElementContainerTest::modulesGoing()
{
    container->pluginContainerReset(modulesRoot.get());

    // Unloading a plugin destroys its modules and their elements: the tree
    // and the model follow, nothing dangles.
    delete groups;
    QCOMPARE(TreeString::fromTree(container->rootNode()), QStringLiteral("user_all[user_alice] user_guests"));
    QCOMPARE(TreeString::fromModel(container->treeNodeModel(), QModelIndex(), Qt::UserRole + 2),
             QStringLiteral("user_all[user_alice] user_guests"));
    modulesRoot.reset();
    QCOMPARE(container->treeNodeModel()->rowCount(), 0);
}

QTEST_MAIN(ElementContainerTest)
#include "tst_elementcontainer.moc"
