#ifndef KVT_TEST_TASKPROBE_H
#define KVT_TEST_TASKPROBE_H

#include <kvt-common/abstracttask.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>

#include <QStringList>
#include <QtTest>

#include <utility>

/*!
 * Wraps a library task: afterRun() first records how the task ended, as
 * "<status>: <message>" (status as a word), in a list the test owns, then
 * runs the library's afterRun().
 */
template <class Task>
class Probe : public Task
{
public:
    template <class... Args>
    Probe(QStringList *outcomes, Args &&...args)
        : Task(std::forward<Args>(args)...)
        , outcomes(outcomes)
    {
    }

    void afterRun() override
    {
        outcomes->append(describe(this->taskDescription()));
        Task::afterRun();
    }

    static QString describe(const TaskDescription &description)
    {
        static const char *const words[] = {"processing", "fail", "success", "warning", "stopping"};
        const QString word = QLatin1String(words[qBound(0, int(description.status()), 4)]);
        return description.message().isEmpty() ? word : word + QStringLiteral(": ") + description.message();
    }

    QStringList *outcomes;
};

/*!
 * Worker threads for a test process, started once: the ring of workers
 * cannot start again once a Thread has been destroyed.
 */
class Workers
{
public:
    void start(int count)
    {
        TaskObserver::instance();
        for (int i = 0; i < count; ++i) {
            threads.append(new Thread);
            threads.last()->start();
        }
        for (Thread *thread : qAsConst(threads))
            QTRY_VERIFY(thread->threadIndex() >= 0);
    }
    void stop()
    {
        qDeleteAll(threads);
        threads.clear();
    }
    QList<Thread *> threads;
};

#endif
