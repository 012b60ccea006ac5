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
    ImportTask(ElementWidget *widget, ElementData *data);
    ~ImportTask() override;

    void afterRun() override;
};

#endif // KVT_IMPORTTASK_H
