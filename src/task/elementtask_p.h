// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTTASK_P_H
#define KVT_ELEMENTTASK_P_H

#include <QVariant>

class AbstractTask;
class Element;
class ElementTask;
class ElementWidget;
class ElementWidgetTask;

namespace ElementTaskPrivate {

// The force reread mode ("paranoid") of the element's module, as stored:
// invalid when the module has no such value, or there is no element.
QVariant forceReread(const Element *element);

bool failed(const AbstractTask *task);

// Element and element widget tasks keep a plain pointer to their element or
// widget. The tasks that exist are listed here, so that an element or widget
// destroyed before its task has ended clears that pointer: afterRun() then
// finds null instead of freed memory.
void addTask(ElementTask *task);
void removeTask(ElementTask *task);
void addTask(ElementWidgetTask *task);
void removeTask(ElementWidgetTask *task);
void elementDestroyed(const Element *element);
void widgetDestroyed(const ElementWidget *widget);

}

#endif
