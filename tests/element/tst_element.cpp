#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/containerelement.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/loginelement.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/serviceelement.h>
#include <kvt-common/servicelightelementdata.h>
#include <kvt-common/supplementelement.h>
#include <kvt-common/supplementloginmixin.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "signallog.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QAction>
#include <QDir>
#include <QFile>
#include <QIcon>
#include <QPixmap>
#include <QPointer>
#include <QTemporaryDir>
#include <QtTest>

#include <memory>

using Container = TestElement<ContainerElement>;
using Ordinary = TestElement<OrdinaryElement>;
using Supplement = TestElement<SupplementElement>;
using Login = TestElement<LoginElement>;
using Service = TestElement<ServiceElement>;

namespace {

const QList<OperationType> allOperations{
    InsertedOperation,     RemovedOperation, CreateOperation,      ReadContentOperation,
    ResetOperation,        ReadPropertyOperation, UpdateOperation, DeleteOperation,
    ChangeDisplayOperation, LoginExtraOperation1, LoginExtraOperation2, OperationType(0x100)};

// A container that lets its children switch the display, as a plugin's
// group element does by adding ChangeDisplayOperation to its offer.
class SwitchingContainer : public Container
{
public:
    using Container::Container;
    quint64 availableOperations() const override
    {
        return Container::availableOperations() | ChangeDisplayOperation;
    }
    QStringList displayChildrenVariants() const override { return {"list", "icons", "details"}; }
};

// A container that still needs loading but does not offer to read it.
class UnreadableContainer : public Container
{
public:
    using Container::Container;
    quint64 availableOperations() const override { return CreateOperation; }
};

ContextOperation::RightsPredicate rights(bool editable)
{
    return editable ? rightsYes : rightsNo;
}

Element *makeKind(const QString &kind, Module &module, bool editable, const QString &title)
{
    Element *e = nullptr;
    if (kind == "container")
        e = new Container(module, rights(editable), "group", title);
    else if (kind == "ordinary")
        e = new Ordinary(module, rights(editable), "user", title);
    else if (kind == "supplement")
        e = new Supplement(module, rights(editable), "extra", title);
    else if (kind == "login")
        e = new Login(module, rights(editable), "login", title);
    else if (kind == "service")
        e = new Service(module, rights(editable), "service", title);
    e->setParent(&module);
    return e;
}

} // namespace

class ElementTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();

    void freshElement();
    void setTitle_data();
    void setTitle();
    void groupElementType();
    void rootNode();
    void treeChangesNotifyModules_data();
    void treeChangesNotifyModules();
    void destructionNotifiesLiveModulesOnly();
    void offeredOperations_data();
    void offeredOperations();
    void forwardedOperations_data();
    void forwardedOperations();
    void containerChangeDisplay_data();
    void containerChangeDisplay();
    void ordinaryChangeDisplayGoesToParent();
    void lazyLoadingThroughModel();
    void fetchMoreNeedsReadContent();
    void resetConteinerElementRereads();
    void loginElementData();
    void serviceIcons_data();
    void serviceIcons();
    void supplementLoginMixin_data();
    void supplementLoginMixin();

private:
    std::unique_ptr<RecordingModule> module;
    bool themePresent = false;
    QTemporaryDir themeDir;
};

void ElementTest::initTestCase()
{
    // A small icon theme of our own, so that the service icons are found and
    // told apart by name; run with KVT_TEST_ICON_THEME=none to check that a
    // missing theme only gives null icons.
    if (qgetenv("KVT_TEST_ICON_THEME") == "none") {
        QIcon::setThemeSearchPaths({themeDir.path()});
        QIcon::setThemeName(QStringLiteral("kvt-missing"));
        return;
    }
    const QString base = themeDir.path() + QStringLiteral("/kvt-test");
    QVERIFY(QDir().mkpath(base + QStringLiteral("/16x16/actions")));
    QFile index(base + QStringLiteral("/index.theme"));
    QVERIFY(index.open(QIODevice::WriteOnly));
    index.write("[Icon Theme]\nName=kvt-test\nDirectories=16x16/actions\n\n"
                "[16x16/actions]\nSize=16\nType=Fixed\n");
    index.close();
    for (const char *name : {"media-playback-start", "media-playback-stop"}) {
        QPixmap pixmap(16, 16);
        pixmap.fill(Qt::red);
        QVERIFY(pixmap.save(base + QStringLiteral("/16x16/actions/%1.png").arg(QLatin1String(name))));
    }
    QIcon::setThemeSearchPaths({themeDir.path()});
    QIcon::setThemeName(QStringLiteral("kvt-test"));
    themePresent = true;
}

