#ifndef KVT_READCONTENTTASK_H
#define KVT_READCONTENTTASK_H

#include "elementtask.h"

/*!
 * Reads the children of \a element. A plugin derives from it and does the
 * work in run().
 *
 * In force reread mode a task that carries a record (the one CreateTask
 * passes on) makes the child whose title is the record's name current.
 */
class KVTCOMMON_EXPORT ReadContentTask : public ElementTask
{
public:
    /*!
     * Creates the task without a record. run() reads the children into the task's own fields; afterRun() creates the child elements from them in the interface thread (see the class description).
     */
    ReadContentTask(Element *element);
    //! Destroys the task and its record.
    ~ReadContentTask() override;

    void afterRun() override;
};

#endif // KVT_READCONTENTTASK_H
