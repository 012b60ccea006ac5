// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "readpropertylightservicetask.h"

#include "elementtask_p.h"

#include "element.h"
#include "servicelightelementdata.h"

using namespace ElementTaskPrivate;

ReadPropertyLightServiceTask::ReadPropertyLightServiceTask(Element *element)
    : ServiceTask(element, new ServiceLightElementData)
{
    _command = QStringLiteral("status");
}

ReadPropertyLightServiceTask::~ReadPropertyLightServiceTask() = default;

void ReadPropertyLightServiceTask::afterRun()
{
    if (!_element || failed(this))
        return;
    auto *target = dynamic_cast<ServiceLightElementData *>(_element->elementData());
    auto *read = dynamic_cast<ServiceLightElementData *>(_elementData);
    if (!target || !read)
        return;
    *target = *read;
    _element->emitNodeDataChanged();
}