void ElementTest::init()
{
    module.reset(new RecordingModule(QStringLiteral("users")));
}

void ElementTest::cleanup()
{
    module.reset();
}

void ElementTest::freshElement()
{
    auto *e = new Ordinary(*module, nullptr, ContextOperation::undefinedElementType);
    e->setParent(module.get());
    QCOMPARE(e->elementType(), QStringLiteral("Undefined"));
    QCOMPARE(e->groupElementType(), QStringLiteral("Undefined"));
    QVERIFY(e->title().isEmpty());
    QCOMPARE(e->displayChildrenVariant(), 0);
    QVERIFY(e->displayChildrenVariants().isEmpty());
    QVERIFY(!e->requireLoad());
    QVERIFY(!e->elementData());
    QVERIFY(!e->isPersistent());
    QVERIFY(!e->isEditable());
    QCOMPARE(e->contextType(), ContextOperation::ElementContextType);
    QCOMPARE(e->elementContext(), static_cast<Element *>(e));
    QCOMPARE(&e->module(), static_cast<Module *>(module.get()));
    QCOMPARE(e->columnCount(), 1);
    QCOMPARE(e->questionForRemove(), QStringLiteral("Do you really want to remove this element?"));
    QVERIFY(!e->elementWidget(EditElementRole));
    QVERIFY(e->elementActions().isEmpty());

    QAction action(QStringLiteral("Lock"), nullptr);
    module->setElementActions(QStringLiteral("user"), {&action});
    auto *user = new Ordinary(*module, rightsYes, "user", "alice");
    user->setParent(module.get());
    QCOMPARE(user->elementActions(), QList<QAction *>{&action});
    QVERIFY(user->isEditable());

    // The item data of column 0 and the roles that answer in any column.
    QCOMPARE(user->data(0, Qt::DisplayRole).toString(), QStringLiteral("alice"));
    QCOMPARE(user->data(0, Qt::ToolTipRole).toString(), QStringLiteral("tip:alice"));
    QVERIFY(user->data(0, Qt::DecorationRole).value<QIcon>().isNull());
    QVERIFY(!user->data(1, Qt::DisplayRole).isValid());
    QCOMPARE(user->data(3, Qt::UserRole + 4).toString(), QStringLiteral("alice"));
    QCOMPARE(user->data(3, Qt::UserRole + 5).toString(), QStringLiteral("user"));
    QCOMPARE(user->data(3, Qt::UserRole + 6).toString(), QStringLiteral("Undefined"));
    QCOMPARE(user->data(0, Qt::UserRole + 2).toString(), QStringLiteral("user_alice"));
}

void ElementTest::setTitle_data()
{
    QTest::addColumn<bool>("persistent");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("expectedId");
    QTest::addColumn<QStringList>("expectedSignals");

    QTest::newRow("plain") << false << "alice" << "user_alice"
                           << QStringList{"nodeDataChanged(user_alice)"};
    QTest::newRow("placeholders are text") << false << "a%1b" << "user_a%1b"
                                           << QStringList{"nodeDataChanged(user_a%1b)"};
    QTest::newRow("empty") << false << "" << "user_" << QStringList{"nodeDataChanged(user_)"};
    QTest::newRow("persistent") << true << "alice" << "fixed" << QStringList();
}

