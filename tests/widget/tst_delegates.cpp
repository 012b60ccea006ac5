#include <kvt-common/comboboxdelegate.h>
#include <kvt-common/lineeditdelegate.h>
#include <kvt-common/miscdelegatetableview.h>
#include <kvt-common/multichecktreeview.h>
#include <kvt-common/spinboxdelegate.h>

#include "screenshot.h"

#include <QAbstractItemModelTester>
#include <QComboBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QPointer>
#include <QSpinBox>
#include <QStandardItemModel>
#include <QtTest>

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
    void cleanup();

    void lineEditWritesEveryKeystroke();
    void spinBoxWritesEveryStep_data();
    void spinBoxWritesEveryStep();
    void comboBoxOpensOnce();
    void comboBoxRefillKeepsListClosed();
    void wrongEditorOrIndexIgnored_data();
    void wrongEditorOrIndexIgnored();
    void singleClickEditing_data();
    void singleClickEditing();
    void spaceTogglesSelected_data();
    void spaceTogglesSelected();
    void screenshot();

private:
    QStandardItemModel *model = nullptr;
    std::unique_ptr<QAbstractItemModelTester> tester;
    QStringList writes; // "row,column=value" for each change of the model

    QVariant value(int row, int column) const { return model->index(row, column).data(Qt::EditRole); }
};

void DelegatesTest::init()
{
    // Rows of text, a choice (item index) and a number.
    model = new QStandardItemModel(3, 3, this);
    for (int row = 0; row < 3; ++row) {
        model->setData(model->index(row, TextColumn), QStringLiteral("x%1").arg(row));
        model->setData(model->index(row, ChoiceColumn), 1);
        model->setData(model->index(row, NumberColumn), 5);
    }
    model->setHorizontalHeaderLabels({QStringLiteral("Text"), QStringLiteral("Choice"), QStringLiteral("Number")});
    tester.reset(new QAbstractItemModelTester(model, QAbstractItemModelTester::FailureReportingMode::QtTest));
    writes.clear();
    connect(model, &QAbstractItemModel::dataChanged, this, [this](const QModelIndex &from) {
        writes.append(QStringLiteral("%1,%2=%3").arg(from.row()).arg(from.column()).arg(from.data().toString()));
    });
}

void DelegatesTest::cleanup()
{
    tester.reset();
    delete model;
    model = nullptr;
}

void DelegatesTest::lineEditWritesEveryKeystroke()
{
    MiscDelegateTableView view;
    view.setModel(model);
    view.setItemDelegateForColumn(TextColumn, new LineEditDelegate(&view));
    view.show();
    QVERIFY(QTest::qWaitForWindowExposed(&view));

    const QModelIndex cell = model->index(1, TextColumn);
    click(&view, cell);
    auto *editor = qobject_cast<QLineEdit *>(view.indexWidget(cell));
    QVERIFY(editor);
    QCOMPARE(editor->geometry(), view.visualRect(cell));
    QCOMPARE(editor->text(), QStringLiteral("x1"));

    QTest::keyClick(editor, Qt::Key_End);
    QTest::keyClicks(editor, QStringLiteral("ab"));
    QTest::keyClick(editor, Qt::Key_Backspace);
    QCOMPARE(writes, QStringList({"1,0=x1a", "1,0=x1ab", "1,0=x1a"}));
    // Still editing: nothing waited for Enter or for the editor to close.
    QCOMPARE(view.indexWidget(cell), editor);

    // Each write fills the editor again; the cursor must stay where the
    // user types.
    QTest::keyClick(editor, Qt::Key_Home);
    QTest::keyClicks(editor, QStringLiteral("z"));
    QCOMPARE(value(1, TextColumn).toString(), QStringLiteral("zx1a"));
    QCOMPARE(editor->cursorPosition(), 1);
}

