// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * Creates the task with the changed properties in \a data (owned), usually the edit widget's exported record.
     */
    UpdateTask(Element *element, ElementData *data);
    //! Destroys the task and its record.
    ~UpdateTask() override;

    void afterRun() override;
};

#endif // KVT_UPDATETASK_H
