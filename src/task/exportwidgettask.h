// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_EXPORTWIDGETTASK_H
#define KVT_EXPORTWIDGETTASK_H

#include "elementwidgettask.h"

#include <QCoreApplication>

/*!
 * Exports \a widget's content. A plugin derives from it and does the work
 * in run(); success is confirmed to the user by a message box.
 */
class KVTCOMMON_EXPORT ExportWidgetTask : public ElementWidgetTask
{
    Q_DECLARE_TR_FUNCTIONS(ExportWidgetTask)

public:
    //! Creates the task with the content to export in \a data (owned).
    ExportWidgetTask(ElementWidget *widget, ElementData *data);
    //! Destroys the task and its record.
    ~ExportWidgetTask() override;

    void afterRun() override;
};

#endif // KVT_EXPORTWIDGETTASK_H
