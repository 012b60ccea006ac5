#include <kvt-common/containerelement.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/module.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QSettings>
#include <QtTest>

#include <dlfcn.h>
#include <unistd.h>

#include <memory>

using VariantMap = QMap<QString, QVariant>;
Q_DECLARE_METATYPE(VariantMap)

namespace {

// Module data as a plugin leaves it: the given entries replace or remove
// (an invalid value) those the constructor made.
void setModuleData(RecordingModule &module, const VariantMap &entries)
{
    for (auto it = entries.cbegin(); it != entries.cend(); ++it) {
        if (it.value().isValid())
            module.moduleDataRef()->insert(it.key(), it.value());
        else
            module.moduleDataRef()->remove(it.key());
    }
}

QVariant storedSetting(const QString &key)
{
    QSettings settings;
    return settings.value(key);
}

} // namespace

class ModuleTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();

    void rootNode();
    void construction();
    void columns_data();
    void columns();
    void setData_data();
    void setData();
    void checkThroughModel();
    void settingsRoundTrip();
    void storedSettingOverridesDefault_data();
    void storedSettingOverridesDefault();
    void noParanoidEntryNoSetting();
    void getData();
    void rightsFromHierarchy_data();
    void rightsFromHierarchy();
    void elementLookup();
    void performOperationReachesChildModules();
    void isAdministratorWithoutHostLibrary();
};

void ModuleTest::initTestCase()
{
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-tests"));
    QCoreApplication::setApplicationName(QStringLiteral("tst_module"));
}

void ModuleTest::init()
{
    QSettings().clear();
}

void ModuleTest::rootNode()
{
    ModuleRootTreeNode root;
    QCOMPARE(root.expectedDepth(), 0);
    QVERIFY(root.id().isEmpty());
    QCOMPARE(root.columnCount(), 3);
    QStringList headers;
    for (int section = 0; section < 4; ++section)
        headers << root.headerData(section, Qt::Horizontal, Qt::DisplayRole).toString();
    QCOMPARE(headers, (QStringList{"Name", "Reread", "Description", ""}));
    QVERIFY(!root.headerData(0, Qt::Vertical, Qt::DisplayRole).isValid());
    QVERIFY(!root.headerData(0, Qt::Horizontal, Qt::ToolTipRole).isValid());

    // Modules of depth 1 without an expected parent hang below it; a
    // module naming another as parent hangs below that one.
    QObject owner;
    struct Expecting : Module {
        Expecting(const QString &name, int depth, const QString &parentId, QObject *parent)
            : Module(name, parent)
        {
            _expectedDepth = depth;
            _expectedParentId = parentId;
        }
    };
    auto *top1 = new Expecting(QStringLiteral("users"), 1, QString(), &owner);
    auto *top2 = new Expecting(QStringLiteral("groups"), 1, QString(), &owner);
    auto *sub = new Expecting(QStringLiteral("quota"), 2, QStringLiteral("users"), &owner);
    root.loadTreeFromList({sub, top1, top2});
    QCOMPARE(TreeString::fromTree(&root), QStringLiteral("groups users[quota]"));
    root.clear();
    top1->clear();
}

void ModuleTest::construction()
{
    RecordingModule module(QStringLiteral("users"), nullptr, true);
    QCOMPARE(module.id(), QStringLiteral("users"));
    QVERIFY(!module.parentNode());
    QCOMPARE(module.expectedDepth(), -1);
    QVERIFY(module.moduleData());
    QCOMPARE(module.moduleData()->keys(), (QStringList{"name", "paranoid"}));
    QCOMPARE(module.getData(QStringLiteral("name")).toString(), QStringLiteral("users"));
    QCOMPARE(module.getData(QStringLiteral("paranoid")), QVariant(true));
    QVERIFY(module.elementNodes().isEmpty());
    QVERIFY(!module.elementWidget(QStringLiteral("user")));
    QVERIFY(module.elementActions(QStringLiteral("user")).isEmpty());
    QVERIFY(!module.canFetchMore());
    QCOMPARE(module.paranoidSettingsKey(), QStringLiteral("module/usersparanoid"));
}

