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

class ThreadTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<QAbstractItemModelTester> tester;
    std::unique_ptr<Thread> worker{new Thread}; // not started yet
    TestTask::Counters running, queued;
    QSemaphore gate;

    // A worker not started yet opens no slot. Once started, it is kept busy with a
    // task waiting at the gate and the 64 slots of the ring behind it are filled;
    // one more task is refused.
    void fillRing()
    {
        TestTask early(nullptr, QStringLiteral("early"));
        QVERIFY(!Thread::put(&early) && !Thread::put(nullptr));
        worker->start();
        // The worker opens the ring a moment later, in its own thread.
        auto *blocker = new TestTask(&running, QStringLiteral("blocker"), TaskDescription::Success, &gate);
        for (QDeadlineTimer deadline(5000); !Thread::put(blocker) && !deadline.hasExpired();)
            QThread::msleep(1);
        QVERIFY(running.started.tryAcquire(1, 5000));
        for (int i = 0; i < Thread::BufferSize; ++i)
            QVERIFY2(Thread::put(new TestTask(&queued, QString::number(i))), qPrintable(QString::number(i)));
        TestTask refused(nullptr, QStringLiteral("65th"));
        QVERIFY(!Thread::put(&refused));
    }

private Q_SLOTS:
    void initTestCase()
    {
        // Tasks report to the observer, which must live in this thread.
        tester.reset(new QAbstractItemModelTester(TaskObserver::instance()->model(),
                                                  QAbstractItemModelTester::FailureReportingMode::QtTest));
    }

    void ringHolds64BesidesRunningTask()
    {
        fillRing();
        // A task the full ring refuses is not run, not leaked, and shown as
        // failed rather than running for ever; the failure opens the list for
        // the user to read.
        TaskObserver *observer = TaskObserver::instance();
        QTest::ignoreMessage(QtWarningMsg, QRegularExpression(QStringLiteral("\"overflow\" refused")));
        TestTask::Counters refused;
        observer->performTask(new TestTask(&refused, QStringLiteral("overflow")));
        QCOMPARE(int(refused.runs), 0);
        QCOMPARE(int(refused.destroyed), 1);
        QCOMPARE(observer->model()->index(0, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Fail));
        QCOMPARE(observer->runningCount(), 0);
        QVERIFY(observer->dialog()->isVisible());

        gate.release();
        QTRY_COMPARE(int(queued.afterRuns), Thread::BufferSize);
        QCOMPARE(int(queued.destroyed), Thread::BufferSize);
        QCOMPARE(int(running.destroyed), 1);
        // Slots are free again.
        QVERIFY(Thread::put(new TestTask(&queued, QStringLiteral("again"))));
        QTRY_COMPARE(int(queued.destroyed), Thread::BufferSize + 1);
    }

    void destroyingOneStopsAll()
    {
        QList<Thread *> workers{new Thread, new Thread, new Thread};
        for (int i = 0; i < 3; ++i) {
            workers[i]->start();
            QTRY_COMPARE(workers[i]->threadIndex(), i);
        }
        delete workers.takeAt(1);
        for (Thread *w : workers)
            QVERIFY(w->wait(5000));
        qDeleteAll(workers);
    }

    void queuedTasksDeletedAtStop()
    {
        fillRing();
        // The destructor waits for the worker, which waits for the gate: open it
        // from elsewhere once the stop has been requested.
        std::thread opener([this] {
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
            gate.release();
        });
        worker.reset();
        opener.join();
        // The full ring is emptied: no waiting task ran, all were deleted. The
        // running task finished and reports as usual.
        QCOMPARE(int(queued.runs), 0);
        QCOMPARE(int(queued.destroyed), Thread::BufferSize);
        QTRY_COMPARE(int(running.destroyed), 1);
        QCOMPARE(int(running.afterRuns), 1);
    }
};

QTEST_MAIN(ThreadTest)
#include "tst_thread.moc"
