#include "importtask.h"

#include "elementtask_p.h"

#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

ImportTask::ImportTask(ElementWidget *widget, ElementData *data)
    : ElementWidgetTask(widget, data)
{
}

ImportTask::~ImportTask() = default;

void ImportTask::afterRun()
{
    if (failed(this))
        return;
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_elementWidget))
        widget->afterSuccessfulImport(_elementData);
}
