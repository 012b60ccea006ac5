#ifndef KVT_TEST_TESTTASK_H
#define KVT_TEST_TESTTASK_H

#include <kvt-common/abstracttask.h>

#include <QAtomicInt>
#include <QSemaphore>
#include <QString>

/*!
 * A task for tests. It may wait at a gate the test opens (a semaphore), ends
 * with a chosen status and message, and counts its runs, follow-ups and
 * destructions in counters the test owns. A stoppable gated task gives up
 * waiting when asked to stop and ends with a warning.
 */
class TestTask : public AbstractTask
{
public:
    struct Counters
    {
        QAtomicInt runs;
        QAtomicInt afterRuns;
        QAtomicInt destroyed;
        QSemaphore started; // released when run() begins
    };

    TestTask(Counters *counters, const QString &name,
             TaskDescription::TaskStatus outcome = TaskDescription::Success,
             QSemaphore *gate = nullptr, bool stoppable = false)
        : counters(counters)
        , outcome(outcome)
        , gate(gate)
    {
        taskDescription().setDescription(name);
        if (stoppable)
            _taskSpecialFlags |= StoppableFlag;
    }

    ~TestTask() override
    {
        if (counters)
            counters->destroyed.ref();
    }

    void run() override
    {
        if (counters) {
            counters->runs.ref();
            counters->started.release();
        }
        bool stopped = false;
        if (gate) {
            while (!gate->tryAcquire(1, 5)) {
                if (taskAboutToBeStopped()) {
                    stopped = true;
                    break;
                }
            }
        }
        taskDescription().setStatus(stopped ? TaskDescription::Warning : outcome);
        taskDescription().setMessage(stopped ? QStringLiteral("stopped on request")
                                             : QStringLiteral("%1 done").arg(taskDescription().description()));
        AbstractTask::run();
    }

    void afterRun() override
    {
        if (counters)
            counters->afterRuns.ref();
    }

    Counters *counters;
    TaskDescription::TaskStatus outcome;
    QSemaphore *gate;
};

#endif