void ElementTest::setTitle()
{
    QFETCH(bool, persistent);
    QFETCH(QString, title);
    QFETCH(QString, expectedId);
    QFETCH(QStringList, expectedSignals);

    Ordinary e(*module, rightsYes, "user");
    e.setId(QStringLiteral("fixed"));
    if (persistent)
        e.setExpected(1, QString());
    QCOMPARE(e.isPersistent(), persistent);
    SignalLog log;
    log.watchNode(&e);
    e.setTitle(title);
    QCOMPARE(e.id(), expectedId);
    QCOMPARE(e.title(), persistent ? QString() : title);
    QCOMPARE(log.take(), expectedSignals);
}

void ElementTest::groupElementType()
{
    ElementRootTreeNode root;
    Container group(*module, rightsYes, "group", "staff");
    group.setGroupType(QStringLiteral("users"));
    TestTreeNode between(QStringLiteral("between"));
    Container inner(*module, rightsYes, "group", "inner");
    Ordinary leaf(*module, rightsYes, "user", "alice");
    Ordinary own(*module, rightsYes, "user", "bob");
    own.setGroupType(QStringLiteral("admins"));
    root.append(&group);
    group.append(&between);
    between.append(&inner);
    inner.append(QList<TreeNode *>{&leaf, &own});

    // Inherited through any number of undefined elements and plain nodes.
    QCOMPARE(leaf.groupElementType(), QStringLiteral("users"));
    QCOMPARE(inner.groupElementType(), QStringLiteral("users"));
    QCOMPARE(own.groupElementType(), QStringLiteral("admins"));
    // The item role shows the element's own declaration only.
    QCOMPARE(leaf.data(0, Qt::UserRole + 6).toString(), QStringLiteral("Undefined"));

    group.removeOne(&between);
    QCOMPARE(leaf.groupElementType(), QStringLiteral("Undefined"));
    inner.clear();
}

void ElementTest::rootNode()
{
    ElementRootTreeNode root;
    QCOMPARE(root.expectedDepth(), 0);
    QVERIFY(root.id().isEmpty());
    QCOMPARE(root.columnCount(), 1);
    QCOMPARE(root.headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(), QStringLiteral("Name"));
    QVERIFY(!root.headerData(1, Qt::Horizontal, Qt::DisplayRole).isValid());
    QVERIFY(!root.headerData(0, Qt::Vertical, Qt::DisplayRole).isValid());
    QVERIFY(!root.headerData(0, Qt::Horizontal, Qt::ToolTipRole).isValid());
}

void ElementTest::treeChangesNotifyModules_data()
{
    // The parent starts with the elements a b c (ids user_a ...) and a plain
    // node p; the action is applied to it.
    QTest::addColumn<bool>("elementParent");
    QTest::addColumn<QString>("action");
    QTest::addColumn<QString>("expectedTree");
    QTest::addColumn<QStringList>("expectedLog");

    for (bool elementParent : {false, true}) {
        const char *kind = elementParent ? "element" : "root";
        auto row = [&](const char *name) {
            return &(QTest::addRow("%s: %s", kind, name) << elementParent);
        };
        *row("remove clamped") << "removeAt 1 10" << "user_a"
                               << QStringList{"Removed(user_b)", "Removed(user_c)"};
        *row("remove past the end") << "removeAt 4 1" << "user_a user_b user_c p" << QStringList();
        *row("remove plain node") << "removeAt 3 1" << "user_a user_b user_c" << QStringList();
        *row("remove nothing") << "removeAt 0 0" << "user_a user_b user_c p" << QStringList();
        *row("insert mixed") << "insert 1 d p2 e"
                             << "user_a user_d p2 user_e user_b user_c p"
                             << QStringList{"Inserted(user_d)", "Inserted(user_e)"};
        *row("insert repeated") << "insert 0 d d" << "user_d user_a user_b user_c p"
                                << QStringList{"Inserted(user_d)"};
        *row("clear") << "clear" << ""
                      << QStringList{"Removed(user_a)", "Removed(user_b)", "Removed(user_c)"};
        *row("move within") << "move c 0" << "user_c user_a user_b p"
                            << QStringList{"Removed(user_c)", "Inserted(user_c)"};
    }
}

