// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTWIDGETTASK_H
#define KVT_ELEMENTWIDGETTASK_H

#include "abstracttask.h"

class ElementWidget;

/*!
 * A task that works for one element widget (import, export, print). The
 * widget is not owned; it must outlive the task, which keeps a plain pointer
 * and would reach freed memory in afterRun() if the widget went first.
 */
class KVTCOMMON_EXPORT ElementWidgetTask : public AbstractTask
{
public:
    //! Creates a task for \a widget, owning \a data. run() must not use the widget.
    ElementWidgetTask(ElementWidget *widget, ElementData *data = nullptr);
    //! Destroys the task and its record, not the widget.
    ~ElementWidgetTask() override;

    //! The widget the task works for; use it in afterRun() only.
    ElementWidget *elementWidget() const { return _elementWidget; }

protected:
    //! See elementWidget(); not owned.
    ElementWidget *_elementWidget;
};

#endif // KVT_ELEMENTWIDGETTASK_H
