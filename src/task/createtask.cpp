// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "createtask.h"

#include "elementtask_p.h"

#include "element.h"
#include "elementdata.h"
#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

CreateTask::CreateTask(Element *element, ElementData *data)
    : ElementTask(element, data)
{
}

CreateTask::~CreateTask() = default;

void CreateTask::afterRun()
{
    if (!_element)
        return;
    // Here a module without a force reread value trusts the result.
    if (forceReread(_element).toBool()) {
        if (!(_element->availableOperations() & ReadContentOperation))
            return;
        ElementData *created = nullptr;
        if (!failed(this)) {
            created = new ElementData;
            created->setName(_elementData ? _elementData->name() : QString());
        }
        _element->performOperation(ReadContentOperation, created, 0);
        return;
    }
    if (failed(this))
        return;
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_element->elementWidget(CreateElementRole)))
        widget->setUnchanged();
}
