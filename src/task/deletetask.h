// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates the task without a record.
    DeleteTask(Element *element);
    //! Destroys the task and its record; the element only in the case described above.
    ~DeleteTask() override;

    void afterRun() override;
};

#endif // KVT_DELETETASK_H
