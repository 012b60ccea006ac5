#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/containerelement.h>
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

#include <algorithm>
#include <memory>

Q_DECLARE_METATYPE(ElementWidgetRole)

using Container = TestElement<ContainerElement>;
using Ordinary = TestElement<OrdinaryElement>;

namespace {

// A supplement (special flag 1) that may offer the change of display and
// records the display type it is asked for.
class SwitchingSupplement : public TestElement<SupplementElement>
{
public:
    SwitchingSupplement(Module &module, bool offersChangeDisplay)
        : TestElement<SupplementElement>(module, rightsYes, QStringLiteral("extra"), QStringLiteral("x"))
        , offersChangeDisplay(offersChangeDisplay)
    {
    }
    quint64 availableOperations() const override
    {
        return SupplementElement::availableOperations() | (offersChangeDisplay ? ChangeDisplayOperation : 0);
    }
    void performOperation(OperationType type, ElementData *data, int flags) override
    {
        if (type == ChangeDisplayOperation) {
            auto *display = dynamic_cast<ChangeDisplayElementData *>(data);
            requested.append(display ? display->displayType() : -1);
        }
        SupplementElement::performOperation(type, data, flags);
    }
    bool offersChangeDisplay;
    QList<int> requested;
};

QList<int> states(const QSignalSpy &spy)
{
    QList<int> result;
    for (const QList<QVariant> &arguments : spy)
        result.append(arguments.value(0).toInt());
    return result;
}

} // namespace

class ElementWidgetTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { qRegisterMetaType<Element *>(); }
    void init();
    void cleanup();

    void setElement_data();
    void setElement();
    void readOnProgrammaticShowOnly();
    void editing_data();
    void editing();
    void setTreeNodeCurrent_data();
    void setTreeNodeCurrent();
    void noSetTreeNodeCurrent();
    void moduleKeepsOneWidgetPerType();

private:
    std::unique_ptr<RecordingModule> module;
    ElementRootTreeNode *root = nullptr;
    Ordinary *alice = nullptr;
    Ordinary *bob = nullptr;
    QList<ElementData *> received; // records handed to the module, owned here

    EditWidget *newEditor(ContextOperation::RightsPredicate rights = rightsYes)
    {
        auto *widget = new EditWidget(*module, rights);
        module->insertElementWidget(widget);
        return widget;
    }
};

void ElementWidgetTest::init()
{
    module.reset(new RecordingModule(QStringLiteral("users")));
    root = new ElementRootTreeNode(module.get());
    alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
    bob = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("bob"));
    root->append(QList<TreeNode *>{alice, bob});
    module->log.clear();
    module->onOperation = [this](ContextOperation *, OperationType, ElementData *data) {
        if (data)
            received.append(data);
    };
}

void ElementWidgetTest::cleanup()
{
    // Tree nodes do not own their children.
    if (module)
        root->clearDeleteAll();
    module.reset();
    qDeleteAll(received);
    received.clear();
}

void ElementWidgetTest::setElement_data()
{
    QTest::addColumn<bool>("mayEdit");
    QTest::addColumn<ElementWidgetRole>("role");
    QTest::addColumn<int>("times");
    QTest::addColumn<bool>("enabled");
    QTest::addColumn<QList<int>>("reported");

    // Editing waits for a read; creating starts at once, changed and invalid.
    QTest::newRow("edit") << true << EditElementRole << 1 << false << QList<int>{};
    QTest::newRow("edit without rights") << false << EditElementRole << 1 << false << QList<int>{};
    QTest::newRow("create") << true << CreateElementRole << 1 << true << QList<int>{2};
    QTest::newRow("create without rights") << false << CreateElementRole << 1 << true << QList<int>{2};
    QTest::newRow("create twice resets once") << true << CreateElementRole << 2 << true << QList<int>{2};
}

void ElementWidgetTest::setElement()
{
    QFETCH(bool, mayEdit);
    QFETCH(ElementWidgetRole, role);
    QFETCH(int, times);
    QFETCH(bool, enabled);
    QFETCH(QList<int>, reported);

    EditWidget *editor = newEditor(mayEdit ? rightsYes : rightsNo);
    editor->userTypes(QStringLiteral("draft"));
    QSignalSpy spy(editor, SIGNAL(contentChanged(int)));
    for (int i = 0; i < times; ++i)
        editor->setElement(alice, role);
    QCOMPARE(editor->element(), alice);
    QCOMPARE(editor->role(), role);
    QCOMPARE(editor->isEnabled(), enabled);
    QCOMPARE(editor->isEditBlocked(), !enabled);
    QVERIFY(!editor->isChanged());
    QCOMPARE(states(spy), reported);

    // Taking the element away blocks the controls again, but reports nothing.
    spy.clear();
    editor->setElement(nullptr, NoElementRole);
    QVERIFY(!editor->isEnabled());
    QVERIFY(editor->isEditBlocked());
    QCOMPARE(states(spy), QList<int>{});
    QVERIFY(module->log.isEmpty());
}