void ModuleTest::columns_data()
{
    QTest::addColumn<VariantMap>("entries");
    QTest::addColumn<int>("column");
    QTest::addColumn<int>("role");
    QTest::addColumn<QVariant>("expected");

    const VariantMap none;
    const VariantMap described{{"description", "Accounts of the host"}};
    const VariantMap noParanoid{{"paranoid", QVariant()}};

    QTest::newRow("name") << none << 0 << int(Qt::DisplayRole) << QVariant("users");
    QTest::newRow("name tip") << none << 0 << int(Qt::ToolTipRole) << QVariant("users");
    QTest::newRow("no id roles") << none << 0 << int(Qt::UserRole + 2) << QVariant();
    QTest::newRow("no parent id role") << none << 1 << int(Qt::UserRole + 3) << QVariant();
    QTest::newRow("name has no check") << none << 0 << int(Qt::CheckStateRole) << QVariant();
    QTest::newRow("reread tip") << none << 1 << int(Qt::ToolTipRole) << QVariant("Force reread mode");
    QTest::newRow("reread tip without entry")
        << noParanoid << 1 << int(Qt::ToolTipRole) << QVariant("Force reread mode");
    QTest::newRow("reread checked") << none << 1 << int(Qt::CheckStateRole) << QVariant(true);
    QTest::newRow("reread unchecked")
        << VariantMap{{"paranoid", false}} << 1 << int(Qt::CheckStateRole) << QVariant(false);
    QTest::newRow("reread stored as text")
        << VariantMap{{"paranoid", "false"}} << 1 << int(Qt::CheckStateRole) << QVariant(false);
    QTest::newRow("reread without entry")
        << noParanoid << 1 << int(Qt::CheckStateRole) << QVariant();
    QTest::newRow("reread shows no text") << none << 1 << int(Qt::DisplayRole) << QVariant();
    QTest::newRow("description") << described << 2 << int(Qt::DisplayRole)
                                 << QVariant("Accounts of the host");
    QTest::newRow("description tip") << described << 2 << int(Qt::ToolTipRole)
                                     << QVariant("Accounts of the host");
    QTest::newRow("no description") << none << 2 << int(Qt::DisplayRole) << QVariant();
    QTest::newRow("column past the end") << described << 3 << int(Qt::DisplayRole) << QVariant();
}

void ModuleTest::columns()
{
    QFETCH(VariantMap, entries);
    QFETCH(int, column);
    QFETCH(int, role);
    QFETCH(QVariant, expected);

    RecordingModule module(QStringLiteral("users"), nullptr, true);
    setModuleData(module, entries);
    const QVariant value = module.data(column, role);
    QCOMPARE(value, expected);
    if (expected.isValid())
        QCOMPARE(value.userType(), expected.userType());

    const bool checkable = column == 1 && module.moduleData()->contains(QStringLiteral("paranoid"));
    Qt::ItemFlags flags = Qt::ItemIsSelectable | Qt::ItemIsEnabled;
    if (checkable)
        flags |= Qt::ItemIsUserCheckable;
    QCOMPARE(module.flags(column), flags);
}

void ModuleTest::setData_data()
{
    QTest::addColumn<VariantMap>("entries");
    QTest::addColumn<int>("column");
    QTest::addColumn<int>("role");
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<bool>("accepted");
    QTest::addColumn<QVariant>("stored");

    const VariantMap on{{"paranoid", true}};
    const VariantMap off{{"paranoid", false}};
    const int check = Qt::CheckStateRole;

    QTest::newRow("uncheck") << on << 1 << check << QVariant(int(Qt::Unchecked)) << true << QVariant(false);
    QTest::newRow("check") << off << 1 << check << QVariant(int(Qt::Checked)) << true << QVariant(true);
    QTest::newRow("check again") << on << 1 << check << QVariant(int(Qt::Checked)) << false << QVariant(true);
    QTest::newRow("partial is unchecked")
        << on << 1 << check << QVariant(int(Qt::PartiallyChecked)) << true << QVariant(false);
    QTest::newRow("boolean true is not checked")
        << on << 1 << check << QVariant(true) << true << QVariant(false);
    QTest::newRow("other column") << on << 0 << check << QVariant(int(Qt::Unchecked)) << false << QVariant(true);
    QTest::newRow("other role") << on << 1 << int(Qt::EditRole) << QVariant(int(Qt::Unchecked))
                                << false << QVariant(true);
    QTest::newRow("no entry") << VariantMap{{"paranoid", QVariant()}} << 1 << check
                              << QVariant(int(Qt::Checked)) << false << QVariant();
}

