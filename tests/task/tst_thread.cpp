// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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

    void stoppedRingLetsGoOfTasks()
    {
        // Tasks given to the observer and dropped by the stop: their rows let
        // go of them (no flags read, no stop request written through them) and
        // end as failed instead of running for ever.
        TaskObserver *observer = TaskObserver::instance();
        TaskObserverModel *model = observer->model();
        worker->start();
        QTRY_COMPARE(worker->threadIndex(), 0);
        observer->performTask(new TestTask(&running, QStringLiteral("blocker"), TaskDescription::Success, &gate));
        QVERIFY(running.started.tryAcquire(1, 5000));
        for (int i = 1; i <= 3; ++i)
            observer->performTask(new TestTask(&queued, QString::number(i), TaskDescription::Success, nullptr, true));
        QCOMPARE(model->index(1, 1).data(Qt::UserRole).toULongLong(), quint64(AbstractTask::StoppableFlag));
        std::thread opener([this] {
            std::this_thread::sleep_for(std::chrono::milliseconds(100));
            gate.release();
        });
        worker.reset();
        opener.join();
        // A stopped ring takes nothing more: such a task would never run nor
        // be freed.
        TestTask late(nullptr, QStringLiteral("late"));
        QVERIFY(!Thread::put(&late));
        QCOMPARE(int(queued.destroyed), 3);
        QTRY_COMPARE(observer->runningCount(), 0);
        for (int row = 1; row <= 3; ++row) {
            QVERIFY(!observer->rows().at(row).task);
            QCOMPARE(model->index(row, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Fail));
            QCOMPARE(model->index(row, 1).data(Qt::UserRole).toULongLong(), quint64(0));
            QVERIFY(!model->setData(model->index(row, 1), 4, Qt::EditRole));
        }
        QCOMPARE(model->index(0, 1).data(Qt::EditRole).toInt(), int(TaskDescription::Success));
        QCOMPARE(observer->problemCount(), 3);

        // Through the observer, a task the stopped ring refuses is reported
        // failed and freed.
        TestTask::Counters refused;
        QTest::ignoreMessage(QtWarningMsg, QRegularExpression(QStringLiteral("\"after stop\" refused")));
        observer->performTask(new TestTask(&refused, QStringLiteral("after stop")));
        QCOMPARE(int(refused.destroyed), 1);
        QCOMPARE(observer->runningCount(), 0);
    }

    void completionsReachTheInterfaceThread()
    {
        // No observer yet: a task queued directly reports to an observer made
        // in the interface thread, where its afterRun() runs. A worker asking
        // for the observer gets none rather than making one.
        tester.reset();
        delete TaskObserver::instance();
        worker->start();
        QTRY_COMPARE(worker->threadIndex(), 0);
        TaskObserver *fromWorker = reinterpret_cast<TaskObserver *>(1);
        QTest::ignoreMessage(QtWarningMsg, QRegularExpression(QStringLiteral("cannot be created outside the interface thread")));
        std::thread([&fromWorker] { fromWorker = TaskObserver::instance(); }).join();
        QVERIFY(!fromWorker);

        struct Where : TestTask
        {
            Where(TestTask::Counters *counters, const QString &name, QThread **thread)
                : TestTask(counters, name), thread(thread)
            {
            }
            void afterRun() override
            {
                *thread = QThread::currentThread();
                TestTask::afterRun();
            }
            void run() override
            {
                // The observer may delete the task as soon as it is posted.
                QSemaphore *done = posted;
                TestTask::run();
                done->release(); // the completion is on its way
            }
            QThread **thread;
            QSemaphore *posted = nullptr;
        };
        QThread *afterRunThread = nullptr;
        QSemaphore posted;
        TestTask::Counters first;
        auto *early = new Where(&first, QStringLiteral("early"), &afterRunThread);
        early->posted = &posted;
        QVERIFY(Thread::put(early));
        QTRY_COMPARE(int(first.destroyed), 1);
        QCOMPARE(int(first.afterRuns), 1);
        QCOMPARE(afterRunThread, qApp->thread());
        QCOMPARE(TaskObserver::instance()->thread(), qApp->thread());

        // The observer destroyed with one completion already posted and one
        // task still running: both tasks are finished and freed.
        TaskObserver *observer = TaskObserver::instance();
        TestTask::Counters second;
        auto *quick = new Where(&second, QStringLiteral("quick"), &afterRunThread);
        quick->posted = &posted;
        observer->performTask(quick);
        QVERIFY(posted.tryAcquire(2, 5000)); // no event is processed meanwhile
        observer->performTask(new TestTask(&second, QStringLiteral("slow"), TaskDescription::Success, &gate));
        QVERIFY(second.started.tryAcquire(2, 5000));
        delete observer;
        QCOMPARE(int(second.afterRuns), 1);
        QCOMPARE(int(second.destroyed), 1);
        gate.release();
        QTRY_COMPARE(int(second.destroyed), 2);
        QCOMPARE(int(second.afterRuns), 2);
    }
};

QTEST_MAIN(ThreadTest)
#include "tst_thread.moc"
