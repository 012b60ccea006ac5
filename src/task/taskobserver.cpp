// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "taskobserver.h"

#include "abstracttask.h"
#include "blockdialog.h"
#include "handover_p.h"
#include "taskobserverdialog.h"
#include "taskobservermodel.h"
#include "taskperformedevent.h"
#include "thread.h"
#include "kvtlogging_p.h"

#include <QCoreApplication>
#include <QMutex>
#include <QSet>
#include <QThread>
#include <QTimer>
#include <QWidget>

TaskObserver *TaskObserver::_instance = nullptr;

namespace {

// What workers share with the observer. _instance is written only by the
// interface thread, under this lock, so that a worker never posts to an
// observer being destroyed. The tasks that have a row and still exist are
// listed here too: a stopping worker deletes the tasks still queued, in its
// own thread, and the rows must not reach them afterwards.
struct SharedState
{
    QMutex mutex;
    QSet<const AbstractTask *> listed;     // alive, with a row in the observer
    QList<const AbstractTask *> droppedListed; // destroyed while listed, row not settled yet
};

SharedState &shared()
{
    static SharedState state;
    return state;
}

// The observer whose destructor is handing out the completions still queued.
const TaskObserver *dyingObserver = nullptr;

// Addresses that mark the queued calls made by workers (see handover_p.h).
const char completionRelay = 0;
const char settleRequest = 0;

bool inInterfaceThread()
{
    const QCoreApplication *app = QCoreApplication::instance();
    return !app || QThread::currentThread() == app->thread();
}

bool isFinalStatus(TaskDescription::TaskStatus status)
{
    return status == TaskDescription::Fail || status == TaskDescription::Success
        || status == TaskDescription::Warning;
}

} // namespace

TaskObserver *TaskObserver::instance(QObject *parent)
{
    // Only the interface thread creates or destroys the observer, so it reads
    // _instance without the lock; other threads take it.
    if (inInterfaceThread()) {
        if (!_instance) {
            TaskObserver *observer = new TaskObserver(parent);
            KvtHandOver::Locker locker(&shared().mutex);
            _instance = observer;
        }
        return _instance;
    }
    KvtHandOver::Locker locker(&shared().mutex);
    if (!_instance) {
        // Made here, the observer and its dialogs would live in a worker that
        // has no event loop: completions would never arrive.
        qCWarning(KVT_TASK, "TaskObserver::instance(): no observer exists and it cannot be created outside the interface thread");
    }
    return _instance;
}

void TaskObserver::postCompletion(AbstractTask *task)
{
    {
        KvtHandOver::Locker locker(&shared().mutex);
        if (_instance) {
            auto *event = new TaskPerformedEvent(task);
            KvtHandOver::handOver(event);
            QCoreApplication::postEvent(_instance, event);
            return;
        }
    }
    // No observer: the task was queued before one was made, or the observer
    // was destroyed while the task ran. The completion goes to the interface
    // thread, which makes the observer there and hands it the task.
    QCoreApplication *app = QCoreApplication::instance();
    if (!app) {
        qCWarning(KVT_TASK, "task \"%s\" finished without an application object: its completion cannot be delivered",
                  qPrintable(task->taskDescription().description()));
        return;
    }
    if (inInterfaceThread()) {
        QCoreApplication::postEvent(instance(), new TaskPerformedEvent(task));
        return;
    }
    KvtHandOver::handOver(&completionRelay);
    QMetaObject::invokeMethod(app, [task] {
        KvtHandOver::takeOver(&completionRelay);
        QCoreApplication::postEvent(TaskObserver::instance(), new TaskPerformedEvent(task));
    }, Qt::QueuedConnection);
}

void TaskObserver::taskDestroyed(AbstractTask *task)
{
    KvtHandOver::Locker locker(&shared().mutex);
    if (!shared().listed.remove(task))
        return;
    // Destroyed while its row still points at it: dropped by a stopping
    // worker (or deleted by its owner against the rules). The row is settled
    // in the interface thread.
    shared().droppedListed.append(task);
    if (_instance) {
        TaskObserver *observer = _instance;
        KvtHandOver::handOver(&settleRequest);
        QMetaObject::invokeMethod(observer, [observer] {
            KvtHandOver::takeOver(&settleRequest);
            observer->settleDroppedTasks();
        }, Qt::QueuedConnection);
    }
}

