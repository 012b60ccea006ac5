// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_READPROPERTYHEAVYTASK_H
#define KVT_READPROPERTYHEAVYTASK_H

#include "elementtask.h"

/*!
 * Reads the properties of \a element. A plugin derives from it, fills the
 * task's record in run(), and a successful read is handed to the element's
 * edit widget (ViewEditElementWidget::afterSuccessfulRead()).
 */
class KVTCOMMON_EXPORT ReadPropertyHeavyTask : public ElementTask
{
public:
    /*!
     * Creates the task without a record: run() must create one (an ElementData the task then owns) and fill it, or the edit widget receives null.
     */
    ReadPropertyHeavyTask(Element *element);
    //! Destroys the task and its record.
    ~ReadPropertyHeavyTask() override;

    void afterRun() override;
};

#endif // KVT_READPROPERTYHEAVYTASK_H
