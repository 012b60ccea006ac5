// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_READCONTENTTASK_H
#define KVT_READCONTENTTASK_H

#include "elementtask.h"

/*!
 * Reads the children of \a element. A plugin derives from it and does the
 * work in run().
 *
 * In force reread mode a task that carries a record (the one CreateTask
 * passes on) makes the child whose title is the record's name current.
 *
 * The children are elements, which live in the interface thread, so run()
 * only collects what it read (names, properties) in fields of the task. The
 * plugin's afterRun() then, in the interface thread, removes and deletes the
 * old children (TreeNode::clearDelete() on the container), creates the new
 * ones with the container as their QObject parent, appends them
 * (TreeNode::append(), which views see at once) and finally calls
 * ReadContentTask::afterRun().
 *
 * The children belong to the container: Module::resetConteinerElement()
 * deletes them with clearDelete(), and the QObject parent deletes those still
 * there when the container goes. The tree itself never deletes a node.
 */
class KVTCOMMON_EXPORT ReadContentTask : public ElementTask
{
public:
    /*!
     * Creates the task without a record. run() reads the children into fields
     * of the task; afterRun() creates the child elements from them.
     */
    ReadContentTask(Element *element);
    //! Destroys the task and its record.
    ~ReadContentTask() override;

    void afterRun() override;
};

#endif // KVT_READCONTENTTASK_H
