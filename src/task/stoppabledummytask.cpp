// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "stoppabledummytask.h"

#include <unistd.h>

namespace {
const int passes = 10;
const unsigned int secondsPerPass = 5;
}

StoppableDummyTask::StoppableDummyTask(Element *element)
    : ElementTask(element)
{
    _taskSpecialFlags = StoppableFlag;
    _taskDescription.setDescription(tr("Stoppable dummy task"));
}

StoppableDummyTask::~StoppableDummyTask() = default;

void StoppableDummyTask::run()
{
    bool stopped = false;
    for (int pass = 0; pass < passes; ++pass) {
        if (taskAboutToBeStopped()) {
            stopped = true;
            break;
        }
        sleep(secondsPerPass);
    }
    if (stopped) {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("Terminate by user"));
    } else {
        _taskDescription.setStatus(TaskDescription::Success);
    }
    AbstractTask::run();
}

void StoppableDummyTask::afterRun()
{
}