void ElementTest::treeChangesNotifyModules()
{
    QFETCH(bool, elementParent);
    QFETCH(QString, action);
    QFETCH(QString, expectedTree);
    QFETCH(QStringList, expectedLog);

    QObject owner;
    std::unique_ptr<TreeNode> parent;
    if (elementParent)
        parent.reset(new Container(*module, rightsYes, "group", "top"));
    else
        parent.reset(new ElementRootTreeNode);
    QMap<QString, TreeNode *> nodes;
    for (const char *name : {"a", "b", "c", "d", "e"}) {
        auto *e = new Ordinary(*module, rightsYes, "user", QLatin1String(name));
        e->setParent(&owner);
        nodes.insert(QLatin1String(name), e);
    }
    for (const char *name : {"p", "p2"})
        nodes.insert(QLatin1String(name), new TestTreeNode(QLatin1String(name), &owner));
    parent->append(QList<TreeNode *>{nodes["a"], nodes["b"], nodes["c"], nodes["p"]});
    QCOMPARE(module->log, (QStringList{"Inserted(user_a)", "Inserted(user_b)", "Inserted(user_c)"}));
    module->log.clear();

    const QStringList words = action.split(' ');
    if (words[0] == "removeAt") {
        parent->removeAt(words[1].toInt(), words[2].toInt());
    } else if (words[0] == "insert") {
        QList<TreeNode *> list;
        for (const QString &name : words.mid(2))
            list.append(nodes[name]);
        parent->insert(words[1].toInt(), list);
    } else if (words[0] == "clear") {
        parent->clear();
    } else if (words[0] == "move") {
        parent->insert(words[2].toInt(), nodes[words[1]]);
    }
    QCOMPARE(TreeString::fromTree(parent.get()), expectedTree);
    QCOMPARE(module->log, expectedLog);
    QVERIFY(module->dataLog.count(nullptr) == module->dataLog.size());
    parent->clear();
}

void ElementTest::destructionNotifiesLiveModulesOnly()
{
    ElementRootTreeNode root;
    auto *group = new Container(*module, rightsYes, "group", "staff");
    auto *alice = new Ordinary(*module, rightsYes, "user", "alice");
    group->setParent(module.get());
    alice->setParent(module.get());
    root.append(group);
    group->append(alice);
    module->log.clear();

    // The module may still read the record of an element that goes.
    group->setElementData(new ElementData);
    group->elementData()->setName(QStringLiteral("staff data"));
    QString seenName;
    module->onOperation = [&seenName](ContextOperation *c, OperationType type, ElementData *) {
        if (type == RemovedOperation && c->elementContext()->elementData())
            seenName = c->elementContext()->elementData()->name();
    };
    delete group;
    QCOMPARE(module->log, (QStringList{"Removed(group_staff)", "Removed(user_alice)"}));
    QCOMPARE(seenName, QStringLiteral("staff data"));
    QVERIFY(!alice->parentNode());
    QCOMPARE(root.childNodesCount(), 0);

    // Elements owned by their module outlive its destructor while they are
    // still in an element tree: their removal must not call into it.
    auto *bob = new Ordinary(*module, rightsYes, "user", "bob");
    bob->setParent(module.get());
    root.append(QList<TreeNode *>{alice, bob});
    QPointer<Element> watch(bob);
    module.reset();
    QVERIFY(!watch);
    QCOMPARE(root.childNodesCount(), 0);

    // A module made later at the same address is a live one again.
    module.reset(new RecordingModule(QStringLiteral("first")));
    RecordingModule *place = module.release();
    place->~RecordingModule();
    module.reset(new (place) RecordingModule(QStringLiteral("again")));
    Ordinary carol(*module, rightsYes, "user", "carol");
    root.append(&carol);
    QCOMPARE(module->log, QStringList{"Inserted(user_carol)"});
    root.clear();
}

