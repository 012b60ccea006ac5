#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/choicedialog.h>
#include <kvt-common/choicetreenodeproxymodel.h>
#include <kvt-common/choicewidget.h>
#include <kvt-common/containerelement.h>
#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/singlechoicedialog.h>
#include <kvt-common/treenodemodel.h>

#include "recordingmodule.h"
#include "screenshot.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QLineEdit>
#include <QPushButton>
#include <QTreeView>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;
using Strings = QSet<QString>;

namespace {

// A container whose children can be shown in two ways besides "All".
class VariantElement : public TestElement<ContainerElement>
{
public:
    VariantElement(Module &module, bool offers)
        : TestElement<ContainerElement>(module, rightsYes, QStringLiteral("group")), offersDisplay(offers) {}
    quint64 availableOperations() const override
    {
        return ContainerElement::availableOperations() | (offersDisplay ? ChangeDisplayOperation : 0);
    }
    QStringList displayChildrenVariants() const override { return {QStringLiteral("Users"), QStringLiteral("Groups")}; }
    void switchTo(int variant)
    {
        ChangeDisplayElementData data(variant);
        performOperation(ChangeDisplayOperation, &data, 0);
    }
    bool offersDisplay;
};

QString sorted(const Strings &strings)
{
    QStringList list = strings.values();
    list.sort();
    return list.join(QLatin1Char(' '));
}

// The row reached by a path of display texts, "a/a2".
QModelIndex findRow(const QAbstractItemModel *model, const QString &path)
{
    QModelIndex index;
    for (const QString &name : path.split(QLatin1Char('/'))) {
        const QModelIndexList found = model->match(model->index(0, 0, index), Qt::DisplayRole, name, 1, Qt::MatchExactly);
        index = found.value(0);
    }
    return index;
}

QTreeView *treeView(QWidget *widget) { return widget->findChild<QTreeView *>(QStringLiteral("_nodeTreeView")); }
QPushButton *button(QWidget *widget, const char *name) { return widget->findChild<QPushButton *>(QLatin1String(name)); }
QString rows(QWidget *widget) { return TreeString::fromModel(treeView(widget)->model()); }
QPushButton *okButton(QWidget *dialog)
{
    return dialog->findChild<QDialogButtonBox *>(QStringLiteral("_buttonBox"))->button(QDialogButtonBox::Ok);
}

// Clicks the named row of a shown view; with Ctrl the row is added to (or
// taken from) the selection.
bool clickRow(QTreeView *view, const QString &path, Qt::KeyboardModifiers modifiers = {})
{
    const QModelIndex index = findRow(view->model(), path);
    if (index.isValid())
        QTest::mouseClick(view->viewport(), Qt::LeftButton, modifiers, view->visualRect(index).center());
    return index.isValid();
}

} // namespace

class ChoiceTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void tickThroughDialogAndRemove();
    void disabledWidget();
    void filter_data();
    void filter();
    void displayVariants_data();
    void displayVariants();
    void singleChoice();
    void doubleClickReportsNode();
    void screenshots();

private:
    TestTreeNode *root = nullptr;
    TreeNodeModel *treeModel = nullptr;
    ChoiceTreeNodeProxyModel *choiceModel = nullptr;
    QList<Tester *> testers;

    void watch(QAbstractItemModel *model) { testers.append(new Tester(model, Tester::FailureReportingMode::QtTest)); }
};

void ChoiceTest::init()
{
    root = TreeString::makeTree(QStringLiteral("adm audio a.b axb cdrom video"));
    treeModel = new TreeNodeModel(root);
    choiceModel = new ChoiceTreeNodeProxyModel(0, Qt::CheckStateRole, Qt::CheckStateRole);
    choiceModel->setSourceModel(treeModel);
    choiceModel->setCheckedNames({QStringLiteral("adm")});
    watch(treeModel);
    watch(choiceModel);
}

void ChoiceTest::cleanup()
{
    qDeleteAll(testers);
    testers.clear();
    delete choiceModel;
    delete treeModel;
    delete root;
}

