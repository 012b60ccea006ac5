#ifndef KVT_DELETETASK_H
#define KVT_DELETETASK_H

#include "elementtask.h"

/*!
 * Deletes \a element's system object. A plugin derives from it and does
 * the work in run().
 *
 * Afterwards the element's parent becomes current. Outside force reread
 * mode a successful task also removes the element from the tree and deletes
 * it; element() is null after that.
 */
class KVTCOMMON_EXPORT DeleteTask : public ElementTask
{
public:
    DeleteTask(Element *element);
    ~DeleteTask() override;

    void afterRun() override;
};

#endif // KVT_DELETETASK_H