TaskObserver::TaskObserver(QObject *parent)
    : QObject(parent)
    , _runningCount(0)
    , _problemCount(0)
    , _timer(new QTimer(this))
    , _model(nullptr)
    , _blockDialog(nullptr)
    , _dialog(nullptr)
{
    _timer->setSingleShot(true);
    _timer->setInterval(_delay);
    _model = new TaskObserverModel(this, this);
    _dialog = new TaskObserverDialog(this, qobject_cast<QWidget *>(parent));
    connect(_timer, SIGNAL(timeout()), this, SLOT(openTaskObserveDialog()));
    connect(_dialog, SIGNAL(rejected()), this, SLOT(clearTasks()));
}

TaskObserver::~TaskObserver()
{
    {
        KvtHandOver::Locker locker(&shared().mutex);
        if (_instance == this)
            _instance = nullptr;
        // Tasks still running report to the next observer; their rows go
        // with this one.
        for (auto it = _taskRows.cbegin(); it != _taskRows.cend(); ++it)
            shared().listed.remove(it.key());
        shared().droppedListed.clear();
    }
    // Completions already posted here would be discarded with this object,
    // and their tasks never finished nor freed: finish them now, quietly.
    dyingObserver = this;
    QCoreApplication::sendPostedEvents(this, TaskPerformedEvent::EventType);
    dyingObserver = nullptr;
    delete _blockDialog;
    delete _dialog;
}

void TaskObserver::performTask(AbstractTask *task)
{
    // A task may be new at the address of one that a stopping worker dropped:
    // the old row lets go of that address first.
    settleDroppedTasks();
    if (!task || _taskRows.contains(task) || task->taskAboutToBeStopped())
        return;

    if (_runningCount == 0) {
        _dialog->blockCloseButton();
        if (!_dialog->isVisible()) {
            if (_timer->interval() != 0) {
                openBlockDialog();
                _timer->start();
            } else {
                openTaskObserveDialog();
            }
        }
    }

    const int row = _rows.size();
    Q_EMIT tasksAboutToBeInserted(row, row);
    ++_runningCount;
    _taskRows.insert(task, row);
    _rows.append(Row{task->taskDescription(), task});
    {
        KvtHandOver::Locker locker(&shared().mutex);
        shared().listed.insert(task);
    }
    Q_EMIT tasksInserted(row, row);

    if (!Thread::put(task)) {
        // No worker has a free slot (or none has started). The task does
        // not run; it is reported as failed and deleted, so that it is
        // neither leaked nor left "processing" for ever.
        qCWarning(KVT_TASK, "TaskObserver: task \"%s\" refused, the task queue is full or no worker runs",
                 qPrintable(task->taskDescription().description()));
        task->taskDescription().setStatus(TaskDescription::Fail);
        task->taskDescription().setMessage(tr("The task was not started: no worker thread is free."));
        recordOutcome(task, task->taskDescription());
        forgetTask(task);
        delete task;
    }
}

void TaskObserver::taskPerformedEvent(TaskPerformedEvent *event)
{
    if (!event || !event->task())
        return;
    AbstractTask *task = event->task();
    if (dyingObserver == this) {
        // The observer is going away: the task is finished without a row.
        task->afterRun();
        delete task;
        return;
    }
    TaskDescription outcome = task->taskDescription();
    if (!isFinalStatus(outcome.status())) {
        // A run() that ends without fail, success or warning would keep the
        // list "running" for ever. It counts as a warning, so that the user
        // sees it and the list can still close.
        qCWarning(KVT_TASK, "task \"%s\" finished with the status %d instead of fail, success or warning; "
                            "its run() must set a final status before calling AbstractTask::run()",
                  qPrintable(outcome.description()), int(outcome.status()));
        outcome.setStatus(TaskDescription::Warning);
        if (outcome.message().isEmpty())
            outcome.setMessage(tr("The task finished without reporting its outcome."));
    }
    recordOutcome(task, outcome);
    // A task is deleted right below, so its row forgets it now: a pointer to
    // a deleted task could be taken for a new task created at the same
    // address, which would then be refused as already listed.
    forgetTask(task);
    task->afterRun();
    delete task;
}

