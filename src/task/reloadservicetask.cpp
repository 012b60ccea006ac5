// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "reloadservicetask.h"

ReloadServiceTask::ReloadServiceTask(Element *element)
    : RServiceTask(element)
{
    _command = QStringLiteral("reload");
}

ReloadServiceTask::~ReloadServiceTask() = default;
