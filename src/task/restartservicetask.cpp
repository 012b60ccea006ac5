#include "restartservicetask.h"

RestartServiceTask::RestartServiceTask(Element *element)
    : RServiceTask(element)
{
    _command = QStringLiteral("restart");
}

RestartServiceTask::~RestartServiceTask() = default;
