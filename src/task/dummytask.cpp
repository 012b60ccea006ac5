// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "dummytask.h"

#include <unistd.h>

DummyTask::DummyTask(Element *element, bool success)
    : ElementTask(element)
    , _success(success)
{
    _taskDescription.setDescription(tr("Dummy task"));
}

DummyTask::~DummyTask() = default;

void DummyTask::run()
{
    sleep(5);
    if (_success) {
        _taskDescription.setStatus(TaskDescription::Success);
    } else {
        _taskDescription.setStatus(TaskDescription::Fail);
        // Not translated: a developer's tool.
        _taskDescription.setMessage(QStringLiteral("ERROR!!!\nERROR!!!\nERROR!!!\nERROR!!!\n"));
    }
    AbstractTask::run();
}

void DummyTask::afterRun()
{
}
