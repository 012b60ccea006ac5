#include "taskobserver.h"

#include "abstracttask.h"
#include "blockdialog.h"
#include "taskobserverdialog.h"
#include "taskobservermodel.h"
#include "taskperformedevent.h"
#include "thread.h"
#include "kvtlogging_p.h"

#include <QTimer>
#include <QWidget>

TaskObserver *TaskObserver::_instance = nullptr;

TaskObserver *TaskObserver::instance(QObject *parent)
{
    if (!_instance)
        _instance = new TaskObserver(parent);
    return _instance;
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
    delete _blockDialog;
    delete _dialog;
    if (_instance == this)
        _instance = nullptr;
}

void TaskObserver::performTask(AbstractTask *task)
{
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
    Q_EMIT tasksInserted(row, row);

    if (!Thread::put(task)) {
        // No worker has a free slot (or none has started). The task does
        // not run; it is reported as failed and deleted, so that it is
        // neither leaked nor left "processing" for ever.
        qCWarning(KVT_TASK, "TaskObserver: task \"%s\" refused, the task queue is full or no worker runs",
                 qPrintable(task->taskDescription().description()));
        task->taskDescription().setStatus(TaskDescription::Fail);
        task->taskDescription().setMessage(tr("The task was not started: no worker thread is free."));
        recordOutcome(task);
        forgetTask(task);
        delete task;
    }
}

void TaskObserver::taskPerformedEvent(TaskPerformedEvent *event)
{
    if (!event || !event->task())
        return;
    AbstractTask *task = event->task();
    recordOutcome(task);
    // A task is deleted right below, so its row forgets it now: a pointer to
    // a deleted task could be taken for a new task created at the same
    // address, which would then be refused as already listed.
    forgetTask(task);
    task->afterRun();
    delete task;
}

void TaskObserver::recordOutcome(AbstractTask *task)
{
    const int row = _taskRows.value(task, -1);
    if (row >= 0 && row < _rows.size()) {
        _rows[row].description = task->taskDescription();
        Q_EMIT taskDataChanged(row);
        switch (task->taskDescription().status()) {
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
}

bool TaskObserver::requestStop(int row)
{
    if (row < 0 || row >= _rows.size())
        return false;
    Row &entry = _rows[row];
    if (entry.description.status() != TaskDescription::Processing || !entry.task)
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