void ModuleTest::setData()
{
    QFETCH(VariantMap, entries);
    QFETCH(int, column);
    QFETCH(int, role);
    QFETCH(QVariant, value);
    QFETCH(bool, accepted);
    QFETCH(QVariant, stored);

    RecordingModule module(QStringLiteral("users"));
    setModuleData(module, entries);
    QCOMPARE(module.setData(column, value, role), accepted);
    QCOMPARE(module.getData(QStringLiteral("paranoid")), stored);
    // Nothing is saved before the module goes.
    QVERIFY(!storedSetting(module.paranoidSettingsKey()).isValid());
}

void ModuleTest::checkThroughModel()
{
    ModuleRootTreeNode root;
    RecordingModule users(QStringLiteral("users"), nullptr, true);
    RecordingModule groups(QStringLiteral("groups"), nullptr, false);
    users.moduleDataRef()->insert(QStringLiteral("description"), QStringLiteral("Accounts"));
    root.append(QList<TreeNode *>{&users, &groups});

    TreeNodeModel model(&root);
    QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::QtTest);
    QSignalSpy changed(&model, SIGNAL(dataChanged(QModelIndex, QModelIndex, QVector<int>)));
    QCOMPARE(model.columnCount(), 3);
    QCOMPARE(model.headerData(1, Qt::Horizontal).toString(), QStringLiteral("Reread"));
    const QModelIndex check = model.index(0, 1);
    QCOMPARE(model.index(0, 2).data().toString(), QStringLiteral("Accounts"));
    QVERIFY(model.flags(check) & Qt::ItemIsUserCheckable);

    QVERIFY(model.setData(check, Qt::Unchecked, Qt::CheckStateRole));
    QCOMPARE(changed.count(), 1);
    QCOMPARE(check.data(Qt::CheckStateRole).toBool(), false);
    // A no-op announces nothing.
    QVERIFY(!model.setData(check, Qt::Unchecked, Qt::CheckStateRole));
    QVERIFY(!model.setData(model.index(0, 0), Qt::Checked, Qt::CheckStateRole));
    QCOMPARE(changed.count(), 1);
    QVERIFY(model.setData(model.index(1, 1), Qt::Checked, Qt::CheckStateRole));
    QCOMPARE(changed.count(), 2);
    root.clear();
}

void ModuleTest::settingsRoundTrip()
{
    {
        RecordingModule users(QStringLiteral("users"), nullptr, true);
        QCOMPARE(users.data(1, Qt::CheckStateRole), QVariant(true));
        QVERIFY(users.flags(1) & Qt::ItemIsUserCheckable);
        QVERIFY(users.setData(1, int(Qt::Unchecked), Qt::CheckStateRole));
    }
    // The key runs the group and the name together.
    QCOMPARE(storedSetting(QStringLiteral("module/usersparanoid")), QVariant(false));
    QVERIFY(!storedSetting(QStringLiteral("module/users/paranoid")).isValid());
    QCOMPARE(QSettings().allKeys(), QStringList{"module/usersparanoid"});

    {
        RecordingModule again(QStringLiteral("users"), nullptr, true);
        QCOMPARE(again.data(1, Qt::CheckStateRole), QVariant(false));
        QVERIFY(again.setData(1, int(Qt::Checked), Qt::CheckStateRole));
        // Another module keeps a setting of its own.
        RecordingModule groups(QStringLiteral("groups"), nullptr, false);
        QCOMPARE(groups.data(1, Qt::CheckStateRole), QVariant(false));
    }
    QCOMPARE(storedSetting(QStringLiteral("module/usersparanoid")), QVariant(true));
    RecordingModule third(QStringLiteral("users"), nullptr, false);
    QCOMPARE(third.data(1, Qt::CheckStateRole), QVariant(true));
}

void ModuleTest::storedSettingOverridesDefault_data()
{
    QTest::addColumn<QVariant>("stored");
    QTest::addColumn<bool>("constructorDefault");
    QTest::addColumn<bool>("expected");

    QTest::newRow("nothing stored, on") << QVariant() << true << true;
    QTest::newRow("nothing stored, off") << QVariant() << false << false;
    QTest::newRow("stored on") << QVariant(true) << false << true;
    QTest::newRow("stored off") << QVariant(false) << true << false;
    QTest::newRow("stored as text") << QVariant("false") << true << false;
}

