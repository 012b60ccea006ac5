// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RSERVICETASK_H
#define KVT_RSERVICETASK_H

#include "servicetask.h"

/*!
 * Base of the restart and reload tasks. The element's properties are read
 * again afterwards in force reread mode and after a failure; a successful
 * restart or reload outside that mode leaves the element as it is.
 */
class KVTCOMMON_EXPORT RServiceTask : public ServiceTask
{
public:
    //! Creates a task for the service of \a element.
    explicit RServiceTask(Element *element);
    //! Destroys the task.
    ~RServiceTask() override;

    void afterRun() override;
};

#endif // KVT_RSERVICETASK_H