void ElementTest::offeredOperations_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<bool>("editable");
    QTest::addColumn<bool>("persistent");
    QTest::addColumn<bool>("switchingParent");
    QTest::addColumn<quint64>("expected");

    QTest::newRow("container, editable") << "container" << true << false << false << quint64(12);
    QTest::newRow("container, read only") << "container" << false << false << false << quint64(8);
    QTest::newRow("ordinary, editable") << "ordinary" << true << false << false << quint64(228);
    QTest::newRow("ordinary, read only") << "ordinary" << false << false << false << quint64(32);
    QTest::newRow("ordinary, persistent") << "ordinary" << true << true << false << quint64(96);
    QTest::newRow("ordinary, persistent read only") << "ordinary" << false << true << false << quint64(32);
    QTest::newRow("ordinary, switching parent") << "ordinary" << true << false << true << quint64(228 | 2048);
    QTest::newRow("ordinary, switching parent, read only") << "ordinary" << false << false << true << quint64(32 | 2048);
    QTest::newRow("ordinary, persistent, switching") << "ordinary" << true << true << true << quint64(96 | 2048);
    QTest::newRow("supplement, editable") << "supplement" << true << false << false << quint64(96);
    QTest::newRow("supplement, read only") << "supplement" << false << false << false << quint64(32);
    QTest::newRow("supplement, switching parent") << "supplement" << true << false << true << quint64(96);
    QTest::newRow("login, editable") << "login" << true << false << false << quint64(393256);
    QTest::newRow("login, read only") << "login" << false << false << false << quint64(393256);
    QTest::newRow("service") << "service" << true << false << false << quint64(0);
    QTest::newRow("container, switching parent") << "container" << true << false << true << quint64(12);
}

void ElementTest::offeredOperations()
{
    QFETCH(QString, kind);
    QFETCH(bool, editable);
    QFETCH(bool, persistent);
    QFETCH(bool, switchingParent);
    QFETCH(quint64, expected);

    SwitchingContainer switching(*module, rightsNo, "group", "switching");
    Container plain(*module, rightsNo, "group", "plain");
    Element *e = makeKind(kind, *module, editable, "x");
    if (persistent)
        static_cast<Ordinary *>(e)->setExpected(2, QStringLiteral("group_plain"));
    (switchingParent ? static_cast<TreeNode &>(switching) : plain).append(e);
    QCOMPARE(e->availableOperations(), expected);
    // Reached through the ContextOperation side as well.
    QCOMPARE(static_cast<ContextOperation *>(e)->availableOperations(), expected);
    switching.clear();
    plain.clear();
}

void ElementTest::forwardedOperations_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<bool>("editable");
    QTest::addColumn<QStringList>("expected");

    const QStringList container{"Create(group_x)", "ReadContent(group_x)"};
    const QStringList ordinary{"Create(user_x)", "ReadProperty(user_x)", "Update(user_x)",
                               "Delete(user_x)"};
    const QStringList login{"ReadContent(login_x)", "ReadProperty(login_x)",
                            "LoginExtra1(login_x)", "LoginExtra2(login_x)"};
    // The offer is advisory: rights do not change what is forwarded.
    for (bool editable : {true, false}) {
        const char *rights = editable ? "editable" : "read only";
        QTest::addRow("container, %s", rights) << "container" << editable << container;
        QTest::addRow("ordinary, %s", rights) << "ordinary" << editable << ordinary;
        QTest::addRow("supplement, %s", rights)
            << "supplement" << editable << QStringList{"ReadProperty(extra_x)", "Update(extra_x)"};
        QTest::addRow("login, %s", rights) << "login" << editable << login;
        QTest::addRow("service, %s", rights) << "service" << editable << QStringList();
    }
}

