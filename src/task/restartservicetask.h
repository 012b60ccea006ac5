// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RESTARTSERVICETASK_H
#define KVT_RESTARTSERVICETASK_H

#include "rservicetask.h"

/*! Restarts a service: runs its control program with "restart". */
class KVTCOMMON_EXPORT RestartServiceTask : public RServiceTask
{
public:
    //! Creates a "restart" task for the service of \a element.
    explicit RestartServiceTask(Element *element);
    ~RestartServiceTask() override;
};

#endif // KVT_RESTARTSERVICETASK_H
