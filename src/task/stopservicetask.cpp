#include "stopservicetask.h"

StopServiceTask::StopServiceTask(Element *element)
    : StartStopServiceTask(element, false)
{
    _command = QStringLiteral("stop");
}

StopServiceTask::~StopServiceTask() = default;