void ElementTest::forwardedOperations()
{
    QFETCH(QString, kind);
    QFETCH(bool, editable);
    QFETCH(QStringList, expected);

    Element *e = makeKind(kind, *module, editable, "x");
    ElementData data;
    for (OperationType op : allOperations)
        static_cast<ContextOperation *>(e)->performOperation(op, &data, 7);
    QStringList expectedWithFlags;
    for (const QString &entry : expected)
        expectedWithFlags << entry + QStringLiteral(" flags=7");
    QCOMPARE(module->log, expectedWithFlags);
    for (ElementData *given : qAsConst(module->dataLog))
        QCOMPARE(given, &data);
}

void ElementTest::containerChangeDisplay_data()
{
    QTest::addColumn<QString>("record");
    QTest::addColumn<int>("expectedVariant");
    QTest::addColumn<QStringList>("expectedSignals");

    QTest::newRow("display data") << "display" << 3 << QStringList{"nodeChildsDataChanged(group_g)"};
    QTest::newRow("null") << "null" << 0 << QStringList();
    QTest::newRow("plain record") << "plain" << 0 << QStringList();
    QTest::newRow("service record") << "service" << 0 << QStringList();
}

void ElementTest::containerChangeDisplay()
{
    QFETCH(QString, record);
    QFETCH(int, expectedVariant);
    QFETCH(QStringList, expectedSignals);

    std::unique_ptr<ElementData> data;
    if (record == "display")
        data.reset(new ChangeDisplayElementData(3));
    else if (record == "plain")
        data.reset(new ElementData);
    else if (record == "service")
        data.reset(new ServiceLightElementData);
    if (data)
        data->insert(QStringLiteral("displayType"), 5); // a key is no display type

    Container group(*module, rightsYes, "group", "g");
    SignalLog log;
    log.watchNode(&group);
    group.performOperation(ChangeDisplayOperation, data.get(), 0);
    QCOMPARE(group.displayChildrenVariant(), expectedVariant);
    QCOMPARE(log.take(), expectedSignals);
    QVERIFY(module->log.isEmpty());
}

void ElementTest::ordinaryChangeDisplayGoesToParent()
{
    SwitchingContainer group(*module, rightsYes, "group", "g");
    Container plainGroup(*module, rightsYes, "group", "plain");
    Ordinary a(*module, rightsYes, "user", "a");
    Ordinary b(*module, rightsYes, "user", "b");
    Ordinary lone(*module, rightsYes, "user", "lone");
    group.append(QList<TreeNode *>{&a, &b});
    plainGroup.append(&lone);
    QCOMPARE(a.displayChildrenVariants(), (QStringList{"list", "icons", "details"}));
    QVERIFY(lone.displayChildrenVariants().isEmpty());

    SignalLog log;
    log.watchNode(&group);
    ChangeDisplayElementData details(2);
    a.performOperation(ChangeDisplayOperation, &details, 0);
    QCOMPARE(group.displayChildrenVariant(), 2);
    QCOMPARE(b.displayChildrenVariant(), 2);
    QCOMPARE(log.take(), QStringList{"nodeChildsDataChanged(group_g)"});

    // Nothing happens with another record, or under a parent that does not
    // switch the display.
    ElementData plain;
    b.performOperation(ChangeDisplayOperation, &plain, 0);
    b.performOperation(ChangeDisplayOperation, nullptr, 0);
    QCOMPARE(group.displayChildrenVariant(), 2);
    ChangeDisplayElementData icons(1);
    lone.performOperation(ChangeDisplayOperation, &icons, 0);
    QCOMPARE(plainGroup.displayChildrenVariant(), 0);
    QCOMPARE(lone.displayChildrenVariant(), 0);
    QVERIFY(log.take().isEmpty());
    QVERIFY(module->log.filter("ChangeDisplay").isEmpty());
    group.clear();
    plainGroup.clear();
}

