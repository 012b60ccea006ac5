// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STARTSERVICETASK_H
#define KVT_STARTSERVICETASK_H

#include "startstopservicetask.h"

/*! Starts a service: runs its control program with "start". */
class KVTCOMMON_EXPORT StartServiceTask : public StartStopServiceTask
{
public:
    //! Creates a "start" task for the service of \a element.
    explicit StartServiceTask(Element *element);
    ~StartServiceTask() override;
};

#endif // KVT_STARTSERVICETASK_H
