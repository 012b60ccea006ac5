#ifndef KVT_ABSTRACTTASK_H
#define KVT_ABSTRACTTASK_H

#include "taskdescription.h"

#include <atomic>

class ElementData;

/*!
 * Base of all background work. A task is created in the interface thread and
 * started with TaskObserver::performTask(); a worker thread calls run(), the
 * interface thread then calls afterRun() and deletes the task.
 *
 * A subclass's run() does its work, records the outcome in
 * taskDescription() (status and message) and calls AbstractTask::run() as its
 * very last step, exactly once: that posts the completion to the observer.
 * No exception may leave run().
 */
class KVTCOMMON_EXPORT AbstractTask
{
public:
    //! Bit of taskSpecialFlags(): the user may ask the task to stop.
    static const quint64 StoppableFlag = 1;

    explicit AbstractTask(ElementData *data = nullptr);
    virtual ~AbstractTask();

    virtual void run();
    virtual void afterRun() = 0;

    quint64 taskSpecialFlags() const { return _taskSpecialFlags; }
    bool taskAboutToBeStopped() const { return _taskAboutToBeStopped.load(std::memory_order_relaxed); }
    /*!
     * Asks a stoppable task to stop. Returns false for a task that cannot be
     * stopped, true when the request is (or already was) recorded. The
     * running task notices it by polling taskAboutToBeStopped().
     */
    bool setTaskAboutToBeStopped();

    TaskDescription &taskDescription() { return _taskDescription; }
    const TaskDescription &taskDescription() const { return _taskDescription; }
    ElementData *elementData() const { return _elementData; }

    AbstractTask(const AbstractTask &) = delete;
    AbstractTask &operator=(const AbstractTask &) = delete;

protected:
    quint64 _taskSpecialFlags;
    // Written by the interface thread, polled by the worker: one atomic byte.
    std::atomic<bool> _taskAboutToBeStopped;
    ElementData *_elementData;
    TaskDescription _taskDescription;
};

static_assert(sizeof(std::atomic<bool>) == sizeof(bool), "the stop flag keeps the size of a bool");

#endif // KVT_ABSTRACTTASK_H
