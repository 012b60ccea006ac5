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

private Q_SLOTS:
    void init();

    void editorWritesEveryChange_data();
    void editorWritesEveryChange();
    void singleClickEditing_data();
    void singleClickEditing();
    void spaceTogglesSelected_data();
    void spaceTogglesSelected();

private:
    std::unique_ptr<MiscDelegateTableView> view;
    std::unique_ptr<QAbstractItemModelTester> tester;
    std::unique_ptr<QStandardItemModel> model;
    QStringList writes; // "row,column=value" for each change of the model
};

void DelegatesTest::init()
{
    // A shown table of rows of text, a choice (item index) and a number.
    view.reset();
    tester.reset();
    model.reset(new QStandardItemModel(3, 3));
    model->setHorizontalHeaderLabels({QStringLiteral("Text"), QStringLiteral("Choice"), QStringLiteral("Number")});
    for (int row = 0; row < 3; ++row) {
        model->setData(model->index(row, TextColumn), QStringLiteral("x%1").arg(row));
        model->setData(model->index(row, ChoiceColumn), 1);
        model->setData(model->index(row, NumberColumn), 97);
    }
    tester.reset(new QAbstractItemModelTester(model.get(), QAbstractItemModelTester::FailureReportingMode::QtTest));
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

void DelegatesTest::editorWritesEveryChange_data()
{
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("column");
    QTest::addColumn<QList<int>>("keys");
    QTest::addColumn<QStringList>("expected");

    // Each write fills the editor again: the cursor must stay where the user types.
    QTest::newRow("line edit keystrokes") << 1 << int(TextColumn)
        << QList<int>{Qt::Key_End, Qt::Key_A, Qt::Key_B, Qt::Key_Backspace, Qt::Key_Home, Qt::Key_Z, Qt::Key_Y}
        << QStringList({"1,0=x1a", "1,0=x1ab", "1,0=x1a", "1,0=zx1a", "1,0=zyx1a"});
    QTest::newRow("spin box steps, stops at 99") << 2 << int(NumberColumn)
        << QList<int>{Qt::Key_Up, Qt::Key_Up, Qt::Key_Up} << QStringList({"2,2=98", "2,2=99"});
    // The list is open at once, and a choice is written at once.
    QTest::newRow("combo box choice") << 0 << int(ChoiceColumn) << QList<int>{Qt::Key_Down, Qt::Key_Return}
                                      << QStringList({"0,1=2"});
}

void DelegatesTest::editorWritesEveryChange()
{
    QFETCH(int, row);
    QFETCH(int, column);
    QFETCH(QList<int>, keys);
    QFETCH(QStringList, expected);

    const QModelIndex cell = model->index(row, column);
    click(view.get(), cell);
    QWidget *editor = view->indexWidget(cell);
    QVERIFY(editor);
    QCOMPARE(editor->geometry(), view->visualRect(cell));
    auto *box = qobject_cast<QComboBox *>(editor);
    if (box)
        QTRY_VERIFY(box->view()->isVisible());
    for (int key : keys)
        QTest::keyClick(box ? box->view() : editor, Qt::Key(key));
    QCOMPARE(writes, expected);
    // Nothing waited for the editor to close, and filling it again after
    // each write did not drop the list down again.
    QCOMPARE(view->indexWidget(cell), editor);
    QVERIFY(!box || !box->view()->isVisible());
    // A picture of the table with an editor open (the last row's is kept).
    QVERIFY(keepScreenshot(view.get(), QStringLiteral("miscdelegatetableview")));
}

void DelegatesTest::singleClickEditing_data()
{
    QTest::addColumn<bool>("miscDelegate");
    QTest::addColumn<bool>("doubleClickTrigger");
    QTest::addColumn<bool>("doubleClick"); // else a single click
    QTest::addColumn<bool>("opened");

    QTest::newRow("double click alone refused") << true << true << true << false;
    QTest::newRow("click, trigger not set") << true << false << false << false;
    QTest::newRow("other delegate, click") << false << true << false << false;
    QTest::newRow("other delegate, double click") << false << true << true << true;
}

void DelegatesTest::singleClickEditing()
{
    QFETCH(bool, miscDelegate);
    QFETCH(bool, doubleClickTrigger);
    QFETCH(bool, doubleClick);
    QFETCH(bool, opened);

    if (!miscDelegate)
        view->setItemDelegateForColumn(TextColumn, nullptr);
    view->setEditTriggers(doubleClickTrigger ? QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed
                                             : QAbstractItemView::EditKeyPressed);
    const QModelIndex cell = model->index(1, TextColumn);
    const QPoint at = view->visualRect(cell).center();
    // For a double click no release comes between the press and the
    // double-click event, so the double click reaches edit() alone.
    QTest::mousePress(view->viewport(), Qt::LeftButton, {}, at);
    if (doubleClick)
        QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseRelease(view->viewport(), Qt::LeftButton, {}, at);
    QCOMPARE(view->indexWidget(cell) != nullptr, opened);
}

void DelegatesTest::spaceTogglesSelected_data()
{
    QTest::addColumn<QString>("states");    // a row each: 0 unticked, 2 ticked, - without a check box
    QTest::addColumn<QList<int>>("clicks"); // rows clicked in order, Ctrl held after the first
    QTest::addColumn<QString>("expected");

    QTest::newRow("three selected") << "020" << QList<int>{0, 1, 2} << "202";
    // Fewer than two check boxes selected: the current one toggles as in any tree view.
    QTest::newRow("one checkable selected") << "0-0" << QList<int>{1, 0} << "2-0";
}

void DelegatesTest::spaceTogglesSelected()
{
    QFETCH(QString, states);
    QFETCH(QList<int>, clicks);
    QFETCH(QString, expected);

    for (int row = 0; row < 3; ++row) {
        model->item(row)->setCheckable(states.at(row) != QLatin1Char('-'));
        if (model->item(row)->isCheckable())
            model->item(row)->setCheckState(Qt::CheckState(states.at(row).digitValue()));
    }
    // Rows are selected whole: the cells without check boxes are selected too.
    MultiCheckTreeView tree;
    tree.setModel(model.get());
    tree.setSelectionMode(QAbstractItemView::ExtendedSelection);
    tree.show();
    QVERIFY(QTest::qWaitForWindowExposed(&tree));
    for (int i = 0; i < clicks.size(); ++i)
        click(&tree, model->index(clicks.at(i), 0), i ? Qt::ControlModifier : Qt::NoModifier);

    QTest::keyClick(&tree, Qt::Key_Space);
    QVERIFY(!tree.findChild<QLineEdit *>()); // no editor opened on a cell without a check box
    QString result;
    for (int row = 0; row < 3; ++row)
        result += model->item(row)->isCheckable() ? QString::number(model->item(row)->checkState()) : QStringLiteral("-");
    QCOMPARE(result, expected);
}

QTEST_MAIN(DelegatesTest)
#include "tst_delegates.moc"
