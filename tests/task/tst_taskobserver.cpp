// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/blockdialog.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/taskobservermodel.h>

#include "taskprobe.h"
#include "testtask.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QCursor>
#include <QDialogButtonBox>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStackedWidget>
#include <QTreeView>
#include <QtTest>

#include <memory>

using Status = TaskDescription::TaskStatus;
Q_DECLARE_METATYPE(Status)

class TaskObserverTest : public QObject
{
    Q_OBJECT

    TaskObserver *observer = nullptr;
    TaskObserverModel *model = nullptr;
    Workers workers;
    std::unique_ptr<QAbstractItemModelTester> tester;
    TestTask::Counters counters;
    QSemaphore gate; // opened at cleanup

    TaskObserverDialog *dialog() const { return observer->dialog(); }
    template <typename W>
    W *child(const char *name) const { return dialog()->findChild<W *>(QLatin1String(name)); }
    QDialogButtonBox *buttonBox() const { return child<QDialogButtonBox>("_buttonBox"); }
    static BlockDialog *shownBlockDialog()
    {
        const QWidgetList all = QApplication::topLevelWidgets();
        auto it = std::find_if(all.begin(), all.end(),
                               [](QWidget *w) { return qobject_cast<BlockDialog *>(w) && w->isVisible(); });
        return it == all.end() ? nullptr : static_cast<BlockDialog *>(*it);
    }
    static bool blockDialogShown() { return shownBlockDialog(); }
    static bool busyCursor()
    {
        return QGuiApplication::overrideCursor() && QGuiApplication::overrideCursor()->shape() == Qt::BusyCursor;
    }
    int status(int row) const { return model->index(row, 1).data(Qt::EditRole).toInt(); }
    bool requestStop(int row) { return model->setData(model->index(row, 1), 4, Qt::EditRole); }

private Q_SLOTS:
    void initTestCase()
    {
        observer = TaskObserver::instance();
        model = observer->model();
        tester.reset(new QAbstractItemModelTester(model, QAbstractItemModelTester::FailureReportingMode::QtTest));
        workers.start(2);
        QTest::qWait(20); // a running worker opens the ring a moment after it takes its index
    }
    void cleanupTestCase()
    {
        workers.stop();
        delete observer;
    }
    // Closing the dialog empties the list of tasks and problems.
    void cleanup()
    {
        gate.release(10);
        QTRY_COMPARE(observer->runningCount(), 0);
        QTRY_COMPARE(int(counters.destroyed), int(counters.runs));
        gate.acquire(gate.available());
        if (dialog()->isVisible())
            buttonBox()->button(QDialogButtonBox::Close)->click();
        QVERIFY(!dialog()->isVisible());
        QCOMPARE(model->rowCount(), 0);
        QCOMPARE(observer->problemCount(), 0);
        QTRY_VERIFY(!blockDialogShown());
    }

    void dialogFollowsTasks_data()
    {
        QTest::addColumn<bool>("slow");
        QTest::addColumn<Status>("outcome");
        QTest::addColumn<Status>("shown");
        QTest::newRow("quick success leaves no trace") << false << TaskDescription::Success << TaskDescription::Success;
        QTest::newRow("quick failure") << false << TaskDescription::Fail << TaskDescription::Fail;
        QTest::newRow("slow success") << true << TaskDescription::Success << TaskDescription::Success;
        QTest::newRow("slow warning") << true << TaskDescription::Warning << TaskDescription::Warning;
        // A run() that forgets to set a final status must not keep the list
        // running for ever: it is logged and shown as a warning.
        QTest::newRow("no final status") << false << TaskDescription::Processing << TaskDescription::Warning;
        QTest::newRow("ends while stopping") << true << TaskDescription::AboutToBeStopped << TaskDescription::Warning;
    }

