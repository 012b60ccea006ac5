// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "updatetask.h"

#include "elementtask_p.h"

#include "element.h"
#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

UpdateTask::UpdateTask(Element *element, ElementData *data)
    : ElementTask(element, data)
{
}

UpdateTask::~UpdateTask() = default;

void UpdateTask::afterRun()
{
    if (!_element)
        return;
    // Unlike creating and deleting, a module without a force reread value
    // re-reads here: only a module that says "false" trusts an update.
    const QVariant reread = forceReread(_element);
    if (!reread.isValid() || reread.toBool()) {
        if (_element->availableOperations() & ReadPropertyOperation)
            _element->performOperation(ReadPropertyOperation, nullptr, 0);
        return;
    }
    if (failed(this))
        return;
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_element->elementWidget(EditElementRole))) {
        widget->afterSuccessfulUpdate();
        widget->setUnchanged();
    }
}