void DelegatesTest::spinBoxWritesEveryStep_data()
{
    QTest::addColumn<int>("start");
    QTest::addColumn<int>("steps"); // up when positive, down when negative
    QTest::addColumn<QStringList>("values");

    QTest::newRow("steps up") << 5 << 2 << QStringList({"6", "7"});
    QTest::newRow("stops at 99") << 98 << 3 << QStringList({"99"});
    QTest::newRow("stops at 0") << 1 << -3 << QStringList({"0"});
}

void DelegatesTest::spinBoxWritesEveryStep()
{
    QFETCH(int, start);
    QFETCH(int, steps);
    QFETCH(QStringList, values);

    const QModelIndex cell = model->index(2, NumberColumn);
    model->setData(cell, start);
    writes.clear();

    MiscDelegateTableView view;
    view.setModel(model);
    view.setItemDelegateForColumn(NumberColumn, new SpinBoxDelegate(&view));
    view.show();
    QVERIFY(QTest::qWaitForWindowExposed(&view));
    click(&view, cell);
    auto *editor = qobject_cast<QSpinBox *>(view.indexWidget(cell));
    QVERIFY(editor);
    QCOMPARE(editor->value(), start);
    QVERIFY(writes.isEmpty()); // filling the editor writes nothing back

    for (int i = 0; i < qAbs(steps); ++i)
        QTest::keyClick(editor, steps > 0 ? Qt::Key_Up : Qt::Key_Down);
    QStringList expected;
    for (const QString &v : qAsConst(values))
        expected.append(QStringLiteral("2,2=") + v);
    QCOMPARE(writes, expected);
}

void DelegatesTest::comboBoxOpensOnce()
{
    MiscDelegateTableView view;
    view.setModel(model);
    view.setItemDelegateForColumn(ChoiceColumn, new NamesComboBoxDelegate(&view));
    view.show();
    QVERIFY(QTest::qWaitForWindowExposed(&view));

    const QModelIndex cell = model->index(0, ChoiceColumn);
    click(&view, cell);
    QPointer<QComboBox> editor = qobject_cast<QComboBox *>(view.indexWidget(cell));
    QVERIFY(editor);
    QCOMPARE(editor->currentIndex(), 1);
    QTRY_VERIFY(editor->view()->isVisible());
    QVERIFY(writes.isEmpty());

    // Choosing in the list writes the choice at once, before the editor
    // closes. (Whether it stays open afterwards depends on the window
    // system: the offscreen one hands activation to the popup for good.)
    QTest::keyClick(editor->view(), Qt::Key_Down);
    QTest::keyClick(editor->view(), Qt::Key_Return);
    QCOMPARE(writes, QStringList({"0,1=2"}));
    QTRY_VERIFY(!editor || !editor->view()->isVisible());
    QCOMPARE(value(0, ChoiceColumn).toInt(), 2);
}

void DelegatesTest::comboBoxRefillKeepsListClosed()
{
    NamesComboBoxDelegate delegate;
    QWidget parent;
    parent.show();
    QVERIFY(QTest::qWaitForWindowExposed(&parent));
    QSignalSpy commits(&delegate, SIGNAL(commitData(QWidget*)));
    const QModelIndex cell = model->index(1, ChoiceColumn);
    model->setData(cell, 2);

    auto *box = qobject_cast<QComboBox *>(delegate.createEditor(&parent, QStyleOptionViewItem(), cell));
    QVERIFY(box);
    box->show();
    commits.clear(); // the subclass's items moved the box off -1 while it was made
    delegate.setEditorData(box, cell);
    QCOMPARE(box->currentIndex(), 2);
    QTRY_VERIFY(box->view()->isVisible());
    box->hidePopup();
    QTRY_VERIFY(!box->view()->isVisible());

    // Filled again later (the model changed): new value, list stays closed,
    // and filling is not taken for a choice.
    model->setData(cell, 0);
    delegate.setEditorData(box, cell);
    QCOMPARE(box->currentIndex(), 0);
    QTest::qWait(20);
    QVERIFY(!box->view()->isVisible());
    QCOMPARE(commits.count(), 0);

}

