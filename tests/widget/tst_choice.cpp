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
#include <QtTest>
#include <QtWidgets>

#include <memory>

namespace {

// A container that can show its children as "Users" or "Groups" besides "All".
struct VariantElement : TestElement<ContainerElement> {
    explicit VariantElement(Module &module) : TestElement<ContainerElement>(module, rightsYes, QStringLiteral("group")) {}
    quint64 availableOperations() const override { return ContainerElement::availableOperations() | ChangeDisplayOperation; }
    QStringList displayChildrenVariants() const override { return {QStringLiteral("Users"), QStringLiteral("Groups")}; }
};

QTreeView *treeView(QWidget *widget) { return widget->findChild<QTreeView *>(QStringLiteral("_nodeTreeView")); }
QString rows(QWidget *widget) { return TreeString::fromModel(treeView(widget)->model()); }
QPushButton *button(QWidget *widget, const char *name) { return widget->findChild<QPushButton *>(QLatin1String(name)); }
QPushButton *okButton(QWidget *dialog) { return dialog->findChild<QDialogButtonBox *>()->button(QDialogButtonBox::Ok); }

// Clicks the row reached by a path of display texts ("a/a2") in a shown
// view and returns where; with Ctrl the row is added to (or taken from) the
// selection. A missing row gives the null point.
QPoint clickRow(QWidget *widget, const QString &path, Qt::KeyboardModifiers modifiers = {})
{
    QTreeView *view = treeView(widget);
    QModelIndex index;
    for (const QString &name : path.split(QLatin1Char('/')))
        index = view->model()->match(view->model()->index(0, 0, index), Qt::DisplayRole, name, 1, Qt::MatchExactly).value(0);
    const QPoint at = index.isValid() ? view->visualRect(index).center() : QPoint();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, modifiers, at);
    return at;
}

} // namespace

class ChoiceTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void chooseAndRemove();
    void filter_data();
    void filter();
    void displayVariants();
    void singleChoice();
    void screenshots();

private:
    RecordingModule module{QStringLiteral("m")};
    VariantElement *root = nullptr;
    TreeNodeModel *treeModel = nullptr;
    ChoiceTreeNodeProxyModel *choiceModel = nullptr;
    ChoiceWidget *widget = nullptr; // shown, its dialog not yet
    ChoiceDialog *dialog = nullptr;
    QObject *testers = nullptr; // owns a model tester on every model, for the whole test

    void watch(const QList<QAbstractItemModel *> &models)
    {
        for (QAbstractItemModel *model : models)
            new QAbstractItemModelTester(model, QAbstractItemModelTester::FailureReportingMode::QtTest, testers);
    }
};

void ChoiceTest::init()
{
    root = new VariantElement(module);
    TreeString::build(root, QStringLiteral("adm audio a.b axb cdrom video"));
    treeModel = new TreeNodeModel(root);
    choiceModel = new ChoiceTreeNodeProxyModel(0, Qt::CheckStateRole, Qt::CheckStateRole);
    choiceModel->setSourceModel(treeModel);
    choiceModel->setCheckedNames({QStringLiteral("adm")});
    widget = new ChoiceWidget;
    dialog = widget->choiceDialog();
    testers = new QObject;
    watch({treeModel, choiceModel, treeView(widget)->model(), dialog->model()});
    widget->setChoiceModel(choiceModel);
    widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(widget));
}

void ChoiceTest::cleanup()
{
    delete testers;
    delete widget;
    delete choiceModel;
    delete treeModel;
    delete root;
}

void ChoiceTest::chooseAndRemove()
{
    QCOMPARE(rows(widget), QStringLiteral("adm"));

    // The dialog offers the unticked names; OK needs a selection.
    QTest::mouseClick(button(widget, "_addPushButton"), Qt::LeftButton);
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    QCOMPARE(dialog->windowTitle(), QStringLiteral("Choice"));
    QCOMPARE(rows(dialog), QStringLiteral("audio a.b axb cdrom video"));
    QVERIFY(!okButton(dialog)->isEnabled());
    QVERIFY(!clickRow(dialog, QStringLiteral("audio")).isNull());
    QVERIFY(okButton(dialog)->isEnabled());
    clickRow(dialog, QStringLiteral("cdrom"), Qt::ControlModifier);
    QTest::mouseClick(okButton(dialog), Qt::LeftButton);
    QCOMPARE(rows(widget), QStringLiteral("adm audio cdrom"));
    QCOMPARE(choiceModel->addNames(), QSet<QString>({"audio", "cdrom"}));

    // Remove unticks every selected name, one added just now and one that
    // was ticked from the start.
    clickRow(widget, QStringLiteral("audio"));
    clickRow(widget, QStringLiteral("adm"), Qt::ControlModifier);
    QTest::mouseClick(button(widget, "_removePushButton"), Qt::LeftButton);
    QCOMPARE(rows(widget), QStringLiteral("cdrom"));
    QCOMPARE(rows(dialog), QStringLiteral("adm audio a.b axb video"));
    QCOMPARE(choiceModel->addNames(), QSet<QString>({"cdrom"}));
    QCOMPARE(choiceModel->removeNames(), QSet<QString>({"adm"}));
    QVERIFY(!button(widget, "_removePushButton")->isEnabled());

    // A double click on a ticked row reports its node.
    QList<TreeNode *> reports;
    connect(widget, &ChoiceWidget::treeNodeDoubleClicked, this, [&reports](TreeNode *node) { reports.append(node); });
    QTest::mouseDClick(treeView(widget)->viewport(), Qt::LeftButton, {}, clickRow(widget, QStringLiteral("cdrom")));
    QCOMPARE(reports, QList<TreeNode *>({TreeString::find(root, QStringLiteral("cdrom"))}));

    // Choosing disabled: the selection goes, none can be made, neither button works.
    widget->setChoiceEnabled(false);
    clickRow(widget, QStringLiteral("cdrom"));
    QVERIFY(!treeView(widget)->selectionModel()->hasSelection());
    QVERIFY(!button(widget, "_addPushButton")->isEnabled() && !button(widget, "_removePushButton")->isEnabled());
}

