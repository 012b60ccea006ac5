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
    StoppableDummyTask(Element *element);
    ~StoppableDummyTask() override;

    void run() override;
    void afterRun() override;
};

#endif // KVT_STOPPABLEDUMMYTASK_H
