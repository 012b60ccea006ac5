// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "workerthreads.h"

#include <kvt-common/taskperformedevent.h>
#include <kvt-common/thread.h>

#include <QCoreApplication>

WorkerThreads::WorkerThreads(int count)
{
    for (int i = 0; i < count; ++i) {
        _threads.push_back(std::make_unique<Thread>());
        _threads.back()->start();
    }
}

WorkerThreads::~WorkerThreads()
{
    stop();
}

void WorkerThreads::stop()
{
    if (_threads.empty())
        return;
    _threads.clear();
    QCoreApplication::sendPostedEvents(nullptr, TaskPerformedEvent::EventType);
}