void ChoiceTest::filter_data()
{
    QTest::addColumn<int>("patternType"); // the entries "Wildcard", "RegExp", "Fixed string"
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("expected");

    QTest::newRow("wildcard") << 0 << "a?b" << "a.b axb";
    QTest::newRow("regexp dot") << 1 << "a.b" << "a.b axb";
    QTest::newRow("regexp invalid") << 1 << "[" << "audio a.b axb cdrom video";
    QTest::newRow("fixed string star") << 2 << "a*b" << "";
}

void ChoiceTest::filter()
{
    QFETCH(int, patternType);
    QFETCH(QString, pattern);
    QFETCH(QString, expected);

    dialog->show();
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    auto *type = dialog->findChild<QComboBox *>(QStringLiteral("_patternTypeComboBox"));
    // The text first, the type after: the filter follows both.
    auto *line = dialog->findChild<QLineEdit *>(QStringLiteral("_patternLineEdit"));
    line->setFocus();
    QTest::keyClicks(line, pattern);
    type->setFocus();
    for (int i = 0; i < patternType; ++i)
        QTest::keyClick(type, Qt::Key_Down);
    QCOMPARE(rows(dialog), expected);
}

void ChoiceTest::displayVariants()
{
    // Filling the list selects the element's variant, without switching it meanwhile;
    // choosing an entry switches it.
    ChangeDisplayElementData users(1), all(0);
    root->performOperation(ChangeDisplayOperation, &users, 0);
    dialog->show();
    auto *box = dialog->findChild<QComboBox *>(QStringLiteral("_displayVariantComboBox"));
    QCOMPARE(box->itemText(0) + QLatin1Char(' ') + box->itemText(2), QStringLiteral("All Groups"));
    QCOMPARE(box->currentIndex(), 1);
    box->setFocus();
    QTest::keyClick(box, Qt::Key_Down);
    QCOMPARE(root->displayChildrenVariant(), 2);

    // Shown again after the element changed elsewhere: its variant is
    // selected, and the entries are not added twice.
    dialog->hide();
    root->performOperation(ChangeDisplayOperation, &all, 0);
    dialog->show();
    QCOMPARE(box->count(), 3);
    QCOMPARE(box->currentIndex(), 0);
}

void ChoiceTest::singleChoice()
{
    // A node with special flags is not offered.
    std::unique_ptr<TestTreeNode> tree(TreeString::makeTree(QStringLiteral("a[a1 a2] hidden b")));
    static_cast<TestTreeNode *>(TreeString::find(tree.get(), QStringLiteral("hidden")))->specialFlags = 1;
    SingleChoiceDialog single(tree.get());
    watch({single.treeNodeModel(), single.model()});
    single.show();
    QVERIFY(QTest::qWaitForWindowExposed(&single));
    QCOMPARE(rows(&single), QStringLiteral("a[a1 a2] b"));

    // Expand a with the keyboard and pick a2; Ctrl+click replaces the
    // selection, as one node only can be chosen.
    clickRow(&single, QStringLiteral("a"));
    QTest::keyClick(treeView(&single), Qt::Key_Right);
    QVERIFY(!clickRow(&single, QStringLiteral("a/a2"), Qt::ControlModifier).isNull());
    QCOMPARE(treeView(&single)->selectionModel()->selectedRows().size(), 1);
    QTest::mouseClick(okButton(&single), Qt::LeftButton);
    QCOMPARE(single.choosenTreeNode(), TreeString::find(tree.get(), QStringLiteral("a/a2")));

    // Every showing starts without a selection.
    single.show();
    QVERIFY(!treeView(&single)->selectionModel()->hasSelection());
    QVERIFY(!okButton(&single)->isEnabled());
}

void ChoiceTest::screenshots()
{
    SingleChoiceDialog single(root);
    for (QWidget *shown : QList<QWidget *>{widget, dialog, &single}) {
        shown->show();
        QVERIFY(QTest::qWaitForWindowExposed(shown));
        QVERIFY(keepScreenshot(shown, QString::fromLatin1(shown->metaObject()->className()).toLower()));
    }
}

QTEST_MAIN(ChoiceTest)
#include "tst_choice.moc"
