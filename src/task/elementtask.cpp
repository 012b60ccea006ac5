#include "elementtask.h"

#include "elementtask_p.h"

#include "element.h"
#include "module.h"

ElementTask::ElementTask(Element *element, ElementData *data)
    : AbstractTask(data)
    , _element(element)
{
}

ElementTask::~ElementTask() = default;

QVariant ElementTaskPrivate::forceReread(const Element *element)
{
    if (!element)
        return QVariant();
    return element->module().getData(QStringLiteral("paranoid"));
}

bool ElementTaskPrivate::failed(const AbstractTask *task)
{
    return task->taskDescription().status() == TaskDescription::Fail;
}