void DelegatesTest::wrongEditorOrIndexIgnored_data()
{
    QTest::addColumn<int>("kind");
    QTest::newRow("combo box") << 0;
    QTest::newRow("spin box") << 1;
    QTest::newRow("line edit") << 2;
}

void DelegatesTest::wrongEditorOrIndexIgnored()
{
    QFETCH(int, kind);
    using Delegate = MiscStyledItemDelegate;
    std::unique_ptr<Delegate> delegate(kind == 0   ? static_cast<Delegate *>(new NamesComboBoxDelegate)
                                       : kind == 1 ? static_cast<Delegate *>(new SpinBoxDelegate)
                                                   : new LineEditDelegate);
    const QModelIndex cell = model->index(0, kind == 2 ? TextColumn : NumberColumn);
    QWidget parent;
    QWidget *editor = delegate->createEditor(&parent, QStyleOptionViewItem(), cell);
    QSignalSpy commits(delegate.get(), SIGNAL(commitData(QWidget*)));
    QWidget plain(&parent);
    QLineEdit lineEdit(&parent);
    QWidget *wrong = kind == 2 ? &plain : &lineEdit;

    delegate->setModelData(wrong, model, cell);
    delegate->setModelData(editor, model, QModelIndex());
    delegate->setModelData(editor, nullptr, cell);
    delegate->setEditorData(wrong, cell);
    delegate->setEditorData(editor, QModelIndex());
    // Filling the right editor from the model is not an edit either.
    delegate->setEditorData(editor, cell);
    QCOMPARE(commits.count(), 0);
    QVERIFY(writes.isEmpty());
    if (auto *box = qobject_cast<QComboBox *>(editor))
        box->hidePopup();
}

void DelegatesTest::singleClickEditing_data()
{
    QTest::addColumn<bool>("miscView");
    QTest::addColumn<bool>("miscDelegate");
    QTest::addColumn<bool>("doubleClickTrigger");
    QTest::addColumn<bool>("doubleClick"); // else a single click
    QTest::addColumn<bool>("opened");

    QTest::newRow("click opens") << true << true << true << false << true;
    QTest::newRow("double click alone refused") << true << true << true << true << false;
    QTest::newRow("click, trigger not set") << true << true << false << false << false;
    QTest::newRow("other delegate, click") << true << false << true << false << false;
    QTest::newRow("other delegate, double click") << true << false << true << true << true;
    QTest::newRow("plain table, click") << false << true << true << false << false;
    QTest::newRow("plain table, double click") << false << true << true << true << true;
}

void DelegatesTest::singleClickEditing()
{
    QFETCH(bool, miscView);
    QFETCH(bool, miscDelegate);
    QFETCH(bool, doubleClickTrigger);
    QFETCH(bool, doubleClick);
    QFETCH(bool, opened);

    std::unique_ptr<QTableView> view(miscView ? new MiscDelegateTableView : new QTableView);
    view->setModel(model);
    if (miscDelegate)
        view->setItemDelegateForColumn(TextColumn, new LineEditDelegate(view.get()));
    view->setEditTriggers(doubleClickTrigger ? QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed
                                             : QAbstractItemView::EditKeyPressed);
    view->show();
    QVERIFY(QTest::qWaitForWindowExposed(view.get()));
    if (miscView)
        QCOMPARE(view->horizontalHeader()->defaultAlignment(), Qt::Alignment(Qt::AlignLeft));

    const QModelIndex cell = model->index(1, TextColumn);
    const QPoint at = view->visualRect(cell).center();
    if (doubleClick) {
        // The press and the double-click event without the release of a
        // first click between them: the double click reaches edit() alone.
        QTest::mousePress(view->viewport(), Qt::LeftButton, {}, at);
        QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
        QTest::mouseRelease(view->viewport(), Qt::LeftButton, {}, at);
    } else {
        QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, at);
    }
    QCOMPARE(view->indexWidget(cell) != nullptr, opened);
}

