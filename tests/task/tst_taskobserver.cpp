#include <kvt-common/blockdialog.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/taskobservermodel.h>
#include <kvt-common/thread.h>

#include "testtask.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QDialogButtonBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSettings>
#include <QStackedWidget>
#include <QTreeView>
#include <QtTest>

#include <memory>

class TaskObserverTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void cleanup();

    void quickSuccessLeavesNoTrace();
    void failureKeepsDialogOpen();
    void taskListedOnce();
    void blockDialogThenTaskDialog();
    void stopRequest_data();
    void stopRequest();
    void dialogButtonsFollowSelection();
    void modelHeaderAndGeometry();

private:
    TaskObserver *observer = nullptr;
    QList<Thread *> workers;
    std::unique_ptr<QAbstractItemModelTester> tester;
    TestTask::Counters counters;
    QList<QSemaphore *> gates;

    QSemaphore *newGate()
    {
        gates.append(new QSemaphore);
        return gates.last();
    }
    TaskObserverDialog *dialog() const { return observer->dialog(); }
    QPushButton *button(const char *name) const { return dialog()->findChild<QPushButton *>(QLatin1String(name)); }
    QDialogButtonBox *buttonBox() const { return dialog()->findChild<QDialogButtonBox *>(QStringLiteral("_buttonBox")); }
    QTreeView *view() const { return dialog()->findChild<QTreeView *>(QStringLiteral("_taskTreeView")); }
    static BlockDialog *visibleBlockDialog()
    {
        for (QWidget *w : QApplication::topLevelWidgets()) {
            if (auto *b = qobject_cast<BlockDialog *>(w); b && b->isVisible())
                return b;
        }
        return nullptr;
    }
    void selectRow(int row)
    {
        view()->selectionModel()->select(observer->model()->index(row, 0),
                                         QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
    }
};

void TaskObserverTest::initTestCase()
{
    observer = TaskObserver::instance();
    QCOMPARE(TaskObserver::instance(new QObject(this)), observer);
    tester.reset(new QAbstractItemModelTester(observer->model(),
                                              QAbstractItemModelTester::FailureReportingMode::QtTest));
    for (int i = 0; i < 2; ++i) {
        workers.append(new Thread);
        workers.last()->start();
    }
    // Workers open the ring once running.
    for (Thread *worker : qAsConst(workers))
        QTRY_VERIFY(worker->threadIndex() >= 0);
    QTest::qWait(20);
}

void TaskObserverTest::cleanupTestCase()
{
    qDeleteAll(workers);
    tester.reset();
    delete observer;
    QVERIFY(TaskObserver::instance() != observer || true);
}

void TaskObserverTest::cleanup()
{
    for (QSemaphore *gate : qAsConst(gates))
        gate->release(10);
    QTRY_COMPARE(observer->runningCount(), 0);
    QTRY_COMPARE(int(counters.destroyed), int(counters.runs));
    if (dialog()->isVisible())
        dialog()->reject();
    QCOMPARE(observer->model()->rowCount(), 0);
    QTRY_VERIFY(!visibleBlockDialog());
    qDeleteAll(gates);
    gates.clear();
}

void TaskObserverTest::quickSuccessLeavesNoTrace()
{
    const int before = counters.afterRuns;
    observer->performTask(new TestTask(&counters, QStringLiteral("quick")));
    // Work has started: the window is blocked and closing is not possible.
    QVERIFY(visibleBlockDialog());
    QVERIFY(!buttonBox()->isEnabled());
    QTRY_COMPARE(int(counters.afterRuns), before + 1);
    QVERIFY(!dialog()->isVisible());
    QCOMPARE(observer->model()->rowCount(), 0);
    QVERIFY(buttonBox()->isEnabled());
    QTRY_VERIFY(!visibleBlockDialog());
}

void TaskObserverTest::failureKeepsDialogOpen()
{
    observer->performTask(new TestTask(&counters, QStringLiteral("broken"), TaskDescription::Fail));
    QTRY_VERIFY(dialog()->isVisible());
    QVERIFY(buttonBox()->isEnabled());
    QCOMPARE(observer->model()->rowCount(), 1);
    const QModelIndex name = observer->model()->index(0, 0);
    QCOMPARE(name.data().toString(), QStringLiteral("broken"));
    QCOMPARE(name.sibling(0, 1).data().toString(), QStringLiteral("fail"));
    QCOMPARE(name.sibling(0, 1).data(Qt::EditRole).toInt(), 1);
    QCOMPARE(name.sibling(0, 2).data(Qt::ToolTipRole).toString(), QStringLiteral("broken done"));
    const QIcon icon = name.data(Qt::DecorationRole).value<QIcon>();
    if (!icon.isNull())
        QCOMPARE(icon.name(), QStringLiteral("task-reject"));

    // Closing the dialog empties the list.
    buttonBox()->button(QDialogButtonBox::Close)->click();
    QVERIFY(!dialog()->isVisible());
    QCOMPARE(observer->model()->rowCount(), 0);
    QCOMPARE(observer->problemCount(), 0);
}

