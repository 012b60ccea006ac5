// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Short tasks through the task observer and its worker ring (two workers),
// beside the same work through QThreadPool with a queued call back to the
// interface thread per task. Both are fed as slots free: 64 tasks (the size of
// the ring) are started, and each completion, back in the interface thread,
// starts the next one.

#include <kvt-common/abstracttask.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QRunnable>
#include <QThreadPool>
#include <QTimer>

#include <limits>

namespace {

const int taskCount = 100000;
const int inFlightLimit = Thread::BufferSize;

struct Progress
{
    int started = 0;
    int done = 0;
};

// A little arithmetic, so that the work is not optimised away.
quint64 work(int seed)
{
    quint64 x = quint64(seed) + 1;
    for (int i = 0; i < 50; ++i)
        x = x * 6364136223846793005ULL + 1442695040888963407ULL;
    return x;
}

class ShortTask : public AbstractTask
{
public:
    ShortTask(Progress *progress)
        : progress(progress)
        , seed(progress->started++)
    {
        taskDescription().setDescription(QStringLiteral("short task"));
    }
    void run() override
    {
        result = work(seed);
        taskDescription().setStatus(TaskDescription::Success);
        AbstractTask::run();
    }
    void afterRun() override
    {
        benchmark::DoNotOptimize(result);
        ++progress->done;
        if (progress->started < taskCount)
            TaskObserver::instance()->performTask(new ShortTask(progress));
    }

private:
    Progress *progress;
    int seed;
    quint64 result = 0;
};

// With state.range(0) == 1 the task window is kept closed (the observer's
// one-second timer never fires), which measures the road of a task alone; with
// 0 the window opens after a second, as it does for an administrator, and
// lists every task.
void observerTasks(benchmark::State &state)
{
    TaskObserver *observer = TaskObserver::instance();
    QTimer *delay = observer->findChild<QTimer *>();
    delay->setInterval(state.range(0) ? std::numeric_limits<int>::max() : TaskObserver::_delay);
    for (auto _ : state) {
        Progress progress;
        while (progress.started < inFlightLimit)
            observer->performTask(new ShortTask(&progress));
        while (progress.done < taskCount)
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    state.SetItemsProcessed(state.iterations() * taskCount);
}

struct PoolFeeder
{
    QThreadPool *pool;
    QObject *receiver;
    Progress *progress;

    void startOne()
    {
        const int seed = progress->started++;
        PoolFeeder self = *this;
        pool->start(QRunnable::create([self, seed] {
            const quint64 result = work(seed);
            QMetaObject::invokeMethod(
                self.receiver,
                [self, result] {
                    benchmark::DoNotOptimize(result);
                    ++self.progress->done;
                    if (self.progress->started < taskCount) {
                        PoolFeeder next = self;
                        next.startOne();
                    }
                },
                Qt::QueuedConnection);
        }));
    }
};

void threadPoolTasks(benchmark::State &state)
{
    QThreadPool pool;
    pool.setMaxThreadCount(2);
    QObject receiver;
    for (auto _ : state) {
        Progress progress;
        PoolFeeder feeder{&pool, &receiver, &progress};
        while (progress.started < inFlightLimit)
            feeder.startOne();
        while (progress.done < taskCount)
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    pool.waitForDone();
    state.SetItemsProcessed(state.iterations() * taskCount);
}

} // namespace

BENCHMARK(observerTasks)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);
BENCHMARK(threadPoolTasks)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(3);

int main(int argc, char **argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    TaskObserver::instance();
    // The workers live for the whole program: once stopped they cannot restart.
    Thread workers[2];
    for (Thread &worker : workers)
        worker.start();
    while (workers[0].threadIndex() < 0 || workers[1].threadIndex() < 0)
        QThread::msleep(1);
    QThread::msleep(10);

    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
