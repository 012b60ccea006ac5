#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/supplementelement.h>

#include "dialoganswerer.h"
#include "editwidget.h"
#include "recordingmodule.h"
#include "testtreenode.h"

#include <QPointer>
#include <QShowEvent>
#include <QtTest>
#include <qtestspontaneevent.h>

#include <memory>

Q_DECLARE_METATYPE(ElementWidgetRole)

using Ordinary = TestElement<OrdinaryElement>;

namespace {

// A supplement (not selectable) that offers the change of display and
// records the display type it is asked for.
class SwitchingSupplement : public TestElement<SupplementElement>
{
public:
    explicit SwitchingSupplement(Module &module)
        : TestElement<SupplementElement>(module, rightsYes, QStringLiteral("extra"), QStringLiteral("x"))
    {
    }
    quint64 availableOperations() const override { return ChangeDisplayOperation; }
    void performOperation(OperationType, ElementData *data, int) override
    {
        if (auto *display = dynamic_cast<ChangeDisplayElementData *>(data))
            requested.append(display->displayType());
    }
    QList<int> requested;
};

} // namespace

class ElementWidgetTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordingModule> module;
    ElementRootTreeNode *root = nullptr;
    Ordinary *alice = nullptr;
    Ordinary *bob = nullptr;

    EditWidget *newEditor()
    {
        auto *widget = new EditWidget(*module, rightsYes);
        module->insertElementWidget(widget);
        return widget;
    }

