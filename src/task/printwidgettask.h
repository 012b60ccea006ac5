// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PRINTWIDGETTASK_H
#define KVT_PRINTWIDGETTASK_H

#include "elementwidgettask.h"

#include <QCoreApplication>

/*!
 * Turns a widget's report into HTML and shows it in the print preview.
 *
 * run() applies the XSLT 2.0 stylesheet named by the record's
 * "templateName" (a URL; a relative one is taken from the application's
 * folder) to the XML text under "xmlText" and stores the result under
 * "htmlText". afterRun() opens the preview (PreviewDialog) with it.
 */
class KVTCOMMON_EXPORT PrintWidgetTask : public ElementWidgetTask
{
    Q_DECLARE_TR_FUNCTIONS(PrintWidgetTask)

public:
    //! Creates the task with \a data (owned) holding "xmlText" and "templateName".
    PrintWidgetTask(ElementWidget *widget, ElementData *data);
    //! Destroys the task and its record.
    ~PrintWidgetTask() override;

    //! Applies the stylesheet in the worker thread; a failed transformation fails the task.
    void run() override;
    //! Shows the HTML in the print preview after a successful run.
    void afterRun() override;
};

#endif // KVT_PRINTWIDGETTASK_H
