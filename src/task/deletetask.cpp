// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "deletetask.h"

#include "elementtask_p.h"

#include "element.h"

using namespace ElementTaskPrivate;

DeleteTask::DeleteTask(Element *element)
    : ElementTask(element)
{
}

DeleteTask::~DeleteTask() = default;

void DeleteTask::afterRun()
{
    if (!_element)
        return;
    TreeNode *parent = _element->parentNode();
    if (forceReread(_element).toBool()) {
        // The element stays listed until its container is read again.
        if (parent)
            parent->emitSetCurrentNode();
        return;
    }
    if (failed(this))
        return;
    if (parent) {
        parent->emitSetCurrentNode();
        parent->removeOne(_element);
    }
    delete _element;
    _element = nullptr;
}
