// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTTASK_H
#define KVT_ELEMENTTASK_H

#include "abstracttask.h"

class Element;

/*!
 * A task that works for one element. The element is not owned; it must
 * outlive the task (the observer deletes the task, never the element).
 *
 * The task keeps a plain pointer: an element deleted while its task is
 * queued or running is not noticed, and afterRun() would then reach freed
 * memory. Delete elements, and unload the plugins that own them, only while
 * no task works for them (TaskObserver::runningCount() is 0).
 */
class KVTCOMMON_EXPORT ElementTask : public AbstractTask
{
public:
    /*!
     * Creates a task for \a element, owning \a data. Call it in the interface
     * thread; run() must not use the element (see AbstractTask).
     */
    ElementTask(Element *element, ElementData *data = nullptr);
    //! Destroys the task and its record, not the element.
    ~ElementTask() override;

    //! The element the task works for; use it in the constructor and in afterRun() only.
    Element *element() const { return _element; }

protected:
    //! See element(); not owned.
    Element *_element;
};

#endif // KVT_ELEMENTTASK_H
