// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "restartservicetask.h"

RestartServiceTask::RestartServiceTask(Element *element)
    : RServiceTask(element)
{
    _command = QStringLiteral("restart");
}

RestartServiceTask::~RestartServiceTask() = default;
