// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "readcontenttask.h"

#include "elementtask_p.h"

#include "element.h"
#include "elementdata.h"

using namespace ElementTaskPrivate;

ReadContentTask::ReadContentTask(Element *element)
    : ElementTask(element)
{
}

ReadContentTask::~ReadContentTask() = default;

void ReadContentTask::afterRun()
{
    if (!_element || !_elementData || !forceReread(_element).toBool())
        return;
    // The record names the element just created (CreateTask): select it now
    // that the container lists it.
    const QString name = _elementData->name();
    for (TreeNode *node : qAsConst(_element->childNodes())) {
        auto *child = qobject_cast<Element *>(node);
        if (child && child->title() == name) {
            child->emitSetCurrentNode();
            break;
        }
    }
}
