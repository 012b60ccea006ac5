// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_IMPORTTASK_H
#define KVT_IMPORTTASK_H

#include "elementwidgettask.h"

/*!
 * Imports content into \a widget. A plugin derives from it and fills the
 * record in run(); a successful import reaches the widget as an unsaved
 * change (ViewEditElementWidget::afterSuccessfulImport()).
 */
class KVTCOMMON_EXPORT ImportTask : public ElementWidgetTask
{
public:
    //! Creates the task with \a data (owned), which run() fills with the imported content.
    ImportTask(ElementWidget *widget, ElementData *data);
    //! Destroys the task and its record.
    ~ImportTask() override;

    void afterRun() override;
};

#endif // KVT_IMPORTTASK_H