void ElementWidgetTest::readOnProgrammaticShowOnly()
{
    EditWidget *editor = newEditor();
    editor->setElement(alice, EditElementRole);

    QShowEvent restored;
    QSpontaneKeyEvent::setSpontaneous(&restored);
    // Delivered as the window system does: sendEvent() would clear the flag.
    qApp->notify(editor, &restored);
    QCOMPARE(module->log, QStringList{});

    editor->show();
    QCOMPARE(module->log, QStringList{"ReadProperty(user_alice)"});
    editor->hide();
    editor->show();
    QCOMPARE(module->log, (QStringList{"ReadProperty(user_alice)", "ReadProperty(user_alice)"}));
    editor->hide();

    // Nothing to read in the create role, nor for an element that does not
    // offer reading.
    auto *container = new Container(*module, rightsYes, QStringLiteral("user"), QStringLiteral("c"));
    root->append(container);
    module->log.clear();
    editor->setElement(alice, CreateElementRole);
    editor->show();
    editor->hide();
    editor->setElement(container, EditElementRole);
    editor->show();
    QCOMPARE(module->log, QStringList{});
}

void ElementWidgetTest::editing_data()
{
    QTest::addColumn<ElementWidgetRole>("role");
    QTest::addColumn<QString>("steps");
    QTest::addColumn<QList<int>>("reported");
    QTest::addColumn<bool>("changed");

    // Steps: t<text> types, i<text> imports, u sets unchanged.
    QTest::newRow("valid edit") << EditElementRole << "t:x" << QList<int>{3} << true;
    QTest::newRow("invalid edit") << EditElementRole << "t:" << QList<int>{2} << true;
    QTest::newRow("edit then unchanged") << EditElementRole << "t:x u" << QList<int>{3, 0} << false;
    QTest::newRow("unchanged without edit") << EditElementRole << "u" << QList<int>{} << false;
    QTest::newRow("import counts as change") << EditElementRole << "i:y" << QList<int>{3} << true;
    QTest::newRow("create: unchanged reports anyway") << CreateElementRole << "u u" << QList<int>{0, 0} << false;
    QTest::newRow("create: valid edit") << CreateElementRole << "t:x" << QList<int>{3} << true;
}

void ElementWidgetTest::editing()
{
    QFETCH(ElementWidgetRole, role);
    QFETCH(QString, steps);
    QFETCH(QList<int>, reported);
    QFETCH(bool, changed);

    EditWidget *editor = newEditor();
    editor->setElement(alice, role);
    QSignalSpy spy(editor, SIGNAL(contentChanged(int)));
    for (const QString &step : steps.split(QLatin1Char(' '))) {
        const QString text = step.mid(2);
        if (step.startsWith(QLatin1Char('t'))) {
            editor->userTypes(text);
        } else if (step.startsWith(QLatin1Char('i'))) {
            ElementData imported;
            imported.insert(QStringLiteral("text"), text);
            editor->afterSuccessfulImport(&imported);
        } else {
            editor->setUnchanged();
        }
    }
    QCOMPARE(states(spy), reported);
    QCOMPARE(editor->isChanged(), changed);
}

