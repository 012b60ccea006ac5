// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STOPSERVICETASK_H
#define KVT_STOPSERVICETASK_H

#include "startstopservicetask.h"

/*! Stops a service: runs its control program with "stop". */
class KVTCOMMON_EXPORT StopServiceTask : public StartStopServiceTask
{
public:
    //! Creates a "stop" task for the service of \a element.
    explicit StopServiceTask(Element *element);
    ~StopServiceTask() override;
};

#endif // KVT_STOPSERVICETASK_H
