// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_TESTTASK_H
#define KVT_TEST_TESTTASK_H

#include <kvt-common/abstracttask.h>

#include <QAtomicInt>
#include <QSemaphore>

// A task for tests: it may wait at a gate the test opens, ends with a chosen
// status and the message "<name> done", and counts its runs, follow-ups and
// destructions in counters the test owns (if any). A stoppable task waiting
// at its gate gives up when asked to stop and ends with a warning.
class TestTask : public AbstractTask
{
public:
    struct Counters
    {
        QAtomicInt runs, afterRuns, destroyed;
        QSemaphore started; // released when run() begins
    };

    TestTask(Counters *counters, const QString &name,
             TaskDescription::TaskStatus outcome = TaskDescription::Success, QSemaphore *gate = nullptr,
             bool stoppable = false)
        : counters(counters), outcome(outcome), gate(gate)
    {
        taskDescription().setDescription(name);
        if (stoppable)
            _taskSpecialFlags |= StoppableFlag;
    }
    ~TestTask() override { count(&Counters::destroyed); }

    void run() override
    {
        count(&Counters::runs);
        if (counters)
            counters->started.release();
        bool stopped = false;
        while (gate && !stopped && !gate->tryAcquire(1, 5))
            stopped = taskAboutToBeStopped();
        taskDescription().setStatus(stopped ? TaskDescription::Warning : outcome);
        taskDescription().setMessage(stopped ? QStringLiteral("stopped on request")
                                             : taskDescription().description() + QStringLiteral(" done"));
        AbstractTask::run();
    }
    void afterRun() override { count(&Counters::afterRuns); }

    void count(QAtomicInt Counters::*counter)
    {
        if (counters)
            (counters->*counter).ref();
    }

    Counters *counters;
    TaskDescription::TaskStatus outcome;
    QSemaphore *gate;
};

#endif
