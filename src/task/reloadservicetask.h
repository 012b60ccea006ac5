// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RELOADSERVICETASK_H
#define KVT_RELOADSERVICETASK_H

#include "rservicetask.h"

/*! Reloads a service: runs its control program with "reload". */
class KVTCOMMON_EXPORT ReloadServiceTask : public RServiceTask
{
public:
    //! Creates a "reload" task for the service of \a element.
    explicit ReloadServiceTask(Element *element);
    ~ReloadServiceTask() override;
};

#endif // KVT_RELOADSERVICETASK_H
