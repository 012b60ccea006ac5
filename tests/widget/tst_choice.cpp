// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
// view and returns where; a missing row gives the null point.
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

private Q_SLOTS:
    void init()
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
    void cleanup()
    {
        delete testers;
        delete widget;
        delete choiceModel;
        delete treeModel;
        delete root;
    }

    void chooseAndRemove()
    {
        // The dialog offers the unticked names; OK needs a selection.
        QTest::mouseClick(button(widget, "_addPushButton"), Qt::LeftButton);
        QVERIFY(QTest::qWaitForWindowExposed(dialog));
        QVERIFY(keepScreenshot(widget, "choicewidget") && keepScreenshot(dialog, "choicedialog"));
        QCOMPARE(rows(dialog), QStringLiteral("audio a.b axb cdrom video"));
        QVERIFY(!okButton(dialog)->isEnabled());
        QVERIFY(!clickRow(dialog, QStringLiteral("audio")).isNull());
        clickRow(dialog, QStringLiteral("cdrom"), Qt::ControlModifier);
        QTest::mouseClick(okButton(dialog), Qt::LeftButton);
        QCOMPARE(rows(widget), QStringLiteral("adm audio cdrom"));

        // Remove unticks every selected name, one added just now and one
        // that was ticked from the start.
        clickRow(widget, QStringLiteral("audio"));
        clickRow(widget, QStringLiteral("adm"), Qt::ControlModifier);
        QTest::mouseClick(button(widget, "_removePushButton"), Qt::LeftButton);
        QCOMPARE(rows(dialog), QStringLiteral("adm audio a.b axb video"));
        QCOMPARE(choiceModel->addNames(), QSet<QString>({"cdrom"}));
        QCOMPARE(choiceModel->removeNames(), QSet<QString>({"adm"}));

        // Choosing disabled: the selection goes and neither button works.
        clickRow(widget, QStringLiteral("cdrom"));
        widget->setChoiceEnabled(false);
        QVERIFY(!treeView(widget)->selectionModel()->hasSelection());
        QVERIFY(!button(widget, "_addPushButton")->isEnabled() && !button(widget, "_removePushButton")->isEnabled());
    }

    void displayVariants()
    {
        // Filling the list selects the element's variant, without switching
        // it meanwhile; choosing an entry switches it.
        ChangeDisplayElementData users(1);
        root->performOperation(ChangeDisplayOperation, &users, 0);
        dialog->show();
        auto *box = dialog->findChild<QComboBox *>(QStringLiteral("_displayVariantComboBox"));
        QCOMPARE(box->itemText(0) + QLatin1Char(' ') + box->itemText(2), QStringLiteral("All Groups"));
        QCOMPARE(box->currentIndex(), 1);
        box->setFocus();
        QTest::keyClick(box, Qt::Key_Down);
        QCOMPARE(root->displayChildrenVariant(), 2);
    }

    void singleChoice()
    {
        // A node with special flags is not offered.
        TestTreeNode *tree = TreeString::makeTree(QStringLiteral("a[a1 a2] hidden b"), testers);
        static_cast<TestTreeNode *>(TreeString::find(tree, QStringLiteral("hidden")))->specialFlags = 1;
        SingleChoiceDialog single(tree);
        watch({single.treeNodeModel(), single.model()});
        single.show();
        QVERIFY(QTest::qWaitForWindowExposed(&single));
        QCOMPARE(rows(&single), QStringLiteral("a[a1 a2] b"));
        QVERIFY(keepScreenshot(&single, "singlechoicedialog"));
        // Expand a with the keyboard and pick a2; Ctrl+click replaces the
        // selection, as one node only can be chosen.
        clickRow(&single, QStringLiteral("a"));
        QTest::keyClick(treeView(&single), Qt::Key_Right);
        QVERIFY(!clickRow(&single, QStringLiteral("a/a2"), Qt::ControlModifier).isNull());
        QCOMPARE(treeView(&single)->selectionModel()->selectedRows().size(), 1);
        QTest::mouseClick(okButton(&single), Qt::LeftButton);
        QCOMPARE(single.choosenTreeNode(), TreeString::find(tree, QStringLiteral("a/a2")));
    }
};

QTEST_MAIN(ChoiceTest)
#include "tst_choice.moc"