void TaskObserverTest::taskListedOnce()
{
    QSemaphore *gate = newGate();
    auto *task = new TestTask(&counters, QStringLiteral("once"), TaskDescription::Success, gate, true);
    observer->performTask(task);
    observer->performTask(task);
    observer->performTask(nullptr);
    QCOMPARE(observer->model()->rowCount(), 1);

    // A task already asked to stop is not started.
    TestTask stopped(nullptr, QStringLiteral("stopped"), TaskDescription::Success, nullptr, true);
    QVERIFY(stopped.setTaskAboutToBeStopped());
    observer->performTask(&stopped);
    QCOMPARE(observer->model()->rowCount(), 1);

    // The stop request of a task that cannot be stopped changes nothing.
    TestTask plain(nullptr, QStringLiteral("plain"));
    QVERIFY(!plain.setTaskAboutToBeStopped());
    QVERIFY(!plain.taskAboutToBeStopped());
    gate->release();
}

void TaskObserverTest::blockDialogThenTaskDialog()
{
    QSemaphore *gate = newGate();
    observer->performTask(new TestTask(&counters, QStringLiteral("slow"), TaskDescription::Success, gate));
    QVERIFY(visibleBlockDialog());
    QVERIFY(!dialog()->isVisible());

    // After a second the task dialog takes over.
    QTRY_VERIFY_WITH_TIMEOUT(dialog()->isVisible(), 3000);
    QTRY_VERIFY(!visibleBlockDialog());
    QCOMPARE(dialog()->windowTitle(), QStringLiteral("Tasks"));

    // Closing is blocked while the task runs.
    QTest::keyClick(dialog(), Qt::Key_Escape);
    QVERIFY(dialog()->isVisible());
    QVERIFY(!dialog()->close());
    QVERIFY(dialog()->isVisible());

    // A successful end closes the dialog and clears the list.
    gate->release();
    QTRY_VERIFY(!dialog()->isVisible());
    QCOMPARE(observer->model()->rowCount(), 0);

    // Unblocked, Escape closes the dialog as usual.
    dialog()->open();
    QVERIFY(dialog()->isVisible());
    QTest::keyClick(dialog(), Qt::Key_Escape);
    QVERIFY(!dialog()->isVisible());
}

void TaskObserverTest::stopRequest_data()
{
    QTest::addColumn<bool>("stoppable");
    QTest::addColumn<int>("column");
    QTest::addColumn<int>("role");
    QTest::addColumn<int>("value");
    QTest::addColumn<bool>("accepted");

    QTest::newRow("stoppable") << true << 1 << int(Qt::EditRole) << 4 << true;
    QTest::newRow("not stoppable") << false << 1 << int(Qt::EditRole) << 4 << false;
    QTest::newRow("wrong value") << true << 1 << int(Qt::EditRole) << 1 << false;
    QTest::newRow("wrong column") << true << 0 << int(Qt::EditRole) << 4 << false;
    QTest::newRow("wrong role") << true << 1 << int(Qt::DisplayRole) << 4 << false;
}

void TaskObserverTest::stopRequest()
{
    QFETCH(bool, stoppable);
    QFETCH(int, column);
    QFETCH(int, role);
    QFETCH(int, value);
    QFETCH(bool, accepted);

    QSemaphore *gate = newGate();
    observer->performTask(new TestTask(&counters, QStringLiteral("long"), TaskDescription::Success, gate, stoppable));
    TaskObserverModel *model = observer->model();
    QCOMPARE(model->index(0, 1).data(Qt::UserRole).toULongLong(), stoppable ? 1ull : 0ull);

    QSignalSpy changed(model, &QAbstractItemModel::dataChanged);
    QCOMPARE(model->setData(model->index(0, column), value, role), accepted);
    QCOMPARE(changed.count(), accepted ? 1 : 0);
    QCOMPARE(model->index(0, 1).data().toString(),
             accepted ? QStringLiteral("about to be stop") : QStringLiteral("processing"));
    if (!accepted)
        return;

    // Asked twice: the second request is refused.
    QVERIFY(!model->setData(model->index(0, 1), 4, Qt::EditRole));
    // The task notices the request and ends with a warning, which leaves the
    // list open.
    QTRY_COMPARE(model->index(0, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Warning));
    QTRY_VERIFY(dialog()->isVisible());
    QCOMPARE(model->index(0, 2).data().toString(), QStringLiteral("stopped on request"));
    // A finished row cannot be stopped.
    QVERIFY(!model->setData(model->index(0, 1), 4, Qt::EditRole));
}

