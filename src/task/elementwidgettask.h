#ifndef KVT_ELEMENTWIDGETTASK_H
#define KVT_ELEMENTWIDGETTASK_H

#include "abstracttask.h"

class ElementWidget;

/*!
 * A task that works for one element widget (import, export, print). The
 * widget is not owned; it must outlive the task.
 */
class KVTCOMMON_EXPORT ElementWidgetTask : public AbstractTask
{
public:
    ElementWidgetTask(ElementWidget *widget, ElementData *data = nullptr);
    ~ElementWidgetTask() override;

    ElementWidget *elementWidget() const { return _elementWidget; }

protected:
    ElementWidget *_elementWidget;
};

#endif // KVT_ELEMENTWIDGETTASK_H