void ChoiceTest::tickThroughDialogAndRemove()
{
    ChoiceWidget widget;
    watch(treeView(&widget)->model());
    watch(widget.choiceDialog()->model());
    widget.setChoiceModel(choiceModel);
    QCOMPARE(widget.choiceModel(), choiceModel);
    widget.show();
    QVERIFY(QTest::qWaitForWindowExposed(&widget));
    QCOMPARE(rows(&widget), QStringLiteral("adm"));
    QVERIFY(!button(&widget, "_removePushButton")->isEnabled());

    QTest::mouseClick(button(&widget, "_addPushButton"), Qt::LeftButton);
    ChoiceDialog *dialog = widget.choiceDialog();
    QVERIFY(dialog->isVisible());
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    QCOMPARE(dialog->windowTitle(), QStringLiteral("Choice"));
    QVERIFY(!okButton(dialog)->isEnabled());
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("audio")));
    QVERIFY(okButton(dialog)->isEnabled());
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("audio"), Qt::ControlModifier));
    QVERIFY(!okButton(dialog)->isEnabled());
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("audio")));
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("cdrom"), Qt::ControlModifier));
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("video"), Qt::ControlModifier));
    QTest::mouseClick(okButton(dialog), Qt::LeftButton);

    QVERIFY(!dialog->isVisible());
    QCOMPARE(rows(dialog), QStringLiteral("a.b axb"));
    QCOMPARE(rows(&widget), QStringLiteral("adm audio cdrom video"));
    QCOMPARE(sorted(choiceModel->addNames()), QStringLiteral("audio cdrom video"));
    QVERIFY(choiceModel->removeNames().isEmpty());

    // Remove unticks every selected name, one added just now and one that
    // was ticked from the start.
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("audio")));
    QVERIFY(button(&widget, "_removePushButton")->isEnabled());
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("adm"), Qt::ControlModifier));
    QTest::mouseClick(button(&widget, "_removePushButton"), Qt::LeftButton);
    QCOMPARE(rows(&widget), QStringLiteral("cdrom video"));
    QCOMPARE(rows(dialog), QStringLiteral("adm audio a.b axb"));
    QCOMPARE(sorted(choiceModel->addNames()), QStringLiteral("cdrom video"));
    QCOMPARE(sorted(choiceModel->removeNames()), QStringLiteral("adm"));
    QVERIFY(!button(&widget, "_removePushButton")->isEnabled());

    // Deselecting one of two selected rows leaves Remove enabled.
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("cdrom")));
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("video"), Qt::ControlModifier));
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("video"), Qt::ControlModifier));
    QVERIFY(button(&widget, "_removePushButton")->isEnabled());

}

void ChoiceTest::disabledWidget()
{
    ChoiceWidget widget;
    widget.setChoiceModel(choiceModel);
    choiceModel->setCheckedNames({QStringLiteral("adm"), QStringLiteral("audio")});
    widget.show();
    QVERIFY(QTest::qWaitForWindowExposed(&widget));
    QVERIFY(widget.isChoiceEnabled());
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("audio")));
    QVERIFY(button(&widget, "_removePushButton")->isEnabled());

    widget.setChoiceEnabled(false);
    QVERIFY(!widget.isChoiceEnabled());
    QVERIFY(!button(&widget, "_addPushButton")->isEnabled());
    QVERIFY(!button(&widget, "_removePushButton")->isEnabled());
    QVERIFY(!treeView(&widget)->selectionModel()->hasSelection());
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("adm")));
    QVERIFY(!treeView(&widget)->selectionModel()->hasSelection());
    QVERIFY(!button(&widget, "_removePushButton")->isEnabled());

    widget.setChoiceEnabled(true);
    QVERIFY(button(&widget, "_addPushButton")->isEnabled());
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("adm")));
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("audio"), Qt::ControlModifier));
    QCOMPARE(treeView(&widget)->selectionModel()->selectedRows().size(), 2);
}

void ChoiceTest::filter_data()
{
    QTest::addColumn<int>("patternType");
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("expected");

    const QString all = QStringLiteral("audio a.b axb cdrom video");
    QTest::newRow("wildcard star") << 0 << "a*b" << "a.b axb";
    QTest::newRow("wildcard question mark") << 0 << "a?b" << "a.b axb";
    QTest::newRow("wildcard dot is literal") << 0 << "a.b" << "a.b";
    QTest::newRow("regexp dot") << 1 << "a.b" << "a.b axb";
    QTest::newRow("regexp alternatives") << 1 << "^(audio|video)$" << "audio video";
    QTest::newRow("regexp invalid") << 1 << "[" << all;
    QTest::newRow("fixed string") << 2 << "a.b" << "a.b";
    QTest::newRow("fixed string star") << 2 << "a*b" << "";
    QTest::newRow("empty") << 2 << "" << all;
}

