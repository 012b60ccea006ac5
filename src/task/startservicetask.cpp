// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "startservicetask.h"

StartServiceTask::StartServiceTask(Element *element)
    : StartStopServiceTask(element, true)
{
    _command = QStringLiteral("start");
}

StartServiceTask::~StartServiceTask() = default;