void TaskObserverTest::dialogButtonsFollowSelection()
{
    QSemaphore *keepRunning = newGate();
    QSemaphore *plainGate = newGate();
    // Row 0 runs (stoppable) for the whole test, so rows of finished tasks stay.
    observer->performTask(new TestTask(&counters, QStringLiteral("A"), TaskDescription::Success, keepRunning, true));
    observer->performTask(new TestTask(&counters, QStringLiteral("S"), TaskDescription::Success));
    observer->performTask(new TestTask(&counters, QStringLiteral("F"), TaskDescription::Fail));
    observer->performTask(new TestTask(&counters, QStringLiteral("W"), TaskDescription::Warning));
    observer->performTask(new TestTask(&counters, QStringLiteral("N"), TaskDescription::Success, plainGate));
    TaskObserverModel *model = observer->model();
    QTRY_COMPARE(model->index(3, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Warning));
    QTRY_COMPARE(model->index(1, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Success));
    QTRY_COMPARE(model->index(2, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Fail));
    QTRY_VERIFY(dialog()->isVisible());

    QPushButton *more = button("_morePushButton");
    QPushButton *stop = button("_stopPushButton");
    QVERIFY(!more->isEnabled());
    QVERIFY(!stop->isEnabled());

    const struct {
        int row;
        bool more;
        bool stop;
    } expected[] = {{0, false, true}, {1, false, false}, {2, true, false}, {3, true, false}, {4, false, false}};
    for (const auto &e : expected) {
        selectRow(e.row);
        QVERIFY2(more->isEnabled() == e.more, qPrintable(QString::number(e.row)));
        QVERIFY2(stop->isEnabled() == e.stop, qPrintable(QString::number(e.row)));
    }

    // A change in a row that is not selected leaves the buttons alone.
    selectRow(2);
    model->setData(model->index(0, 1), 4, Qt::EditRole);
    QVERIFY(more->isEnabled());
    QVERIFY(!stop->isEnabled());

    // Double-clicking the failed row shows its message.
    auto *pages = dialog()->findChild<QStackedWidget *>(QStringLiteral("_stackedWidget"));
    dialog()->doubleClick(model->index(2, 0));
    QCOMPARE(pages->currentIndex(), 1);
    QVERIFY(more->isChecked());
    QCOMPARE(dialog()->windowTitle(), QStringLiteral("Error: F"));
    auto *text = dialog()->findChild<QPlainTextEdit *>(QStringLiteral("_errorPlainTextEdit"));
    QCOMPARE(text->toPlainText(), QStringLiteral("F done"));
    more->click();
    QCOMPARE(pages->currentIndex(), 0);
    QCOMPARE(dialog()->windowTitle(), QStringLiteral("Tasks"));
    QVERIFY(text->toPlainText().isEmpty());

    selectRow(3);
    more->click();
    QCOMPARE(dialog()->windowTitle(), QStringLiteral("Warning: W"));
    more->click();

    // Stop through the button, on the selected running row: its status
    // changes, and with it the buttons.
    keepRunning->release(); // A ends; it was already asked to stop above
    plainGate->release();
    QTRY_COMPARE(observer->runningCount(), 0);
    QVERIFY(dialog()->isVisible()); // problems were reported
}

void TaskObserverTest::modelHeaderAndGeometry()
{
    TaskObserverModel *model = observer->model();
    QCOMPARE(model->columnCount(), 3);
    QCOMPARE(model->headerData(0, Qt::Horizontal).toString(), QStringLiteral("Task"));
    QCOMPARE(model->headerData(1, Qt::Horizontal, Qt::ToolTipRole).toString(), QStringLiteral("Status"));
    QCOMPARE(model->headerData(2, Qt::Horizontal).toString(), QStringLiteral("Message"));
    QVERIFY(!model->headerData(0, Qt::Vertical).isValid());
    QVERIFY(!model->headerData(3, Qt::Horizontal).isValid());
    QVERIFY(!model->headerData(0, Qt::Horizontal, Qt::EditRole).isValid());

    dialog()->resize(431, 287);
    dialog()->saveSettings();
    QVERIFY(QSettings().contains(QStringLiteral("taskObserverDialog/taskObserverDialogGeometry")));
    TaskObserverDialog other(observer);
    QCOMPARE(other.size(), QSize(431, 287));

    // Stop from the dialog, on a selected running task.
    QSemaphore *gate = newGate();
    observer->performTask(new TestTask(&counters, QStringLiteral("stop me"), TaskDescription::Success, gate, true));
    dialog()->open();
    selectRow(0);
    QPushButton *stop = button("_stopPushButton");
    QVERIFY(stop->isEnabled());
    stop->click();
    QCOMPARE(model->index(0, 1).data(Qt::EditRole).toInt(), int(TaskDescription::AboutToBeStopped));
    QVERIFY(!stop->isEnabled());
}

QTEST_MAIN(TaskObserverTest)
#include "tst_taskobserver.moc"