    void dialogFollowsTasks()
    {
        QFETCH(bool, slow);
        QFETCH(Status, outcome);
        QFETCH(Status, shown);
        if (outcome != shown)
            QTest::ignoreMessage(QtWarningMsg, QRegularExpression(QStringLiteral("task \"job\" finished with the status %1 ")
                                                                      .arg(int(outcome))));

        auto *task = new TestTask(&counters, QStringLiteral("job"), outcome, slow ? &gate : nullptr);
        observer->performTask(task);
        observer->performTask(task); // listed and run once however often it is given
        observer->performTask(nullptr);
        QCOMPARE(model->rowCount(), 1);
        // Work has started: the window is blocked and closing is not possible.
        // The blocking dialog is modal but not seen (no grey box over the
        // window): frameless, a pixel large; the busy cursor shows the work.
        const BlockDialog *block = shownBlockDialog();
        QVERIFY(block && block->isModal() && block->testAttribute(Qt::WA_DeleteOnClose));
        QVERIFY((block->windowFlags() & Qt::FramelessWindowHint) && block->width() * block->height() <= 1);
        QVERIFY(busyCursor());
        QVERIFY(!buttonBox()->isEnabled());
        QVERIFY(!dialog()->isVisible());
        if (slow) {
            // After a second the task dialog takes over, still not closable.
            QTRY_VERIFY_WITH_TIMEOUT(dialog()->isVisible(), 3000);
            QTRY_VERIFY(!blockDialogShown());
            QVERIFY(!QGuiApplication::overrideCursor());
            QTest::keyClick(dialog(), Qt::Key_Escape);
            QVERIFY(!dialog()->close());
            QVERIFY(dialog()->isVisible());
            gate.release();
        }
        QTRY_COMPARE(observer->runningCount(), 0);
        QVERIFY(buttonBox()->isEnabled());
        QTRY_VERIFY(!blockDialogShown());
        QVERIFY(!QGuiApplication::overrideCursor());
        // A success closes the dialog and clears the list; a problem leaves both
        // for the user to read, until the dialog is closed.
        const bool problem = shown != TaskDescription::Success;
        QCOMPARE(dialog()->isVisible(), problem);
        QCOMPARE(model->rowCount(), problem ? 1 : 0);
        if (!problem)
            return;
        QCOMPARE(status(0), int(shown));
        QCOMPARE(model->index(0, 2).data().toString(), QStringLiteral("job done"));
        if (!slow) // cleanup() closes it
            return;
        // Left with Escape on the message page, it reopens on the list.
        dialog()->doubleClick(model->index(0, 0));
        QTest::keyClick(dialog(), Qt::Key_Escape);
        QVERIFY(!dialog()->isVisible());
        dialog()->open();
        QCOMPARE(child<QStackedWidget>("_stackedWidget")->currentIndex(), 0);
        QVERIFY(child<QPlainTextEdit>("_errorPlainTextEdit")->toPlainText().isEmpty());
    }

    void dialogButtons_data()
    {
        // The row under test is "job"; a title means the row has a message to show.
        QTest::addColumn<Status>("state");
        QTest::addColumn<bool>("stoppable");
        QTest::addColumn<bool>("stop");
        QTest::addColumn<QString>("title");
        QTest::newRow("running, stoppable") << TaskDescription::Processing << true << true << "";
        QTest::newRow("running") << TaskDescription::Processing << false << false << "";
        QTest::newRow("succeeded, stoppable") << TaskDescription::Success << true << false << "";
        QTest::newRow("failed") << TaskDescription::Fail << false << false << "Error: job";
        QTest::newRow("warned") << TaskDescription::Warning << false << false << "Warning: job";
    }

    void dialogButtons()
    {
        QFETCH(Status, state);
        QFETCH(bool, stoppable);
        QFETCH(bool, stop);
        QFETCH(QString, title);
        const bool running = state == TaskDescription::Processing;
        const bool more = !title.isEmpty();

        // Row 0 runs for the whole test, so that the row under test stays listed.
        observer->performTask(new TestTask(&counters, QStringLiteral("keeper"), TaskDescription::Success, &gate, true));
        observer->performTask(new TestTask(&counters, QStringLiteral("job"), running ? TaskDescription::Success : state,
                                           running ? &gate : nullptr, stoppable));
        QTRY_COMPARE(status(1), int(state));
        dialog()->open();
        auto *moreButton = child<QPushButton>("_morePushButton");
        auto *stopButton = child<QPushButton>("_stopPushButton");
        auto buttons = [&] { return qMakePair(moreButton->isEnabled(), stopButton->isEnabled()); };
        QCOMPARE(buttons(), qMakePair(false, false)); // nothing selected yet
        child<QTreeView>("_taskTreeView")->selectionModel()->select(
            model->index(1, 0), QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
        QCOMPARE(buttons(), qMakePair(more, stop));
        QVERIFY(requestStop(0)); // a change in a row that is not selected leaves them alone
        QCOMPARE(buttons(), qMakePair(more, stop));
        // Only the value 4 edited in column 1 asks a task to stop.
        QVERIFY(!model->setData(model->index(1, 1), 1, Qt::EditRole));
        QVERIFY(!model->setData(model->index(1, 0), 4, Qt::EditRole));
        QVERIFY(!model->setData(model->index(1, 1), 4, Qt::DisplayRole));
        QCOMPARE(status(1), int(state));

        // Double-clicking a row with a problem shows its message.
        dialog()->doubleClick(model->index(1, 0));
        QCOMPARE(child<QStackedWidget>("_stackedWidget")->currentIndex(), more ? 1 : 0);
        QCOMPARE(dialog()->windowTitle(), more ? title : "Tasks");
        QCOMPARE(child<QPlainTextEdit>("_errorPlainTextEdit")->toPlainText(), more ? "job done" : "");
        if (!stop) { // a task that cannot be stopped, or has ended
            QVERIFY(!requestStop(1));
            return;
        }
        // A stop request is taken once, shown in a status text spelled so on
        // purpose; the task notices it and ends with a warning.
        stopButton->click();
        QCOMPARE(model->index(1, 1).data().toString(), QStringLiteral("about to be stop"));
        QVERIFY(!stopButton->isEnabled());
        QVERIFY(!requestStop(1));
        QTRY_COMPARE(status(1), int(TaskDescription::Warning));
        QCOMPARE(model->index(1, 2).data().toString(), QStringLiteral("stopped on request"));
        QVERIFY(!requestStop(1));
    }
};

QTEST_MAIN(TaskObserverTest)
#include "tst_taskobserver.moc"
