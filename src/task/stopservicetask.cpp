// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "stopservicetask.h"

StopServiceTask::StopServiceTask(Element *element)
    : StartStopServiceTask(element, false)
{
    _command = QStringLiteral("stop");
}

StopServiceTask::~StopServiceTask() = default;
