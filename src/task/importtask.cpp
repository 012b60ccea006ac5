// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "importtask.h"

#include "elementtask_p.h"

#include "vieweditelementwidget.h"

using namespace ElementTaskPrivate;

ImportTask::ImportTask(ElementWidget *widget, ElementData *data)
    : ElementWidgetTask(widget, data)
{
}

ImportTask::~ImportTask() = default;

void ImportTask::afterRun()
{
    if (failed(this))
        return;
    if (auto *widget = qobject_cast<ViewEditElementWidget *>(_elementWidget))
        widget->afterSuccessfulImport(_elementData);
}
