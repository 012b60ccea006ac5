// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "readpropertyheavytask.h"

#include "elementtask_p.h"

#include "element.h"
#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

ReadPropertyHeavyTask::ReadPropertyHeavyTask(Element *element)
    : ElementTask(element)
{
}

ReadPropertyHeavyTask::~ReadPropertyHeavyTask() = default;

void ReadPropertyHeavyTask::afterRun()
{
    if (!_element || failed(this))
        return;
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_element->elementWidget(EditElementRole)))
        widget->afterSuccessfulRead(_element, _elementData);
}