private Q_SLOTS:
    void init()
    {
        module.reset(new RecordingModule(QStringLiteral("users")));
        root = new ElementRootTreeNode(module.get());
        alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
        bob = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("bob"));
        root->append(QList<TreeNode *>{alice, bob});
        module->log.clear();
    }
    void cleanup()
    {
        // Tree nodes do not own their children.
        if (module)
            root->clearDeleteAll();
        module.reset();
    }

    void editing_data()
    {
        // After some text typed, e, c, n: shows alice to edit, alice to create, nothing;
        // t:<text> types, i:<text> imports, u sets unchanged.
        QTest::addColumn<QString>("steps");
        QTest::addColumn<QList<int>>("reported");
        QTest::addColumn<bool>("changed");
        QTest::addColumn<bool>("blocked");

        // Editing waits for a read; creating starts at once, invalid but unchanged.
        QTest::newRow("edit") << "e" << QList<int>{} << false << true;
        QTest::newRow("create twice resets once") << "c c" << QList<int>{2} << false << false;
        QTest::newRow("element taken away") << "c n" << QList<int>{2} << false << true;
        QTest::newRow("invalid edit") << "e t:" << QList<int>{2} << true << true;
        QTest::newRow("edit then unchanged") << "e t:x u" << QList<int>{3, 0} << false << true;
        QTest::newRow("import counts as change") << "e i:y" << QList<int>{3} << true << true;
        QTest::newRow("create: unchanged reports anyway") << "c u u" << QList<int>{2, 0, 0} << false << false;
    }
    void editing()
    {
        QFETCH(QString, steps);
        QFETCH(QList<int>, reported);
        QFETCH(bool, changed);
        QFETCH(bool, blocked);

        EditWidget *editor = newEditor();
        editor->userTypes(QStringLiteral("before"));
        editor->reported.clear();
        for (const QString &step : steps.split(QLatin1Char(' '))) {
            if (step == QLatin1String("e")) {
                editor->setElement(alice, EditElementRole);
            } else if (step == QLatin1String("c")) {
                editor->setElement(alice, CreateElementRole);
            } else if (step == QLatin1String("n")) {
                editor->setElement(nullptr, NoElementRole);
            } else if (step == QLatin1String("u")) {
                editor->setUnchanged();
            } else if (step.startsWith(QLatin1Char('t'))) {
                editor->userTypes(step.mid(2));
            } else {
                ElementData imported;
                imported.insert(QStringLiteral("text"), step.mid(2));
                editor->afterSuccessfulImport(&imported);
            }
        }
        QCOMPARE(editor->reported, reported);
        QCOMPARE(editor->isChanged(), changed);
        QCOMPARE(editor->isEditBlocked(), blocked);
        QCOMPARE(editor->isEnabled(), !blocked);
        QCOMPARE(module->log, QStringList{});
    }

    void readOnProgrammaticShowOnly()
    {
        EditWidget *editor = newEditor();
        editor->setElement(alice, EditElementRole);
        QShowEvent restored;
        QSpontaneKeyEvent::setSpontaneous(&restored);
        // Delivered as the window system does: sendEvent() would clear the flag.
        qApp->notify(editor, &restored);
        QCOMPARE(module->log, QStringList{});
        editor->show();
        editor->hide();
        QCOMPARE(module->log, QStringList{"ReadProperty(user_alice)"});

        // Nothing to read in the create role.
        editor->setElement(alice, CreateElementRole);
        editor->show();
        QCOMPARE(module->log, QStringList{"ReadProperty(user_alice)"});
    }

    void setTreeNodeCurrent_data()
    {
        QTest::addColumn<QString>("target");
        QTest::addColumn<ElementWidgetRole>("role");
        QTest::addColumn<int>("answer"); // to the question about unsaved text; none: nothing typed
        QTest::addColumn<bool>("madeCurrent");
        QTest::addColumn<bool>("changedAfter");

        const int none = QMessageBox::NoButton;
        QTest::newRow("plain node") << "node" << EditElementRole << none << false << false;
        QTest::newRow("element") << "bob" << EditElementRole << none << true << false;
        QTest::newRow("supplement, no display change") << "supplement" << EditElementRole << none << false << false;
        QTest::newRow("supplement, display change") << "switching" << EditElementRole << none << true << false;
        QTest::newRow("changed, answer no") << "bob" << EditElementRole << int(QMessageBox::No) << false << true;
        // Going on keeps the edit flagged: it has still not been saved.
        QTest::newRow("changed, answer yes") << "bob" << EditElementRole << int(QMessageBox::Yes) << true << true;
        QTest::newRow("creating, answer yes") << "bob" << CreateElementRole << int(QMessageBox::Yes) << true << false;
    }
    void setTreeNodeCurrent()
    {
        QFETCH(QString, target);
        QFETCH(ElementWidgetRole, role);
        QFETCH(int, answer);
        QFETCH(bool, madeCurrent);
        QFETCH(bool, changedAfter);

        auto *plain = new TestElement<SupplementElement>(*module, rightsYes, QStringLiteral("extra"));
        auto *switching = new SwitchingSupplement(*module);
        alice->append(QList<TreeNode *>{plain, switching});
        TestTreeNode node(QStringLiteral("node"));
        const QMap<QString, TreeNode *> targets{
            {"node", &node}, {"bob", bob}, {"supplement", plain}, {"switching", switching}};

        EditWidget *editor = newEditor();
        editor->setElement(alice, role);
        if (answer != QMessageBox::NoButton)
            editor->userTypes(QStringLiteral("unsaved"));
        QSignalSpy current(targets.value(target), SIGNAL(setCurrentNode(TreeNode *)));
        DialogAnswerer answerer;
        answerer.answer(QMessageBox::StandardButton(answer));
        editor->setTreeNodeCurrent(targets.value(target));

        QCOMPARE(current.count(), madeCurrent ? 1 : 0);
        QCOMPARE(switching->requested, target == QLatin1String("switching") ? QList<int>{0} : QList<int>{});
        QCOMPARE(editor->isChanged(), changedAfter);
        const QString question = QStringLiteral("Element activation|Changes not saved!\nContinue without saving?|%1")
                                     .arg(int(QMessageBox::Yes | QMessageBox::No));
        QCOMPARE(answerer.seen, answer != QMessageBox::NoButton ? QStringList{question} : QStringList{});
    }

    void noSetTreeNodeCurrent()
    {
        DialogAnswerer answerer;
        newEditor()->noSetTreeNodeCurrent();
        const QString warning = QStringLiteral("Element activation|Activation of this element not supported!|%1");
        QCOMPARE(answerer.seen, QStringList{warning.arg(int(QMessageBox::Ok))});
    }

    void moduleKeepsOneWidgetPerType()
    {
        module->insertElementWidget(nullptr);
        QPointer<EditWidget> first = new EditWidget(*module, rightsYes, QStringLiteral("user"));
        QPointer<EditWidget> second = new EditWidget(*module, rightsYes, QStringLiteral("user"));
        QPointer<EditWidget> undefined = new EditWidget(*module, rightsYes, ContextOperation::undefinedElementType);
        QPointer<EditWidget> group = new EditWidget(*module, rightsYes, QStringLiteral("group"));
        for (EditWidget *widget : {first.data(), second.data(), undefined.data(), group.data()})
            module->insertElementWidget(widget);
        QVERIFY(first && group && !second && !undefined);
        QCOMPARE(alice->elementWidget(EditElementRole), first.data());

        // A widget deleted elsewhere is forgotten and not deleted again.
        delete group;
        QVERIFY(!module->elementWidget(QStringLiteral("group")));
        root->clearDeleteAll();
        module.reset();
        QVERIFY(!first);
    }
};

QTEST_MAIN(ElementWidgetTest)
#include "tst_elementwidget.moc"
