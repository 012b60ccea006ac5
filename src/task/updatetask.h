#ifndef KVT_UPDATETASK_H
#define KVT_UPDATETASK_H

#include "elementtask.h"

/*!
 * Writes the record given back to \a element's system object. A plugin
 * derives from it and does the work in run().
 *
 * Afterwards the element's properties are read again when its module has no
 * force reread value or a true one, even after a failure. Only a module that
 * has a stored false trusts a successful update: the edit widget is told
 * (afterSuccessfulUpdate()) and its changes are cleared.
 */
class KVTCOMMON_EXPORT UpdateTask : public ElementTask
{
public:
    UpdateTask(Element *element, ElementData *data);
    ~UpdateTask() override;

    void afterRun() override;
};

#endif // KVT_UPDATETASK_H
