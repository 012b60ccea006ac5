// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
 *
 * \section task_status The status decides what follows
 * run() must set a final status before it calls AbstractTask::run():
 * - TaskDescription::Success: the task leaves the running count; afterRun()
 *   of the library's element tasks hands the result to the element and its
 *   widget (for instance ViewEditElementWidget::afterSuccessfulRead()).
 * - TaskDescription::Fail: the task counts as a problem; the task dialog
 *   opens (or stays open) with the message, and afterRun() of the element
 *   tasks leaves the widgets as they are (an edit widget keeps the user's
 *   unsaved changes).
 * - TaskDescription::Warning: a problem like a failure for the task dialog,
 *   while afterRun() treats it as a success.
 * A task that ends still TaskDescription::Processing (the default) or
 * TaskDescription::AboutToBeStopped is a programming error: the observer logs
 * it (category kvt.task) and lists the task as a warning.
 *
 * \section task_threads Threads
 * run() runs in a worker thread and may touch only the task's own fields and
 * its elementData() record. Elements, modules and widgets live in the
 * interface thread: read what run() needs from them in the constructor, and
 * hand results to them in afterRun(), which the observer calls in the
 * interface thread. A task is deleted by the observer right after afterRun();
 * a task still queued when the workers stop is deleted without running.
 */
class KVTCOMMON_EXPORT AbstractTask
{
public:
    //! Bit of taskSpecialFlags(): the user may ask the task to stop.
    static const quint64 StoppableFlag = 1;

    /*!
     * Creates a task that owns \a data (may be null) and deletes it with itself.
     * The task is not stoppable and its status is TaskDescription::Processing.
     */
    explicit AbstractTask(ElementData *data = nullptr);
    //! Deletes the task's record. Called by the observer in the interface thread.
    virtual ~AbstractTask();

    /*!
     * Called once in a worker thread. The base posts a TaskPerformedEvent to the
     * TaskObserver; a reimplementation does its work, sets the status and message
     * of taskDescription(), and calls AbstractTask::run() as its last statement.
     */
    virtual void run();
    /*!
     * Called in the interface thread after run() has finished, just before the
     * observer deletes the task: the place where results reach elements and
     * widgets.
     */
    virtual void afterRun() = 0;

    //! Flag bits of the task; StoppableFlag says the user may ask it to stop.
    quint64 taskSpecialFlags() const { return _taskSpecialFlags; }
    /*!
     * Whether the user asked the task to stop. A stoppable task polls it in run()
     * and, when set, ends early with a final status of its own choice.
     */
    bool taskAboutToBeStopped() const { return _taskAboutToBeStopped.load(std::memory_order_relaxed); }
    /*!
     * Asks a stoppable task to stop. Returns false for a task that cannot be
     * stopped, true when the request is (or already was) recorded. The
     * running task notices it by polling taskAboutToBeStopped().
     */
    bool setTaskAboutToBeStopped();

    //! The name, status and message shown in the task list; run() sets the outcome here.
    TaskDescription &taskDescription() { return _taskDescription; }
    //! The name, status and message shown in the task list.
    const TaskDescription &taskDescription() const { return _taskDescription; }
    //! The record the task owns, or null.
    ElementData *elementData() const { return _elementData; }

    AbstractTask(const AbstractTask &) = delete;
    AbstractTask &operator=(const AbstractTask &) = delete;

protected:
    //! See taskSpecialFlags(); a stoppable task sets StoppableFlag in its constructor.
    quint64 _taskSpecialFlags;
    // Written by the interface thread, polled by the worker: one atomic byte.
    //! See taskAboutToBeStopped().
    std::atomic<bool> _taskAboutToBeStopped;
    /*!
     * The record the task owns (may be null). A task constructed without one
     * (ReadContentTask, ReadPropertyHeavyTask, DeleteTask, the service tasks) may
     * create it in run() when it has a result to hand over; the task deletes it.
     */
    ElementData *_elementData;
    //! See taskDescription().
    TaskDescription _taskDescription;
};

static_assert(sizeof(std::atomic<bool>) == sizeof(bool), "the stop flag keeps the size of a bool");

#endif // KVT_ABSTRACTTASK_H
