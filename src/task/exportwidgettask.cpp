// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "exportwidgettask.h"

#include "elementtask_p.h"

#include "elementwidget.h"

#include <QMessageBox>

using namespace ElementTaskPrivate;

ExportWidgetTask::ExportWidgetTask(ElementWidget *widget, ElementData *data)
    : ElementWidgetTask(widget, data)
{
}

ExportWidgetTask::~ExportWidgetTask() = default;

void ExportWidgetTask::afterRun()
{
    if (failed(this))
        return;
    QMessageBox::information(_elementWidget, tr("Export"), tr("Export success!"), QMessageBox::Ok);
}
