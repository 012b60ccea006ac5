// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementwidgettask.h"

#include "elementtask_p.h"

ElementWidgetTask::ElementWidgetTask(ElementWidget *widget, ElementData *data)
    : AbstractTask(data)
    , _elementWidget(widget)
{
    ElementTaskPrivate::addTask(this);
}

ElementWidgetTask::~ElementWidgetTask()
{
    ElementTaskPrivate::removeTask(this);
}