void ChoiceTest::filter()
{
    QFETCH(int, patternType);
    QFETCH(QString, pattern);
    QFETCH(QString, expected);

    ChoiceDialog dialog;
    watch(dialog.model());
    dialog.setChoiceModel(choiceModel);
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));

    auto *type = dialog.findChild<QComboBox *>(QStringLiteral("_patternTypeComboBox"));
    QCOMPARE(type->count(), 3);
    QCOMPARE(type->itemText(0), QStringLiteral("Wildcard"));
    QCOMPARE(type->itemText(1), QStringLiteral("RegExp"));
    QCOMPARE(type->itemText(2), QStringLiteral("Fixed string"));

    // The text first, the type after: the filter follows both.
    auto *line = dialog.findChild<QLineEdit *>(QStringLiteral("_patternLineEdit"));
    line->setFocus();
    QTest::keyClicks(line, pattern);
    type->setFocus();
    for (int i = 0; i < patternType; ++i)
        QTest::keyClick(type, Qt::Key_Down);
    QCOMPARE(type->currentIndex(), patternType);
    QCOMPARE(rows(&dialog), expected);
}

void ChoiceTest::displayVariants_data()
{
    QTest::addColumn<int>("rootKind"); // 0 offering element, 1 element without the operation, 2 plain node
    QTest::addColumn<QStringList>("items");
    QTest::addColumn<bool>("enabled");

    QTest::newRow("element offering the change") << 0 << QStringList({"All", "Users", "Groups"}) << true;
    QTest::newRow("element without it") << 1 << QStringList({"All"}) << false;
    QTest::newRow("plain node") << 2 << QStringList({"All"}) << false;
}

void ChoiceTest::displayVariants()
{
    QFETCH(int, rootKind);
    QFETCH(QStringList, items);
    QFETCH(bool, enabled);

    RecordingModule module(QStringLiteral("m"));
    std::unique_ptr<TreeNode> tree;
    VariantElement *element = nullptr;
    if (rootKind < 2) {
        element = new VariantElement(module, rootKind == 0);
        element->switchTo(1);
        tree.reset(element);
    } else {
        tree.reset(new TestTreeNode(QStringLiteral("root")));
    }
    TreeString::build(tree.get(), QStringLiteral("alice bob"));
    TreeNodeModel model(tree.get());
    ChoiceTreeNodeProxyModel choices(0, Qt::CheckStateRole, Qt::CheckStateRole);
    choices.setSourceModel(&model);
    watch(&choices);

    ChoiceDialog dialog;
    dialog.setChoiceModel(&choices);
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    auto *box = dialog.findChild<QComboBox *>(QStringLiteral("_displayVariantComboBox"));
    QStringList shown;
    for (int i = 0; i < box->count(); ++i)
        shown.append(box->itemText(i));
    QCOMPARE(shown, items);
    QCOMPARE(box->isEnabled(), enabled);
    if (!element || !enabled)
        return;

    // Filling showed the element's variant without asking it to change.
    QCOMPARE(box->currentIndex(), 1);
    QCOMPARE(element->displayChildrenVariant(), 1);

    // Choosing an entry switches the element to that position.
    box->setFocus();
    QTest::keyClick(box, Qt::Key_Down);
    QCOMPARE(element->displayChildrenVariant(), 2);
    QTest::keyClick(box, Qt::Key_Home);
    QCOMPARE(element->displayChildrenVariant(), 0);

    // Shown again after the element changed elsewhere: its variant is
    // selected again, the box is not filled twice.
    dialog.hide();
    element->switchTo(2);
    dialog.show();
    QCOMPARE(box->count(), 3);
    QCOMPARE(box->currentIndex(), 2);
    QCOMPARE(element->displayChildrenVariant(), 2);
}

