// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CREATETASK_H
#define KVT_CREATETASK_H

#include "elementtask.h"

/*!
 * Creates an element under \a element (the container) from the record
 * given. A plugin derives from it and does the work in run().
 *
 * Afterwards, in force reread mode, the container is read again and told
 * the name of the new element, so that it can be selected once it is
 * listed (see ReadContentTask); otherwise a successful creation clears the
 * changes of the container's creation widget.
 */
class KVTCOMMON_EXPORT CreateTask : public ElementTask
{
public:
    /*!
     * Creates the task for the container \a element with the record of the new element (owned); the record's "name" names the element to select after a re-read.
     */
    CreateTask(Element *element, ElementData *data);
    //! Destroys the task and its record.
    ~CreateTask() override;

    void afterRun() override;
};

#endif // KVT_CREATETASK_H
