// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementtask.h"

#include "elementtask_p.h"

#include "element.h"
#include "elementwidgettask.h"
#include "module.h"

#include <QMutex>
#include <QSet>

namespace {

// The element and element widget tasks that exist. Tasks are made and run to
// their end in the interface thread, but the workers' stop deletes the tasks
// still queued in a worker thread: hence the lock. Never freed, so that an
// element destroyed during static destruction still finds it.
struct LiveTasks
{
    QMutex mutex;
    QSet<ElementTask *> elementTasks;
    QSet<ElementWidgetTask *> widgetTasks;
};

LiveTasks &liveTasks()
{
    static auto *tasks = new LiveTasks;
    return *tasks;
}

// Reach the protected pointers from outside the classes.
struct ElementTaskAccess : ElementTask
{
    static Element *ElementTask::*field() { return &ElementTaskAccess::_element; }
};

struct ElementWidgetTaskAccess : ElementWidgetTask
{
    static ElementWidget *ElementWidgetTask::*field() { return &ElementWidgetTaskAccess::_elementWidget; }
};

} // namespace

ElementTask::ElementTask(Element *element, ElementData *data)
    : AbstractTask(data)
    , _element(element)
{
    ElementTaskPrivate::addTask(this);
}

ElementTask::~ElementTask()
{
    ElementTaskPrivate::removeTask(this);
}

void ElementTaskPrivate::addTask(ElementTask *task)
{
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    tasks.elementTasks.insert(task);
}

void ElementTaskPrivate::removeTask(ElementTask *task)
{
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    tasks.elementTasks.remove(task);
}

void ElementTaskPrivate::addTask(ElementWidgetTask *task)
{
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    tasks.widgetTasks.insert(task);
}

void ElementTaskPrivate::removeTask(ElementWidgetTask *task)
{
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    tasks.widgetTasks.remove(task);
}

void ElementTaskPrivate::elementDestroyed(const Element *element)
{
    if (!element)
        return;
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    Element *ElementTask::*field = ElementTaskAccess::field();
    for (ElementTask *task : qAsConst(tasks.elementTasks)) {
        if (task->*field == element)
            task->*field = nullptr;
    }
}

void ElementTaskPrivate::widgetDestroyed(const ElementWidget *widget)
{
    if (!widget)
        return;
    LiveTasks &tasks = liveTasks();
    QMutexLocker locker(&tasks.mutex);
    ElementWidget *ElementWidgetTask::*field = ElementWidgetTaskAccess::field();
    for (ElementWidgetTask *task : qAsConst(tasks.widgetTasks)) {
        if (task->*field == widget)
            task->*field = nullptr;
    }
}

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
