#ifndef KVT_ELEMENTTASK_H
#define KVT_ELEMENTTASK_H

#include "abstracttask.h"

class Element;

/*!
 * A task that works for one element. The element is not owned; it must
 * outlive the task (the observer deletes the task, never the element).
 */
class KVTCOMMON_EXPORT ElementTask : public AbstractTask
{
public:
    ElementTask(Element *element, ElementData *data = nullptr);
    ~ElementTask() override;

    Element *element() const { return _element; }

protected:
    Element *_element;
};

#endif // KVT_ELEMENTTASK_H
