// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/comboboxdelegate.h>
#include <kvt-common/lineeditdelegate.h>
#include <kvt-common/miscdelegatetableview.h>
#include <kvt-common/multichecktreeview.h>
#include <kvt-common/spinboxdelegate.h>

#include "screenshot.h"

#include <QAbstractItemModelTester>
#include <QtTest>
#include <QtWidgets>

#include <memory>

namespace {

// A combo box delegate as modules write them: the base makes the box, the
// subclass supplies the items.
struct NamesComboBoxDelegate : ComboBoxDelegate {
    using ComboBoxDelegate::ComboBoxDelegate;
    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option, const QModelIndex &index) const override
    {
        auto *box = static_cast<QComboBox *>(ComboBoxDelegate::createEditor(parent, option, index));
        box->addItems({QStringLiteral("zero"), QStringLiteral("one"), QStringLiteral("two")});
        return box;
    }
};

enum Column { TextColumn, ChoiceColumn, NumberColumn };

void click(QAbstractItemView *view, const QModelIndex &index, Qt::KeyboardModifiers modifiers = {})
{
    QTest::mouseClick(view->viewport(), Qt::LeftButton, modifiers, view->visualRect(index).center());
}

} // namespace

class DelegatesTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<MiscDelegateTableView> view;
    std::unique_ptr<QStandardItemModel> model;
    QStringList writes; // "row,column=value" for each change of the model

private Q_SLOTS:
    void init()
    {
        // A shown table of rows of text, a choice (item index) and a number.
        view.reset();
        model.reset(new QStandardItemModel(3, 3));
        for (int row = 0; row < 3; ++row) {
            model->setData(model->index(row, TextColumn), QStringLiteral("x%1").arg(row));
            model->setData(model->index(row, ChoiceColumn), 1);
            model->setData(model->index(row, NumberColumn), 97);
        }
        new QAbstractItemModelTester(model.get(), QAbstractItemModelTester::FailureReportingMode::QtTest, model.get());
        writes.clear();
        connect(model.get(), &QAbstractItemModel::dataChanged, this, [this](const QModelIndex &from) {
            writes.append(QStringLiteral("%1,%2=%3").arg(from.row()).arg(from.column()).arg(from.data().toString()));
        });
        view.reset(new MiscDelegateTableView);
        view->setModel(model.get());
        view->setItemDelegateForColumn(TextColumn, new LineEditDelegate(view.get()));
        view->setItemDelegateForColumn(ChoiceColumn, new NamesComboBoxDelegate(view.get()));
        view->setItemDelegateForColumn(NumberColumn, new SpinBoxDelegate(view.get()));
        view->resize(360, 160);
        view->show();
        QVERIFY(QTest::qWaitForWindowExposed(view.get()));
    }

    void editorWritesEveryChange_data()
    {
        QTest::addColumn<int>("row");
        QTest::addColumn<int>("column");
        QTest::addColumn<QList<int>>("keys");
        QTest::addColumn<QStringList>("expected");
        // Each write fills the editor again: the cursor must stay where the user types.
        QTest::newRow("line edit keystrokes") << 1 << int(TextColumn)
            << QList<int>{Qt::Key_End, Qt::Key_A, Qt::Key_B, Qt::Key_Backspace, Qt::Key_Home, Qt::Key_Z}
            << QStringList({"1,0=x1a", "1,0=x1ab", "1,0=x1a", "1,0=zx1a"});
        QTest::newRow("spin box steps, stops at 99") << 2 << int(NumberColumn)
            << QList<int>{Qt::Key_Up, Qt::Key_Up, Qt::Key_Up} << QStringList({"2,2=98", "2,2=99"});
        // The list is open at once, and a choice is written at once.
        QTest::newRow("combo box choice") << 0 << int(ChoiceColumn) << QList<int>{Qt::Key_Down, Qt::Key_Return}
                                          << QStringList({"0,1=2"});
    }
    void editorWritesEveryChange()
    {
        QFETCH(int, row);
        QFETCH(int, column);
        QFETCH(QList<int>, keys);
        const QModelIndex cell = model->index(row, column);
        click(view.get(), cell);
        QWidget *editor = view->indexWidget(cell);
        QVERIFY(editor);
        auto *box = qobject_cast<QComboBox *>(editor);
        if (box)
            QTRY_VERIFY(box->view()->isVisible());
        for (int key : keys)
            QTest::keyClick(box ? box->view() : editor, Qt::Key(key));
        QTEST(writes, "expected");
        // Nothing waited for the editor to close, and filling it again after
        // each write did not drop the list down again.
        QCOMPARE(view->indexWidget(cell), editor);
        QVERIFY(!box || !box->view()->isVisible());
        QVERIFY(keepScreenshot(view.get(), QStringLiteral("miscdelegatetableview")));
    }

    void singleClickEditing_data()
    {
        QTest::addColumn<bool>("doubleClick"); // with the double-click trigger; else a click without it
        QTest::newRow("double click alone refused") << true;
        QTest::newRow("click, trigger not set") << false;
    }
    void singleClickEditing()
    {
        // The table opens its editors on a single click, and only when
        // double clicks are among its edit triggers.
        QFETCH(bool, doubleClick);
        view->setEditTriggers(doubleClick ? QAbstractItemView::DoubleClicked : QAbstractItemView::EditKeyPressed);
        const QModelIndex cell = model->index(1, TextColumn);
        const QPoint at = view->visualRect(cell).center();
        // For a double click no release comes between the press and the
        // double-click event, so the double click reaches edit() alone.
        QTest::mousePress(view->viewport(), Qt::LeftButton, {}, at);
        if (doubleClick)
            QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
        QTest::mouseRelease(view->viewport(), Qt::LeftButton, {}, at);
        QVERIFY(!view->indexWidget(cell));
    }

    void spaceTogglesSelected()
    {
        // Rows 0 and 2 unticked, row 1 ticked; rows are selected whole, so the
        // cells without check boxes are selected too.
        for (int row = 0; row < 3; ++row)
            model->item(row)->setCheckable(true), model->item(row)->setCheckState(row == 1 ? Qt::Checked : Qt::Unchecked);
        MultiCheckTreeView tree;
        tree.setModel(model.get());
        tree.setSelectionMode(QAbstractItemView::ExtendedSelection);
        tree.show();
        QVERIFY(QTest::qWaitForWindowExposed(&tree));
        for (int row = 0; row < 3; ++row)
            click(&tree, model->index(row, 0), row ? Qt::ControlModifier : Qt::NoModifier);
        QTest::keyClick(&tree, Qt::Key_Space);
        QVERIFY(!tree.findChild<QLineEdit *>()); // no editor opened on a cell without a check box
        for (int row = 0; row < 3; ++row)
            QCOMPARE(model->item(row)->checkState(), row == 1 ? Qt::Unchecked : Qt::Checked);
    }
};

QTEST_MAIN(DelegatesTest)
#include "tst_delegates.moc"