void ElementTest::lazyLoadingThroughModel()
{
    ElementRootTreeNode root;
    auto *group = new Container(*module, rightsYes, "group", "staff");
    group->setParent(module.get());
    root.append(group);
    module->log.clear();

    // The module answers a read of the group's content by adding the users,
    // as a plugin's read task does when it is done.
    module->onOperation = [this](ContextOperation *c, OperationType type, ElementData *) {
        if (type != ReadContentOperation)
            return;
        Element *e = c->elementContext();
        for (const char *name : {"alice", "bob"}) {
            auto *user = new Ordinary(*module, rightsYes, "user", QLatin1String(name));
            user->setParent(e);
            e->append(user);
        }
    };

    TreeNodeModel model(&root);
    const QModelIndex groupIndex = model.index(0, 0);
    QVERIFY(model.canFetchMore(groupIndex));
    QVERIFY(model.hasChildren(groupIndex));
    QCOMPARE(model.rowCount(groupIndex), 0);
    // The tester walks the tree and may fetch on its own, as a view does.
    QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::QtTest);
    if (model.canFetchMore(groupIndex))
        model.fetchMore(groupIndex);
    QCOMPARE(module->log,
             (QStringList{"ReadContent(group_staff)", "Inserted(user_alice)", "Inserted(user_bob)"}));
    QCOMPARE(TreeString::fromModel(&model), QStringLiteral("staff[alice bob]"));
    QVERIFY(!model.canFetchMore(groupIndex));
    QVERIFY(!group->requireLoad());

    // A second fetch reads nothing.
    module->log.clear();
    model.fetchMore(groupIndex);
    QVERIFY(module->log.isEmpty());

    // Dropping the content and marking it to be read again fetches anew.
    group->clearDelete();
    QCOMPARE(module->log, (QStringList{"Removed(user_alice)", "Removed(user_bob)"}));
    QVERIFY(!model.canFetchMore(groupIndex));
    group->resetRequireLoad();
    QVERIFY(model.canFetchMore(groupIndex));
    module->log.clear();
    model.fetchMore(groupIndex);
    QCOMPARE(module->log,
             (QStringList{"ReadContent(group_staff)", "Inserted(user_alice)", "Inserted(user_bob)"}));
    QCOMPARE(TreeString::fromModel(&model), QStringLiteral("staff[alice bob]"));
    root.clear();
}

void ElementTest::fetchMoreNeedsReadContent()
{
    UnreadableContainer container(*module, rightsYes, "group", "g");
    QVERIFY(container.requireLoad());
    QVERIFY(!container.canFetchMore());
    container.fetchMore();
    QVERIFY(container.requireLoad());
    QVERIFY(module->log.isEmpty());

    // An element that offers reading its content but has nothing to load.
    Login login(*module, rightsYes, "login", "l");
    QVERIFY(!login.canFetchMore());
    login.fetchMore();
    QVERIFY(module->log.isEmpty());
}

void ElementTest::resetConteinerElementRereads()
{
    auto *group = new Container(*module, rightsYes, "group", "staff");
    auto *other = new Ordinary(*module, rightsYes, "user", "other");
    group->setParent(module.get());
    other->setParent(module.get());
    QPointer<Element> child = new Ordinary(*module, rightsYes, "user", "alice");
    QPointer<Element> grandChild = new Ordinary(*module, rightsYes, "user", "x");
    TestTreeNode otherChild(QStringLiteral("kept"));
    group->append(child.data());
    child->append(grandChild.data());
    other->append(&otherChild);
    module->elementNodesRef() << group << other;
    group->performOperation(ReadContentOperation, nullptr, 0);
    QVERIFY(!group->canFetchMore());

    module->resetConteinerElement();
    QVERIFY(!child);
    QVERIFY(grandChild); // the children's children are detached, not destroyed
    QVERIFY(!grandChild->parentNode());
    QCOMPARE(group->childNodesCount(), 0);
    QVERIFY(group->canFetchMore());
    QCOMPARE(other->childNodesCount(), 1);
    delete grandChild.data();
    other->clear();
}

void ElementTest::loginElementData()
{
    Login login(*module, nullptr, "login", "l");
    QVERIFY(login.elementData());
    QCOMPARE(login.elementData()->keys(), (QStringList{"isLogin", "user"}));
    QCOMPARE(login.elementData()->value("user").userType(), int(QMetaType::QString));
    QVERIFY(login.elementData()->value("user").toString().isEmpty());
    QCOMPARE(login.elementData()->value("isLogin"), QVariant(false));
    QCOMPARE(login.availableOperations(), quint64(393256));
}