void ModuleTest::storedSettingOverridesDefault()
{
    QFETCH(QVariant, stored);
    QFETCH(bool, constructorDefault);
    QFETCH(bool, expected);

    if (stored.isValid())
        QSettings().setValue(QStringLiteral("module/quotaparanoid"), stored);
    RecordingModule module(QStringLiteral("quota"), nullptr, constructorDefault);
    QCOMPARE(module.getData(QStringLiteral("paranoid")), QVariant(expected));
}

void ModuleTest::noParanoidEntryNoSetting()
{
    QSettings().setValue(QStringLiteral("module/acceptorparanoid"), true);
    {
        RecordingModule module(QStringLiteral("acceptor"), nullptr, false);
        module.moduleDataRef()->remove(QStringLiteral("paranoid"));
        QSettings().remove(QStringLiteral("module/acceptorparanoid"));
        module.loadSettings();
        QVERIFY(!module.moduleData()->contains(QStringLiteral("paranoid")));
    }
    QVERIFY(QSettings().allKeys().isEmpty());
}

void ModuleTest::getData()
{
    RecordingModule parent(QStringLiteral("parent"));
    RecordingModule child(QStringLiteral("child"));
    parent.append(&child);
    parent.moduleDataRef()->insert(QStringLiteral("only"), 1);
    child.moduleDataRef()->insert(QStringLiteral("shared"), QStringLiteral("mine"));
    parent.moduleDataRef()->insert(QStringLiteral("shared"), QStringLiteral("parent's"));

    QVERIFY(!child.getData(QStringLiteral("only")).isValid());
    QCOMPARE(child.getDataHierarchy(QStringLiteral("only")), QVariant(1));
    QCOMPARE(child.getDataHierarchy(QStringLiteral("shared")), QVariant("mine"));
    QCOMPARE(child.getDataHierarchy(QStringLiteral("name")), QVariant("child"));
    QVERIFY(!child.getDataHierarchy(QStringLiteral("absent")).isValid());
    parent.clear();
}

void ModuleTest::rightsFromHierarchy_data()
{
    // The value stored in the grandparent, parent and module itself (an
    // invalid variant: no entry), whether the parent is a module or a plain
    // node, and the expected answer.
    QTest::addColumn<QVariant>("grandparent");
    QTest::addColumn<QVariant>("parent");
    QTest::addColumn<QVariant>("own");
    QTest::addColumn<bool>("parentIsModule");
    QTest::addColumn<bool>("expected");

    const QVariant none;
    QTest::newRow("nowhere") << none << none << none << true << false;
    QTest::newRow("own") << none << none << QVariant(true) << true << true;
    QTest::newRow("own false") << none << none << QVariant(false) << true << false;
    QTest::newRow("from parent") << none << QVariant(true) << none << true << true;
    QTest::newRow("from grandparent") << QVariant(true) << none << none << true << true;
    QTest::newRow("nearest wins") << QVariant(true) << QVariant(false) << none << true << false;
    QTest::newRow("own wins") << QVariant(true) << QVariant(true) << QVariant(false) << true << false;
    QTest::newRow("text true") << none << QVariant("true") << none << true << false;
    QTest::newRow("number 1") << none << none << QVariant(1) << true << false;
    QTest::newRow("text stops the search") << QVariant(true) << QVariant("true") << none << true << false;
    QTest::newRow("plain node between") << QVariant(true) << none << none << false << false;
}

void ModuleTest::rightsFromHierarchy()
{
    QFETCH(QVariant, grandparent);
    QFETCH(QVariant, parent);
    QFETCH(QVariant, own);
    QFETCH(bool, parentIsModule);
    QFETCH(bool, expected);

    for (const QString &key : {QStringLiteral("administrator"), QStringLiteral("macAdministrator")}) {
        RecordingModule top(QStringLiteral("top"));
        RecordingModule middleModule(QStringLiteral("middle"));
        TestTreeNode middleNode(QStringLiteral("middle"));
        RecordingModule module(QStringLiteral("module"));
        TreeNode *middle = parentIsModule ? static_cast<TreeNode *>(&middleModule) : &middleNode;
        top.append(middle);
        middle->append(&module);
        setModuleData(top, {{key, grandparent}});
        setModuleData(middleModule, {{key, parent}});
        setModuleData(module, {{key, own}});

        const bool administrator = Module::isAdministratorHierarchy(module);
        const bool mac = Module::isMacAdministratorHierarchy(module);
        // Each check reads its own key only.
        QCOMPARE(key == QLatin1String("administrator") ? administrator : mac, expected);
        QCOMPARE(key == QLatin1String("administrator") ? mac : administrator, false);
        QVERIFY(Module::defaultTrue(module));
        middle->clear();
        top.clear();
    }
}

