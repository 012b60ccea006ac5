// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_TASKPROBE_H
#define KVT_TEST_TASKPROBE_H

#include <kvt-common/abstracttask.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>

#include <QStringList>
#include <QtTest>

#include <utility>

// Wraps a library task: afterRun() first records how the task ended, as
// "<status>: <message>" (status as a word), in a list the test owns, then
// runs the library's afterRun().
template <class Task>
class Probe : public Task
{
public:
    template <class... Args>
    Probe(QStringList *outcomes, Args &&...args) : Task(std::forward<Args>(args)...), outcomes(outcomes)
    {
    }

    void afterRun() override
    {
        static const char *const words[] = {"processing", "fail", "success", "warning", "stopping"};
        const TaskDescription &description = this->taskDescription();
        QString outcome = QLatin1String(words[qBound(0, int(description.status()), 4)]);
        if (!description.message().isEmpty())
            outcome += QStringLiteral(": ") + description.message();
        outcomes->append(outcome);
        Task::afterRun();
    }

    QStringList *outcomes;
};

// Worker threads for a test process, started once: the ring of workers
// cannot start again once a Thread has been destroyed.
class Workers
{
public:
    void start(int count)
    {
        TaskObserver::instance();
        for (int i = 0; i < count; ++i) {
            threads.append(new Thread);
            threads.last()->start();
            QTRY_VERIFY(threads.last()->threadIndex() >= 0);
        }
    }
    void stop()
    {
        qDeleteAll(threads);
        threads.clear();
    }
    QList<Thread *> threads;
};

#endif
