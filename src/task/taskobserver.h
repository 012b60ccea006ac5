// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TASKOBSERVER_H
#define KVT_TASKOBSERVER_H

#include "taskdescription.h"

#include <QList>
#include <QMap>
#include <QObject>

class AbstractTask;
class BlockDialog;
class QTimer;
class TaskObserverDialog;
class TaskObserverModel;
class TaskPerformedEvent;

/*!
 * The one entry point through which tasks are started, and the list of the
 * tasks started since the list was last cleared.
 *
 * performTask() records a task and hands it to the worker threads; when the
 * task has run, the observer copies its outcome into the list, calls its
 * afterRun() and deletes it, always in the interface thread.
 *
 * While work runs the task dialog cannot be closed. During the first second
 * a small modal dialog blocks the window; after that the task dialog shows
 * the list. When the last task ends without problems the dialog closes and
 * the list is cleared; a failure or warning leaves it open for the user.
 */
class KVTCOMMON_EXPORT TaskObserver : public QObject
{
    Q_OBJECT

public:
    //! One entry of the list: what the task reported last, and the task
    //! itself while it exists.
    struct Row
    {
        //! The task's description as last reported.
        TaskDescription description;
        //! The task, or null once it is gone.
        AbstractTask *task = nullptr;
    };

    //! Milliseconds of work after which the task dialog replaces the block dialog.
    static const int _delay = 1000;

    /*!
     * The observer of the process, created by the first call with \a parent
     * as its QObject parent (and, when it is a widget, as the parent of the
     * dialogs); later calls ignore \a parent.
     *
     * The observer and its dialogs belong to the interface thread: called
     * from another thread while no observer exists, this returns null and
     * logs a warning instead of creating one there.
     */
    static TaskObserver *instance(QObject *parent = nullptr);

    ~TaskObserver() override;

    /*!
     * Starts \a task; the observer takes ownership. A null task, one that is
     * already listed and one already asked to stop are ignored. Call it in the
     * interface thread, after at least one Thread has begun to run (see
     * Thread::threadIndex()).
     *
     * A task that the workers cannot take (no worker has started yet, or all
     * 64 slots of the ring are taken) is not run: its row shows it failed
     * with a message saying so, and it is deleted without afterRun().
     */
    void performTask(AbstractTask *task);
    //! The model of the task list (three columns: task, status, message).
    TaskObserverModel *model() const { return _model; }
    /*!
     * Completion of a task, in the interface thread: copies its outcome into the
     * list, opens or closes the task dialog, then calls the task's afterRun() and
     * deletes it.
     */
    void taskPerformedEvent(TaskPerformedEvent *event);

    //! Sends TaskPerformedEvent to taskPerformedEvent().
    bool event(QEvent *event) override;

    //! The tasks started since the list was last cleared.
    const QList<Row> &rows() const { return _rows; }
    //! Tasks started and not yet finished with a final status.
    int runningCount() const { return _runningCount; }
    //! Tasks that failed or ended with a warning since the list was last cleared.
    int problemCount() const { return _problemCount; }
    //! The task dialog, owned by the observer.
    TaskObserverDialog *dialog() const { return _dialog; }

public Q_SLOTS:
    //! Closes the block dialog and opens the task dialog window-modally.
    void openTaskObserveDialog();
    //! Forgets every row and resets both counts; called when the task dialog is closed.
    void clearTasks();

Q_SIGNALS:
    //! Row \a first (= \a last) is about to be added.
    void tasksAboutToBeInserted(int first, int last);
    //! All rows are about to go; both arguments carry the row count.
    void tasksAboutToBeRemoved(int first, int last);
    //! Row \a first (= \a last) was added.
    void tasksInserted(int first, int last);
    //! All rows are gone; both arguments carry the former row count.
    void tasksRemoved(int first, int last);
    //! The description of \a row changed.
    void taskDataChanged(int row);

private:
    explicit TaskObserver(QObject *parent);

    void openBlockDialog();
    void closeBlockDialog();
    void recordOutcome(AbstractTask *task, const TaskDescription &outcome);
    void forgetTask(AbstractTask *task);
    bool requestStop(int row);
    quint64 rowTaskSpecialFlags(int row) const;
    void settleDroppedTasks();

    // Called by AbstractTask, from any thread.
    static void postCompletion(AbstractTask *task);
    static void taskDestroyed(AbstractTask *task);

    friend class AbstractTask;
    friend class TaskObserverModel;

    int _runningCount;
    int _problemCount;
    QMap<AbstractTask *, int> _taskRows;
    QList<Row> _rows;
    QTimer *_timer;
    TaskObserverModel *_model;
    BlockDialog *_blockDialog;
    TaskObserverDialog *_dialog;

    static TaskObserver *_instance;
};

#endif // KVT_TASKOBSERVER_H
