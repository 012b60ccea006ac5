// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "exporthtmltask.h"

#include "elementdata.h"

#include <QFile>

ExportHtmlTask::ExportHtmlTask(ElementData *data)
    : AbstractTask(data)
{
    _taskDescription.setDescription(tr("Export to HTML"));
}

ExportHtmlTask::~ExportHtmlTask() = default;

void ExportHtmlTask::run()
{
    const QString path = _elementData ? _elementData->value(QStringLiteral("filePath")).toString() : QString();
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate)) {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("\"%1\" error %2\n%3")
                                        .arg(file.fileName(), QString::number(int(file.error())),
                                             file.errorString()));
    } else {
        const QString html = _elementData ? _elementData->value(QStringLiteral("htmlText")).toString() : QString();
        file.write(html.toUtf8());
        file.close();
        _taskDescription.setStatus(TaskDescription::Success);
    }
    AbstractTask::run();
}

void ExportHtmlTask::afterRun()
{
}
