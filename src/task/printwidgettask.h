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
    PrintWidgetTask(ElementWidget *widget, ElementData *data);
    ~PrintWidgetTask() override;

    void run() override;
    void afterRun() override;
};

#endif // KVT_PRINTWIDGETTASK_H
