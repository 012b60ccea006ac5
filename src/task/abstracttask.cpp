// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "abstracttask.h"

#include "elementdata.h"
#include "taskobserver.h"

AbstractTask::AbstractTask(ElementData *data)
    : _taskSpecialFlags(0)
    , _taskAboutToBeStopped(false)
    , _elementData(data)
{
}

AbstractTask::~AbstractTask()
{
    // First, while the flags are still there: a row of the observer may be
    // reading them from the interface thread.
    TaskObserver::taskDestroyed(this);
    delete _elementData;
}

void AbstractTask::run()
{
    // Posts a TaskPerformedEvent to the observer; see postCompletion for the
    // case of a worker that finds no observer.
    TaskObserver::postCompletion(this);
}

bool AbstractTask::setTaskAboutToBeStopped()
{
    if (!(_taskSpecialFlags & StoppableFlag))
        return false;
    _taskAboutToBeStopped.store(true, std::memory_order_relaxed);
    return true;
}
