// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "startevent.h"
#include "taskperformedevent.h"

StartEvent::StartEvent(const QString &pluginPath)
    : QEvent(EventType)
    , _pluginPath(pluginPath)
{
}

StartEvent::~StartEvent() = default;

TaskPerformedEvent::TaskPerformedEvent(AbstractTask *task)
    : QEvent(EventType)
    , _task(task)
{
}

TaskPerformedEvent::~TaskPerformedEvent() = default;