void ChoiceTest::singleChoice()
{
    std::unique_ptr<TestTreeNode> tree(TreeString::makeTree(QStringLiteral("a[a1 a2] hidden b")));
    static_cast<TestTreeNode *>(TreeString::find(tree.get(), QStringLiteral("hidden")))->specialFlags = 1;
    SingleChoiceDialog dialog(tree.get());
    watch(dialog.treeNodeModel());
    watch(dialog.model());
    QVERIFY(!dialog.choosenTreeNode());
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    QCOMPARE(rows(&dialog), QStringLiteral("a[a1 a2] b"));
    QTreeView *view = treeView(&dialog);

    // Expand a with the keyboard and pick a2.
    QVERIFY(clickRow(view, QStringLiteral("a")));
    QTest::keyClick(view, Qt::Key_Right);
    QVERIFY(clickRow(view, QStringLiteral("a/a2")));
    QVERIFY(okButton(&dialog)->isEnabled());
    // One node only: Ctrl+click replaces the selection.
    QVERIFY(clickRow(view, QStringLiteral("b"), Qt::ControlModifier));
    QCOMPARE(view->selectionModel()->selectedRows().size(), 1);
    QVERIFY(clickRow(view, QStringLiteral("a/a2")));
    QTest::mouseClick(okButton(&dialog), Qt::LeftButton);
    QVERIFY(!dialog.isVisible());
    QCOMPARE(dialog.choosenTreeNode(), TreeString::find(tree.get(), QStringLiteral("a/a2")));

    // Every showing starts without a selection.
    dialog.show();
    QVERIFY(!view->selectionModel()->hasSelection());
    QVERIFY(!okButton(&dialog)->isEnabled());
}

void ChoiceTest::doubleClickReportsNode()
{
    ChoiceWidget widget;
    widget.setChoiceModel(choiceModel);
    widget.show();
    QVERIFY(QTest::qWaitForWindowExposed(&widget));
    QList<TreeNode *> reports;
    connect(&widget, &ChoiceWidget::treeNodeDoubleClicked, this, [&reports](TreeNode *node) { reports.append(node); });
    QTreeView *view = treeView(&widget);
    const QPoint at = view->visualRect(findRow(view->model(), QStringLiteral("adm"))).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseRelease(view->viewport(), Qt::LeftButton, {}, at);
    QCOMPARE(reports, QList<TreeNode *>({TreeString::find(root, QStringLiteral("adm"))}));
}

void ChoiceTest::screenshots()
{
    RecordingModule module(QStringLiteral("m"));
    auto *groups = new VariantElement(module, true);
    std::unique_ptr<TreeNode> tree(groups);
    TreeString::build(tree.get(), QStringLiteral("adm audio cdrom plugdev staff sudo video"));
    TreeNodeModel model(tree.get());
    ChoiceTreeNodeProxyModel choices(0, Qt::CheckStateRole, Qt::CheckStateRole);
    choices.setSourceModel(&model);
    choices.setCheckedNames({QStringLiteral("audio"), QStringLiteral("sudo")});

    ChoiceWidget widget;
    widget.setTitle(QStringLiteral("Groups"));
    widget.setAcceptColumns({0});
    widget.setChoiceModel(&choices);
    widget.resize(300, 200);
    widget.show();
    QVERIFY(QTest::qWaitForWindowExposed(&widget));
    QVERIFY(clickRow(treeView(&widget), QStringLiteral("sudo")));
    QVERIFY(keepScreenshot(&widget, QStringLiteral("choicewidget")));

    ChoiceDialog *dialog = widget.choiceDialog();
    dialog->setAcceptColumns({0});
    QTest::mouseClick(button(&widget, "_addPushButton"), Qt::LeftButton);
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    QVERIFY(clickRow(treeView(dialog), QStringLiteral("cdrom")));
    QVERIFY(keepScreenshot(dialog, QStringLiteral("choicedialog")));
    dialog->hide();

    SingleChoiceDialog single(tree.get());
    single.show();
    QVERIFY(QTest::qWaitForWindowExposed(&single));
    QVERIFY(keepScreenshot(&single, QStringLiteral("singlechoicedialog")));
}

QTEST_MAIN(ChoiceTest)
#include "tst_choice.moc"
