// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STOPPABLEDUMMYTASK_H
#define KVT_STOPPABLEDUMMYTASK_H

#include "elementtask.h"

#include <QCoreApplication>

/*!
 * A task that waits fifty seconds in steps of five and can be stopped
 * between the steps; for trying out stopping tasks.
 */
class KVTCOMMON_EXPORT StoppableDummyTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(StoppableDummyTask)

public:
    //! Creates the stoppable task "Stoppable dummy task".
    StoppableDummyTask(Element *element);
    //! Destroys the task.
    ~StoppableDummyTask() override;

    /*!
     * Sleeps up to ten times five seconds; a stop request ends it after the current sleep with "Terminate by user".
     */
    void run() override;
    //! Does nothing.
    void afterRun() override;
};

#endif // KVT_STOPPABLEDUMMYTASK_H
