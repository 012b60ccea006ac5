#include "elementwidgettask.h"

ElementWidgetTask::ElementWidgetTask(ElementWidget *widget, ElementData *data)
    : AbstractTask(data)
    , _elementWidget(widget)
{
}

ElementWidgetTask::~ElementWidgetTask() = default;
