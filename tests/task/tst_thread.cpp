// The worker ring is process-wide and stopping it is final, so every test
// function here runs in a process of its own (see CMakeLists.txt).

#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/taskobservermodel.h>
#include <kvt-common/thread.h>

#include "testtask.h"

#include <QAbstractItemModelTester>
#include <QtTest>

#include <memory>
#include <thread>

namespace {

// A started worker opens the ring a moment later, in its own thread.
bool putOnceOpen(AbstractTask *task)
{
    QDeadlineTimer deadline(5000);
    while (!Thread::put(task)) {
        if (deadline.hasExpired())
            return false;
        QThread::msleep(1);
    }
    return true;
}

} // namespace

class ThreadTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void putRefusedWithoutWorkers();
    void ringHolds64BesidesRunningTask();
    void destroyingOneStopsAll();
    void queuedTasksDeletedAtStop();
    void observerReportsRefusedTask();

private:
    std::unique_ptr<QAbstractItemModelTester> tester;
};

void ThreadTest::initTestCase()
{
    // Tasks report to the observer, which must live in this thread.
    TaskObserver *observer = TaskObserver::instance();
    tester.reset(new QAbstractItemModelTester(observer->model(),
                                              QAbstractItemModelTester::FailureReportingMode::QtTest));
}

void ThreadTest::putRefusedWithoutWorkers()
{
    TestTask::Counters counters;
    QVERIFY(!Thread::put(nullptr));
    for (int i = 0; i < 3; ++i) {
        TestTask task(&counters, QStringLiteral("t"));
        QVERIFY(!Thread::put(&task));
    }
    // A worker that is created but not started opens no slot either.
    Thread idle;
    TestTask task(&counters, QStringLiteral("t"));
    QVERIFY(!Thread::put(&task));
    QCOMPARE(int(counters.runs), 0);
}

void ThreadTest::ringHolds64BesidesRunningTask()
{
    TestTask::Counters counters;
    QSemaphore gate;
    auto *worker = new Thread;
    worker->start();

    QVERIFY(putOnceOpen(new TestTask(&counters, QStringLiteral("blocker"), TaskDescription::Success, &gate)));
    QVERIFY(counters.started.tryAcquire(1, 5000));
    QCOMPARE(worker->threadIndex(), 0);

    for (int i = 0; i < Thread::BufferSize; ++i)
        QVERIFY2(Thread::put(new TestTask(&counters, QString::number(i))), qPrintable(QString::number(i)));
    TestTask refused(nullptr, QStringLiteral("65th"));
    QVERIFY(!Thread::put(&refused));

    gate.release();
    QTRY_COMPARE(int(counters.afterRuns), 65);
    QCOMPARE(int(counters.destroyed), 65);
    // Slots are free again.
    QVERIFY(Thread::put(new TestTask(&counters, QStringLiteral("again"))));
    QTRY_COMPARE(int(counters.destroyed), 66);
    delete worker;
}

void ThreadTest::destroyingOneStopsAll()
{
    QList<Thread *> workers;
    for (int i = 0; i < 3; ++i) {
        workers.append(new Thread);
        workers.last()->start();
    }
    // Wait until all three are inside their loop.
    TestTask::Counters counters;
    for (int i = 0; i < 3; ++i)
        QVERIFY(putOnceOpen(new TestTask(&counters, QString::number(i))));
    QTRY_COMPARE(int(counters.destroyed), 3);
    for (Thread *w : workers)
        QTRY_VERIFY(w->threadIndex() >= 0);
    QList<int> indexes;
    for (Thread *w : workers)
        indexes.append(w->threadIndex());
    std::sort(indexes.begin(), indexes.end());
    QCOMPARE(indexes, (QList<int>{0, 1, 2}));

    delete workers.takeAt(1);
    for (Thread *w : workers)
        QVERIFY(w->wait(5000));
    qDeleteAll(workers);
}

void ThreadTest::queuedTasksDeletedAtStop()
{
    TestTask::Counters running;
    TestTask::Counters queued;
    QSemaphore gate;
    auto *worker = new Thread;
    worker->start();
    QVERIFY(putOnceOpen(new TestTask(&running, QStringLiteral("blocker"), TaskDescription::Success, &gate)));
    QVERIFY(running.started.tryAcquire(1, 5000));
    for (int i = 0; i < Thread::BufferSize; ++i)
        QVERIFY(Thread::put(new TestTask(&queued, QString::number(i))));

    // The destructor waits for the worker, which waits for the gate: open it
    // from elsewhere once the stop has been requested.
    std::thread opener([&gate] {
        std::this_thread::sleep_for(std::chrono::milliseconds(100));
        gate.release();
    });
    delete worker;
    opener.join();

    // The full ring (64 waiting tasks) is emptied: none ran, all deleted.
    QCOMPARE(int(queued.runs), 0);
    QCOMPARE(int(queued.destroyed), Thread::BufferSize);
    // The running task finished and reports as usual.
    QTRY_COMPARE(int(running.destroyed), 1);
    QCOMPARE(int(running.afterRuns), 1);
}

void ThreadTest::observerReportsRefusedTask()
{
    TaskObserver *observer = TaskObserver::instance();
    TestTask::Counters counters;
    QSemaphore gate;
    auto *worker = new Thread;
    worker->start();
    QTRY_VERIFY(worker->threadIndex() == 0);
    QTest::qWait(20);
    observer->performTask(new TestTask(&counters, QStringLiteral("blocker"), TaskDescription::Success, &gate));
    QVERIFY(counters.started.tryAcquire(1, 5000));
    for (int i = 0; i < Thread::BufferSize; ++i)
        observer->performTask(new TestTask(&counters, QString::number(i)));

    QTest::ignoreMessage(QtWarningMsg, QRegularExpression(QStringLiteral("\"overflow\" refused")));
    observer->performTask(new TestTask(&counters, QStringLiteral("overflow")));
    // Not run, not leaked, and shown as failed rather than running for ever.
    QCOMPARE(int(counters.destroyed), 1);
    QCOMPARE(int(counters.runs), 1);
    const QModelIndex status = observer->model()->index(Thread::BufferSize + 1, 1);
    QCOMPARE(status.data(Qt::EditRole).toInt(), int(TaskDescription::Fail));
    QCOMPARE(observer->problemCount(), 1);

    gate.release();
    QTRY_COMPARE(int(counters.destroyed), Thread::BufferSize + 2);
    QCOMPARE(int(counters.afterRuns), Thread::BufferSize + 1);
    QCOMPARE(observer->runningCount(), 0);
    // The failure keeps the list for the user to read.
    QTRY_VERIFY(observer->dialog()->isVisible());
    QCOMPARE(observer->model()->rowCount(), Thread::BufferSize + 2);
    delete worker;
}

QTEST_MAIN(ThreadTest)
#include "tst_thread.moc"