void TaskObserver::recordOutcome(AbstractTask *task, const TaskDescription &outcome)
{
    const int row = _taskRows.value(task, -1);
    if (row >= 0 && row < _rows.size()) {
        _rows[row].description = outcome;
        Q_EMIT taskDataChanged(row);
        switch (outcome.status()) {
        case TaskDescription::Success:
            --_runningCount;
            break;
        case TaskDescription::Fail:
        case TaskDescription::Warning:
            --_runningCount;
            ++_problemCount;
            break;
        default:
            break;
        }
    }

    if (_runningCount != 0)
        return;
    _dialog->unblockCloseButton();
    if (_timer->isActive()) {
        closeBlockDialog();
        _timer->stop();
    }
    forgetTask(task);
    if (_dialog->isVisible()) {
        if (_problemCount == 0)
            _dialog->reject();
    } else if (_problemCount != 0) {
        openTaskObserveDialog();
    } else {
        clearTasks();
    }
}

void TaskObserver::forgetTask(AbstractTask *task)
{
    const auto it = _taskRows.find(task);
    if (it == _taskRows.end())
        return;
    if (*it >= 0 && *it < _rows.size())
        _rows[*it].task = nullptr;
    _taskRows.erase(it);
    KvtHandOver::Locker locker(&shared().mutex);
    shared().listed.remove(task);
}

void TaskObserver::settleDroppedTasks()
{
    QList<const AbstractTask *> dropped;
    {
        KvtHandOver::Locker locker(&shared().mutex);
        dropped.swap(shared().droppedListed);
    }
    for (const AbstractTask *gone : qAsConst(dropped)) {
        // Only the address is used: the task no longer exists.
        auto *task = const_cast<AbstractTask *>(gone);
        const int row = _taskRows.value(task, -1);
        if (row < 0 || row >= _rows.size())
            continue;
        _rows[row].task = nullptr;
        TaskDescription outcome = _rows.at(row).description;
        outcome.setStatus(TaskDescription::Fail);
        outcome.setMessage(tr("The task was dropped without running: the worker threads were stopped."));
        recordOutcome(task, outcome);
        forgetTask(task);
    }
}

quint64 TaskObserver::rowTaskSpecialFlags(int row) const
{
    if (row < 0 || row >= _rows.size() || !_rows.at(row).task)
        return 0;
    const AbstractTask *task = _rows.at(row).task;
    KvtHandOver::Locker locker(&shared().mutex);
    return shared().listed.contains(task) ? task->taskSpecialFlags() : 0;
}

bool TaskObserver::requestStop(int row)
{
    if (row < 0 || row >= _rows.size())
        return false;
    Row &entry = _rows[row];
    if (entry.description.status() != TaskDescription::Processing || !entry.task)
        return false;
    // Held while the task is asked: a stopping worker cannot delete it meanwhile.
    KvtHandOver::Locker locker(&shared().mutex);
    if (!shared().listed.contains(entry.task))
        return false;
    if (!(entry.task->taskSpecialFlags() & AbstractTask::StoppableFlag)
        || entry.task->taskAboutToBeStopped() || !entry.task->setTaskAboutToBeStopped())
        return false;
    entry.description.setStatus(TaskDescription::AboutToBeStopped);
    return true;
}

bool TaskObserver::event(QEvent *event)
{
    if (event->type() == TaskPerformedEvent::EventType) {
        KvtHandOver::takeOver(event);
        taskPerformedEvent(static_cast<TaskPerformedEvent *>(event));
        event->accept();
        return true;
    }
    return QObject::event(event);
}

void TaskObserver::openTaskObserveDialog()
{
    closeBlockDialog();
    _dialog->open();
}

void TaskObserver::clearTasks()
{
    const int count = _rows.size();
    Q_EMIT tasksAboutToBeRemoved(count, count);
    _runningCount = 0;
    _problemCount = 0;
    {
        KvtHandOver::Locker locker(&shared().mutex);
        for (auto it = _taskRows.cbegin(); it != _taskRows.cend(); ++it)
            shared().listed.remove(it.key());
    }
    _taskRows.clear();
    _rows.clear();
    Q_EMIT tasksRemoved(count, count);
}

void TaskObserver::openBlockDialog()
{
    if (!_blockDialog) {
        BlockDialog *dialog = new BlockDialog(qobject_cast<QWidget *>(parent()));
        // The dialog deletes itself once closed; forget it then.
        connect(dialog, &QObject::destroyed, this, [this, dialog] {
            if (_blockDialog == dialog)
                _blockDialog = nullptr;
        });
        _blockDialog = dialog;
    }
    _blockDialog->show();
}

void TaskObserver::closeBlockDialog()
{
    if (!_blockDialog)
        return;
    BlockDialog *dialog = _blockDialog;
    _blockDialog = nullptr;
    dialog->reject(); // deletes itself (later): it is closed on delete

}