void ModuleTest::elementLookup()
{
    struct Plain : OrdinaryElement {
        Plain(Module &m, const QString &title) : OrdinaryElement(m, rightsYes)
        {
            _elementType = QStringLiteral("user");
            setTitle(title);
        }
        QString toolTipText() const override { return QString(); }
    };

    RecordingModule module(QStringLiteral("users"));
    auto *alice = new Plain(module, QStringLiteral("alice"));
    auto *aliceAgain = new Plain(module, QStringLiteral("alice"));
    auto *impostor = new TestTreeNode(QStringLiteral("user_bob"), &module);
    auto *bob = new Plain(module, QStringLiteral("bob"));
    for (QObject *o : {static_cast<QObject *>(alice), static_cast<QObject *>(aliceAgain),
                       static_cast<QObject *>(bob)})
        o->setParent(&module);
    module.elementNodesRef() << nullptr << alice << aliceAgain << impostor << bob;

    QCOMPARE(module.element(QStringLiteral("user_alice")), static_cast<Element *>(alice));
    // The first node with the id decides, even when it is no element.
    QVERIFY(!module.element(QStringLiteral("user_bob")));
    QVERIFY(!module.element(QStringLiteral("user_carol")));
    QVERIFY(!module.element(QString()));
}

void ModuleTest::performOperationReachesChildModules()
{
    Module parent(QStringLiteral("parent"));
    RecordingModule a(QStringLiteral("a"));
    RecordingModule b(QStringLiteral("b"));
    RecordingModule aChild(QStringLiteral("aChild"));
    TestTreeNode plain(QStringLiteral("plain"));
    parent.append(QList<TreeNode *>{&a, &plain, &b});
    a.append(&aChild);

    QStringList order;
    for (RecordingModule *m : {&a, &b, &aChild})
        m->onOperation = [&order, m](ContextOperation *, OperationType, ElementData *) {
            order << m->id();
        };
    // One module dropping a later sibling while it is told must not break
    // the walk.
    a.onOperation = [&order, &parent, &b](ContextOperation *, OperationType, ElementData *) {
        order << QStringLiteral("a");
        parent.removeOne(&b);
    };

    ElementData data;
    parent.performOperation(nullptr, UpdateOperation, &data, 9);
    QCOMPARE(order, (QStringList{"a", "aChild", "b"}));
    QCOMPARE(a.log, QStringList{"Update(null) flags=9"});
    QCOMPARE(aChild.log, QStringList{"Update(null) flags=9"});
    QCOMPARE(aChild.dataLog, QList<ElementData *>{&data});

    // A leaf module forwards to nobody.
    order.clear();
    aChild.performOperation(nullptr, DeleteOperation, nullptr, 0);
    QCOMPARE(order, QStringList{"aChild"});
    a.clear();
    parent.clear();
}

void ModuleTest::isAdministratorWithoutHostLibrary()
{
    if (void *handle = dlopen("libtarnhelper.so.1", RTLD_LAZY)) {
        dlclose(handle);
        QSKIP("this host has an integrity library; the replacement is not used here");
    }
    Module module(QStringLiteral("m"));
    if (geteuid() != 0) {
        QVERIFY(!Module::isAdministrator(module));
        QSKIP("not run as root: only the answer for other users was checked");
    }
    // A host without integrity levels: root is at the highest level there is.
    QVERIFY(Module::isAdministrator(module));
    QVERIFY(seteuid(65534) == 0);
    const bool asOther = Module::isAdministrator(module);
    QVERIFY(seteuid(0) == 0);
    QVERIFY(!asOther);
    QVERIFY(Module::isAdministrator(module));
}

QTEST_GUILESS_MAIN(ModuleTest)
#include "tst_module.moc"