void ElementWidgetTest::setTreeNodeCurrent_data()
{
    QTest::addColumn<QString>("target");
    QTest::addColumn<ElementWidgetRole>("role");
    QTest::addColumn<bool>("edited");
    QTest::addColumn<int>("answer");
    QTest::addColumn<bool>("madeCurrent");
    QTest::addColumn<QList<int>>("displayRequests");
    QTest::addColumn<bool>("changedAfter");
    QTest::addColumn<int>("questions");

    const int none = QMessageBox::NoButton;
    QTest::newRow("plain node") << "node" << EditElementRole << false << none << false << QList<int>{} << false << 0;
    QTest::newRow("element") << "bob" << EditElementRole << false << none << true << QList<int>{} << false << 0;
    QTest::newRow("supplement, no display change") << "supplement" << EditElementRole << false << none << false
                                                    << QList<int>{} << false << 0;
    QTest::newRow("supplement, display change") << "switching" << EditElementRole << false << none << true
                                                 << QList<int>{0} << false << 0;
    QTest::newRow("changed, answer no") << "bob" << EditElementRole << true << int(QMessageBox::No) << false
                                        << QList<int>{} << true << 1;
    // Going on keeps the edit flagged: it has still not been saved.
    QTest::newRow("changed, answer yes") << "bob" << EditElementRole << true << int(QMessageBox::Yes) << true
                                         << QList<int>{} << true << 1;
    QTest::newRow("creating, answer yes") << "bob" << CreateElementRole << true << int(QMessageBox::Yes) << true
                                          << QList<int>{} << false << 1;
}

void ElementWidgetTest::setTreeNodeCurrent()
{
    QFETCH(QString, target);
    QFETCH(ElementWidgetRole, role);
    QFETCH(bool, edited);
    QFETCH(int, answer);
    QFETCH(bool, madeCurrent);
    QFETCH(QList<int>, displayRequests);
    QFETCH(bool, changedAfter);
    QFETCH(int, questions);

    auto *plain = new SwitchingSupplement(*module, false);
    auto *switching = new SwitchingSupplement(*module, true);
    alice->append(QList<TreeNode *>{plain, switching});
    TestTreeNode node(QStringLiteral("node"));
    TreeNode *targetNode = target == QLatin1String("node") ? static_cast<TreeNode *>(&node)
        : target == QLatin1String("bob")                   ? bob
        : target == QLatin1String("supplement")            ? static_cast<TreeNode *>(plain)
                                                           : switching;

    EditWidget *editor = newEditor();
    editor->setElement(alice, role);
    if (edited)
        editor->userTypes(QStringLiteral("unsaved"));
    QSignalSpy current(targetNode, SIGNAL(setCurrentNode(TreeNode *)));
    DialogAnswerer answerer;
    answerer.answer(QMessageBox::StandardButton(answer));
    editor->setTreeNodeCurrent(targetNode);

    QCOMPARE(current.count(), madeCurrent ? 1 : 0);
    QCOMPARE(switching->requested, target == QLatin1String("switching") ? displayRequests : QList<int>{});
    QVERIFY(plain->requested.isEmpty());
    QCOMPARE(editor->isChanged(), changedAfter);
    QCOMPARE(answerer.seen.size(), questions);
    if (questions) {
        QCOMPARE(answerer.seen.first(),
                 QStringLiteral("Element activation|Changes not saved!\nContinue without saving?|%1")
                     .arg(int(QMessageBox::Yes | QMessageBox::No)));
    }
}

void ElementWidgetTest::noSetTreeNodeCurrent()
{
    EditWidget *editor = newEditor();
    DialogAnswerer answerer;
    editor->noSetTreeNodeCurrent();
    QCOMPARE(answerer.seen, QStringList{QStringLiteral("Element activation|Activation of this element not supported!|%1")
                                            .arg(int(QMessageBox::Ok))});
}

void ElementWidgetTest::moduleKeepsOneWidgetPerType()
{
    module->insertElementWidget(nullptr);

    QPointer<EditWidget> first = new EditWidget(*module, rightsYes, QStringLiteral("user"));
    QPointer<EditWidget> second = new EditWidget(*module, rightsYes, QStringLiteral("user"));
    QPointer<EditWidget> undefined = new EditWidget(*module, rightsYes, ContextOperation::undefinedElementType);
    QPointer<EditWidget> group = new EditWidget(*module, rightsYes, QStringLiteral("group"));
    for (EditWidget *widget : {first.data(), second.data(), undefined.data(), group.data()})
        module->insertElementWidget(widget);
    QVERIFY(first && group);
    QVERIFY(!second);
    QVERIFY(!undefined);
    QCOMPARE(module->elementWidget(QStringLiteral("user")), first.data());
    QCOMPARE(alice->elementWidget(EditElementRole), first.data());

    // A widget deleted elsewhere is forgotten and not deleted again.
    delete group;
    QVERIFY(!module->elementWidget(QStringLiteral("group")));

    root->clearDeleteAll();
    module.reset();
    QVERIFY(!first);
}

QTEST_MAIN(ElementWidgetTest)
#include "tst_elementwidget.moc"
