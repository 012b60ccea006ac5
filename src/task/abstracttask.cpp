#include "abstracttask.h"

#include "elementdata.h"
#include "taskobserver.h"
#include "taskperformedevent.h"

#include <QCoreApplication>

AbstractTask::AbstractTask(ElementData *data)
    : _taskSpecialFlags(0)
    , _taskAboutToBeStopped(false)
    , _elementData(data)
{
}

AbstractTask::~AbstractTask()
{
    delete _elementData;
}

void AbstractTask::run()
{
    QCoreApplication::postEvent(TaskObserver::instance(), new TaskPerformedEvent(this));
}

bool AbstractTask::setTaskAboutToBeStopped()
{
    if (!(_taskSpecialFlags & StoppableFlag))
        return false;
    _taskAboutToBeStopped.store(true, std::memory_order_relaxed);
    return true;
}
