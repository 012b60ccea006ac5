// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_DUMMYTASK_H
#define KVT_DUMMYTASK_H

#include "elementtask.h"

#include <QCoreApplication>

/*!
 * A task that only waits five seconds and then succeeds or fails as told;
 * for trying out the task list.
 */
class KVTCOMMON_EXPORT DummyTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(DummyTask)

public:
    //! Creates a task named "Dummy task" that succeeds when \a success is true and fails otherwise.
    DummyTask(Element *element, bool success);
    //! Destroys the task.
    ~DummyTask() override;

    //! Sleeps five seconds, then sets the status (and an error message on failure).
    void run() override;
    //! Does nothing.
    void afterRun() override;

protected:
    //! Whether the task is to succeed.
    bool _success;
};

#endif // KVT_DUMMYTASK_H