void DelegatesTest::spaceTogglesSelected_data()
{
    QTest::addColumn<bool>("multiView");
    QTest::addColumn<QString>("items");    // "a b*": * ticked, - not checkable
    QTest::addColumn<QList<int>>("clicks"); // rows clicked in order, Ctrl held after the first
    QTest::addColumn<QString>("expected");

    QTest::newRow("three selected") << true << "a b* c d" << QList<int>{0, 1, 2} << "a* b c* d";
    QTest::newRow("one selected") << true << "a b* c d" << QList<int>{1} << "a b c d";
    QTest::newRow("one checkable selected") << true << "a b- c d" << QList<int>{1, 0} << "a* b- c d";
    QTest::newRow("two apart") << true << "a b c d*" << QList<int>{3, 0} << "a* b c d";
    QTest::newRow("plain tree view") << false << "a b* c d" << QList<int>{0, 1, 2} << "a b* c* d";
}

void DelegatesTest::spaceTogglesSelected()
{
    QFETCH(bool, multiView);
    QFETCH(QString, items);
    QFETCH(QList<int>, clicks);
    QFETCH(QString, expected);

    QStandardItemModel checks;
    QAbstractItemModelTester checksTester(&checks, QAbstractItemModelTester::FailureReportingMode::QtTest);
    for (QString text : items.split(QLatin1Char(' '))) {
        auto *item = new QStandardItem;
        const bool checkable = !text.endsWith(QLatin1Char('-'));
        const bool ticked = text.endsWith(QLatin1Char('*'));
        if (!checkable || ticked)
            text.chop(1);
        item->setText(text);
        item->setEditable(false);
        item->setCheckable(checkable);
        if (checkable)
            item->setCheckState(ticked ? Qt::Checked : Qt::Unchecked);
        // A second column without check boxes: selecting rows selects it too.
        checks.appendRow({item, new QStandardItem(text + QStringLiteral(" info"))});
    }
    auto state = [&checks] {
        QStringList out;
        for (int row = 0; row < checks.rowCount(); ++row) {
            const QStandardItem *item = checks.item(row);
            out.append(item->text() + (!item->isCheckable() ? QStringLiteral("-")
                                       : item->checkState() == Qt::Checked ? QStringLiteral("*") : QString()));
        }
        return out.join(QLatin1Char(' '));
    };

    std::unique_ptr<QTreeView> view(multiView ? new MultiCheckTreeView : new QTreeView);
    view->setModel(&checks);
    view->setSelectionMode(QAbstractItemView::ExtendedSelection);
    view->setRootIsDecorated(false);
    view->show();
    QVERIFY(QTest::qWaitForWindowExposed(view.get()));

    for (int i = 0; i < clicks.size(); ++i) {
        const QRect rect = view->visualRect(checks.index(clicks.at(i), 0));
        QTest::mouseClick(view->viewport(), Qt::LeftButton, i ? Qt::ControlModifier : Qt::NoModifier, rect.center());
    }
    QCOMPARE(view->selectionModel()->selectedRows().size(), clicks.size());
    QCOMPARE(state(), items);

    QTest::keyClick(view.get(), Qt::Key_Space);
    QCOMPARE(state(), expected);
}

void DelegatesTest::screenshot()
{
    MiscDelegateTableView view;
    view.setModel(model);
    view.setItemDelegateForColumn(TextColumn, new LineEditDelegate(&view));
    view.setItemDelegateForColumn(ChoiceColumn, new NamesComboBoxDelegate(&view));
    view.setItemDelegateForColumn(NumberColumn, new SpinBoxDelegate(&view));
    view.resize(360, 160);
    view.show();
    QVERIFY(QTest::qWaitForWindowExposed(&view));
    view.selectRow(1);
    click(&view, model->index(2, NumberColumn));
    QVERIFY(view.indexWidget(model->index(2, NumberColumn)));
    QVERIFY(keepScreenshot(&view, QStringLiteral("miscdelegatetableview")));
}

QTEST_MAIN(DelegatesTest)
#include "tst_delegates.moc"
