#ifndef KVT_DUMMYTASK_H
#define KVT_DUMMYTASK_H

#include "elementtask.h"

#include <QCoreApplication>

/*!
 * A task that only waits five seconds and then succeeds or fails as told;
 * for trying out the task list.
 */
class KVTCOMMON_EXPORT DummyTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(DummyTask)

public:
    DummyTask(Element *element, bool success);
    ~DummyTask() override;

    void run() override;
    void afterRun() override;

protected:
    bool _success;
};

#endif // KVT_DUMMYTASK_H
