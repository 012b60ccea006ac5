// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "rservicetask.h"

#include "elementtask_p.h"

#include "element.h"

using namespace ElementTaskPrivate;

RServiceTask::RServiceTask(Element *element)
    : ServiceTask(element)
{
}

RServiceTask::~RServiceTask() = default;

void RServiceTask::afterRun()
{
    if (!_element)
        return;
    if (!forceReread(_element).toBool() && !failed(this))
        return;
    if (_element->availableOperations() & ReadPropertyOperation)
        _element->performOperation(ReadPropertyOperation, nullptr, 0);
}
