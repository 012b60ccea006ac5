// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
};

Element *makeKind(const QString &kind, Module &module, bool editable)
{
    const ContextOperation::RightsPredicate r = editable ? rightsYes : rightsNo;
    Element *e = kind == "container" ? static_cast<Element *>(new Container(module, r, "group", "x"))
                 : kind == "ordinary" ? new Ordinary(module, r, "user", "x")
                 : kind == "supplement" ? static_cast<Element *>(new Supplement(module, r, "extra", "x"))
                 : kind == "login" ? new Login(module, r, "login", "x")
                                   : static_cast<Element *>(new Service(module, r, "service", "x"));
    e->setParent(&module);
    return e;
}

} // namespace

class ElementTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordingModule> module;
    bool themePresent = false;
    QTemporaryDir themeDir;

private Q_SLOTS:
    void initTestCase()
    {
        // A small icon theme of our own, so that the service icons are told
        // apart by name; with KVT_TEST_ICON_THEME=none it is missing.
        themePresent = qgetenv("KVT_TEST_ICON_THEME") != "none";
        const QString base = themeDir.path() + QStringLiteral("/kvt-test/");
        QVERIFY(QDir().mkpath(base + QStringLiteral("16x16")));
        QFile index(base + QStringLiteral("index.theme"));
        QVERIFY(index.open(QIODevice::WriteOnly) && index.write("[Icon Theme]\nDirectories=16x16\n[16x16]\nSize=16\nType=Fixed\n") > 0);
        index.close();
        QPixmap pixmap(16, 16);
        pixmap.fill(Qt::red);
        for (const QString name : {"media-playback-start", "media-playback-stop"})
            QVERIFY(pixmap.save(base + QStringLiteral("16x16/%1.png").arg(name)));
        QIcon::setThemeSearchPaths({themeDir.path()});
        QIcon::setThemeName(themePresent ? QStringLiteral("kvt-test") : QStringLiteral("kvt-missing"));
    }

    void init() { module.reset(new RecordingModule(QStringLiteral("users"))); }
    void cleanup() { module.reset(); }

    void itemDataAndTexts()
    {
        Ordinary user(*module, rightsYes, "user");
        SignalLog log;
        log.watchNode(&user);
        user.setTitle(QStringLiteral("a%1b"));
        QCOMPARE(log.take(), QStringList{"nodeDataChanged(user_a%1b)"});
        // Title and tool tip in column 0; title, type, own group type and id in any column.
        const QStringList texts{user.data(0, Qt::DisplayRole).toString(), user.data(0, Qt::ToolTipRole).toString(),
                                user.data(3, Qt::UserRole + 4).toString(), user.data(3, Qt::UserRole + 5).toString(),
                                user.data(3, Qt::UserRole + 6).toString(), user.data(3, Qt::UserRole + 2).toString()};
        QCOMPARE(texts, (QStringList{"a%1b", "tip:a%1b", "a%1b", "user", "Undefined", "user_a%1b"}));
        QCOMPARE(user.questionForRemove(), QStringLiteral("Do you really want to remove this element?"));

        // The group type is inherited, through plain nodes too.
        Container group(*module, rightsYes, "group", "staff");
        TestTreeNode between(QStringLiteral("between"));
        group.setGroupType(QStringLiteral("users"));
        group.append(&between);
        between.append(&user);
        QCOMPARE(user.groupElementType(), QStringLiteral("users"));
        between.clear();
    }

    void treeChangesNotifyModules_data()
    {
        QTest::addColumn<bool>("elementParent");
        QTest::newRow("under the root") << false;
        QTest::newRow("under an element") << true;
    }

    void treeChangesNotifyModules()
    {
        QFETCH(bool, elementParent);

        // Elements a b c d e and plain nodes p p2; after each change the
        // children of the parent are added to the module's log in brackets.
        QObject owner;
        QMap<QString, TreeNode *> n;
        for (const QString name : {"a", "b", "c", "d", "e", "top", "p", "p2"}) {
            n[name] = name.startsWith('p') ? static_cast<TreeNode *>(new TestTreeNode(name))
                                           : new Ordinary(*module, rightsYes, "user", name);
            n[name]->setParent(&owner);
        }
        ElementRootTreeNode root;
        TreeNode *parent = elementParent ? n["top"] : &root;
        parent->append(QList<TreeNode *>{n["a"], n["b"], n["c"], n["p"]});
        module->log.clear();
        const std::function<void()> changes[] = {
            [&] { parent->removeAt(4, 1); }, [&] { parent->insert(1, QList<TreeNode *>{n["d"], n["p2"], n["e"], n["d"]}); },
            [&] { parent->insert(0, n["c"]); }, [&] { parent->removeAt(1, 10); }, [&] { parent->clear(); }};
        for (const auto &change : changes) {
            change();
            module->log << '[' + TreeString::fromTree(parent) + ']';
        }
        QCOMPARE(module->log, (QStringList{
            "[user_a user_b user_c p]",
            "Inserted(user_d)", "Inserted(user_e)", "[user_a user_d p2 user_e user_b user_c p]",
            "Removed(user_c)", "Inserted(user_c)", "[user_c user_a user_d p2 user_e user_b p]",
            "Removed(user_a)", "Removed(user_d)", "Removed(user_e)", "Removed(user_b)", "[user_c]",
            "Removed(user_c)", "[]"}));
    }

    void destructionNotifiesLiveModulesOnly()
    {
        ElementRootTreeNode root;
        auto *group = new Container(*module, rightsYes, "group", "staff");
        auto *alice = new Ordinary(*module, rightsYes, "user", "alice");
        alice->setParent(module.get());
        root.append(group);
        group->append(alice);
        module->log.clear();
        // A listener reading the leaving row meets an element whose own class
        // is already gone: it still has its title, but no tool tip to give.
        QStringList heard;
        QObject::connect(&root, &TreeNode::nodesAboutToBeRemoved, [&heard](TreeNode *parent, int first) {
            const TreeNode *leaving = parent->childNodes().at(first);
            heard << leaving->data(0, Qt::DisplayRole).toString() << leaving->data(0, Qt::ToolTipRole).toString();
        });
        QCOMPARE(group->data(0, Qt::ToolTipRole).toString(), QStringLiteral("tip:staff"));
        delete group;
        QCOMPARE(module->log, (QStringList{"Removed(group_staff)", "Removed(user_alice)"}));
        QCOMPARE(heard, (QStringList{"staff", QString()}));

        // Elements owned by their module outlive its destructor while they
        // are still in an element tree: their removal must not call into it.
        root.append(alice);
        QPointer<Element> watch(alice);
        module.reset();
        QVERIFY(!watch);
        QCOMPARE(root.childNodesCount(), 0);
    }

    void operations_data()
    {
        // The row name gives the element's kind and place; the offers with
        // and without rights; what reaches the module, with or without
        // rights, since the offer is only advisory.
        QTest::addColumn<quint64>("editable");
        QTest::addColumn<quint64>("readOnly");
        QTest::addColumn<QStringList>("forwarded");

        const QStringList ordinary{"Create", "ReadProperty", "Update", "Delete"};
        QTest::newRow("container") << quint64(12) << quint64(8) << QStringList{"Create", "ReadContent"};
        QTest::newRow("ordinary") << quint64(228) << quint64(32) << ordinary;
        QTest::newRow("ordinary persistent") << quint64(96) << quint64(32) << ordinary;
        QTest::newRow("ordinary under a switching parent") << quint64(228 | 2048) << quint64(32 | 2048) << ordinary;
        QTest::newRow("supplement") << quint64(96) << quint64(32) << QStringList{"ReadProperty", "Update"};
        QTest::newRow("login") << quint64(393256) << quint64(393256)
                               << QStringList{"ReadContent", "ReadProperty", "LoginExtra1", "LoginExtra2"};
        QTest::newRow("service") << quint64(0) << quint64(0) << QStringList();
    }

    void operations()
    {
        QFETCH(quint64, editable);
        QFETCH(quint64, readOnly);
        QFETCH(QStringList, forwarded);
        const QString tag = QLatin1String(QTest::currentDataTag());

        SwitchingContainer switching(*module, rightsNo, "group", "switching");
        Container plain(*module, rightsNo, "group", "plain");
        for (bool rights : {true, false}) {
            Element *e = makeKind(tag.section(' ', 0, 0), *module, rights);
            if (tag.contains("persistent"))
                static_cast<Ordinary *>(e)->setExpected(2, QStringLiteral("group_plain"));
            (tag.contains("switching") ? static_cast<TreeNode &>(switching) : plain).append(e);
            // Asked through the ContextOperation side, as the host does.
            auto *context = static_cast<ContextOperation *>(e);
            QCOMPARE(context->availableOperations(), rights ? editable : readOnly);

            module->log.clear();
            module->dataLog.clear();
            ElementData data;
            for (quint64 op = 1; op <= LoginExtraOperation2; op <<= 1) // every code, named or not
                context->performOperation(OperationType(op), &data, 7);
            QStringList expected;
            for (const QString &name : forwarded)
                expected << name + '(' + e->id() + ") flags=7";
            QCOMPARE(module->log, expected);
            QCOMPARE(module->dataLog.count(&data), module->dataLog.size());
            switching.clear();
            plain.clear();
        }
    }

    void lazyLoadingThroughModel()
    {
        // A login offers reading its content but has nothing to load.
        ElementRootTreeNode root;
        auto *group = new Container(*module, rightsYes, "group", "staff");
        Login login(*module, rightsYes, "login", "l");
        group->setParent(module.get());
        root.append(QList<TreeNode *>{group, &login});
        // The module answers a read of the group's content by adding the
        // users, as a plugin's read task does when it is done.
        module->onOperation = [this](ContextOperation *c, OperationType type, ElementData *) {
            for (const QString name : {"alice", "bob"}) {
                if (type != ReadContentOperation)
                    break;
                auto *user = new Ordinary(*module, rightsYes, "user", name);
                user->setParent(c->elementContext());
                c->elementContext()->append(user);
            }
        };
        module->log.clear();

        TreeNodeModel model(&root);
        // The tester walks the tree and may fetch on its own, as a view does.
        QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::QtTest);
        for (int row = 0; row < 2; ++row)
            model.fetchMore(model.index(row, 0));
        QCOMPARE(module->log, (QStringList{"ReadContent(group_staff)", "Inserted(user_alice)", "Inserted(user_bob)"}));
        QCOMPARE(TreeString::fromModel(&model), QStringLiteral("staff[alice bob] l"));
        QVERIFY(!model.canFetchMore(model.index(0, 0)));
        root.clear();
    }

    void resetConteinerElementRereads()
    {
        Container group(*module, rightsYes, "group", "staff");
        QPointer<Element> child = new Ordinary(*module, rightsYes, "user", "alice");
        QPointer<Element> grandChild = new Ordinary(*module, rightsYes, "user", "x");
        group.append(child.data());
        child->append(grandChild.data());
        module->elementNodesRef() << &group;
        group.fetchMore();
        module->resetConteinerElement();
        // The children are destroyed, their children only detached; the group is read again.
        QVERIFY(!child && grandChild && !grandChild->parentNode());
        QVERIFY(group.canFetchMore());
        delete grandChild.data();
    }

    void serviceIcons_data()
    {
        QTest::addColumn<int>("running"); // -1: state not known yet
        QTest::addColumn<QString>("expectedIcon");
        QTest::newRow("state unknown") << -1 << QString();
        QTest::newRow("running") << 1 << "media-playback-start";
        QTest::newRow("stopped") << 0 << "media-playback-stop";
    }

    void serviceIcons()
    {
        QFETCH(int, running);
        QFETCH(QString, expectedIcon);

        Service service(*module, rightsYes, "service", "cron");
        auto *light = dynamic_cast<ServiceLightElementData *>(service.elementData());
        QVERIFY(light);
        if (running >= 0)
            light->setState(running, QStringLiteral("text"));
        const QIcon icon = service.data(0, Qt::DecorationRole).value<QIcon>();
        // Without a matching theme the library's own copy of the icon answers.
        QCOMPARE(icon.name(), expectedIcon);
        QCOMPARE(icon.isNull(), expectedIcon.isEmpty());
    }

    void supplementLoginMixin()
    {
        // The flag 1 says that a supplement is not under a login; other flags are kept.
        ElementRootTreeNode root;
        Login login(*module, rightsYes, "login", "l");
        Supplement extra(*module, rightsYes, "extra", "e");
        QList<int> flags;
        for (const QString situation : {"root", "false", "true"}) {
            login.elementData()->insert(QStringLiteral("isLogin"), situation == "true");
            TreeNode *parent = situation == "root" ? static_cast<TreeNode *>(&root) : &login;
            parent->append(&extra);
            flags << SupplementLoginMixin(&extra).treeNodeSpecialFlags(4);
            parent->clear();
        }
        QCOMPARE(flags, (QList<int>{4, 5, 4}));
    }
};

QTEST_MAIN(ElementTest)
#include "tst_element.moc"