void ElementTest::serviceIcons_data()
{
    QTest::addColumn<QString>("textState");
    QTest::addColumn<bool>("running");
    QTest::addColumn<QString>("expectedIcon");

    QTest::newRow("state unknown") << QString() << true << QString();
    QTest::newRow("running") << "active" << true << "media-playback-start";
    QTest::newRow("stopped") << "inactive" << false << "media-playback-stop";
    QTest::newRow("default text") << "default" << false << "media-playback-stop";
}

void ElementTest::serviceIcons()
{
    QFETCH(QString, textState);
    QFETCH(bool, running);
    QFETCH(QString, expectedIcon);

    Service service(*module, rightsYes, "service", "cron");
    auto *light = dynamic_cast<ServiceLightElementData *>(service.elementData());
    QVERIFY(light);
    QVERIFY(light->textState().isEmpty());
    if (textState == "default")
        light->setState(running);
    else if (!textState.isEmpty())
        light->setState(running, textState);

    const QIcon icon = service.data(0, Qt::DecorationRole).value<QIcon>();
    if (expectedIcon.isEmpty() || !themePresent) {
        QVERIFY(icon.isNull());
    } else {
        QVERIFY(!icon.isNull());
        QCOMPARE(icon.name(), expectedIcon);
    }
    QCOMPARE(ServiceElement::startIcon().isNull(), !themePresent);
    QCOMPARE(ServiceElement::stopIcon().isNull(), !themePresent);
    // The other columns and roles are the element's.
    QCOMPARE(service.data(0, Qt::DisplayRole).toString(), QStringLiteral("cron"));
    QVERIFY(!service.data(1, Qt::DecorationRole).isValid());

    // A record of another kind put in by a plugin shows the default icon.
    delete service.elementData();
    service.setElementData(new ElementData);
    QVERIFY(service.data(0, Qt::DecorationRole).value<QIcon>().isNull());
}

void ElementTest::supplementLoginMixin_data()
{
    QTest::addColumn<QString>("situation");
    QTest::addColumn<int>("flags");
    QTest::addColumn<int>("expected");

    QTest::newRow("no element") << "none" << 4 << 4;
    QTest::newRow("detached") << "detached" << 0 << 0;
    QTest::newRow("parent not an element") << "root" << 0 << 0;
    QTest::newRow("parent without data") << "nodata" << 0 << 0;
    QTest::newRow("parent not a login") << "false" << 0 << 1;
    QTest::newRow("parent not a login, other flags") << "false" << 4 << 5;
    QTest::newRow("parent without the key") << "nokey" << 0 << 1;
    QTest::newRow("parent is a login") << "true" << 0 << 0;
    QTest::newRow("parent is a login, flag already set") << "true" << 1 << 1;
}

void ElementTest::supplementLoginMixin()
{
    QFETCH(QString, situation);
    QFETCH(int, flags);
    QFETCH(int, expected);

    ElementRootTreeNode root;
    Login login(*module, rightsYes, "login", "l");
    Container noData(*module, rightsYes, "group", "g");
    Supplement extra(*module, rightsYes, "extra", "e");
    QCOMPARE(extra.treeNodeSpecialFlags(), 1);

    if (situation == "root")
        root.append(&extra);
    else if (situation == "nodata")
        noData.append(&extra);
    else if (situation != "none" && situation != "detached")
        login.append(&extra);
    if (situation == "true")
        login.elementData()->insert(QStringLiteral("isLogin"), true);
    if (situation == "nokey")
        login.elementData()->remove(QStringLiteral("isLogin"));

    const SupplementLoginMixin mixin(situation == "none" ? nullptr : &extra);
    QCOMPARE(mixin.treeNodeSpecialFlags(flags), expected);
    root.clear();
    login.clear();
    noData.clear();
}

QTEST_MAIN(ElementTest)
#include "tst_element.moc"
