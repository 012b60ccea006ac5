// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STARTSTOPSERVICETASK_H
#define KVT_STARTSTOPSERVICETASK_H

#include "servicetask.h"

/*!
 * Base of the start and stop tasks. In force reread mode the element's
 * properties are read again afterwards. Otherwise a successful task sets the
 * element's state to the wanted one (its "state" value, or the state of its
 * ServiceLightElementData), announces the change and shows it in an open
 * edit widget; a failed one changes nothing.
 */
class KVTCOMMON_EXPORT StartStopServiceTask : public ServiceTask
{
public:
    //! Creates a task that starts (\a start true) or stops the service of \a element.
    StartStopServiceTask(Element *element, bool start);
    //! Destroys the task.
    ~StartStopServiceTask() override;

    void afterRun() override;

    //! The wanted state: true to start, false to stop.
    bool start() const { return _start; }

protected:
    //! See start().
    bool _start;
};

#endif // KVT_STARTSTOPSERVICETASK_H
