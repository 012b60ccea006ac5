// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "startstopservicetask.h"

#include "elementtask_p.h"

#include "element.h"
#include "servicelightelementdata.h"
#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

StartStopServiceTask::StartStopServiceTask(Element *element, bool start)
    : ServiceTask(element)
    , _start(start)
{
}

StartStopServiceTask::~StartStopServiceTask() = default;

void StartStopServiceTask::afterRun()
{
    if (!_element)
        return;
    if (forceReread(_element).toBool()) {
        if (_element->availableOperations() & ReadPropertyOperation)
            _element->performOperation(ReadPropertyOperation, nullptr, 0);
        return;
    }
    if (failed(this))
        return;

    ElementData *data = _element->elementData();
    const QString stateKey = QStringLiteral("state");
    if (data && data->contains(stateKey))
        data->insert(stateKey, _start);
    else if (auto *service = dynamic_cast<ServiceLightElementData *>(data))
        service->setState(_start, QString());
    else
        return;

    _element->emitNodeDataChanged();
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_element->elementWidget(EditElementRole)))
        widget->afterSuccessfulRead(_element, _element->elementData());
}
