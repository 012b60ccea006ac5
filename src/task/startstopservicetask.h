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
    StartStopServiceTask(Element *element, bool start);
    ~StartStopServiceTask() override;

    void afterRun() override;

    bool start() const { return _start; }

protected:
    bool _start;
};

#endif // KVT_STARTSTOPSERVICETASK_H
