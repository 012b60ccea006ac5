// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_READPROPERTYLIGHTSERVICETASK_H
#define KVT_READPROPERTYLIGHTSERVICETASK_H

#include "servicetask.h"

/*!
 * Asks a service's control program for the "status" and copies the state
 * into the element's ServiceLightElementData, so that views show it.
 */
class KVTCOMMON_EXPORT ReadPropertyLightServiceTask : public ServiceTask
{
public:
    /*!
     * Creates a status query of the service of \a element, with a ServiceLightElementData record of its own.
     */
    explicit ReadPropertyLightServiceTask(Element *element);
    //! Destroys the task and its record.
    ~ReadPropertyLightServiceTask() override;

    void afterRun() override;
};

#endif // KVT_READPROPERTYLIGHTSERVICETASK_H
