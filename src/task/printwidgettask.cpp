// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "printwidgettask.h"

#include "elementtask_p.h"

#include "elementdata.h"
#include "previewdialog.h"

#include <QUrl>
#include <QXmlNamePool>
#include <QXmlQuery>

using namespace ElementTaskPrivate;

namespace {
const QString xmlTextKey = QStringLiteral("xmlText");
const QString templateNameKey = QStringLiteral("templateName");
const QString htmlTextKey = QStringLiteral("htmlText");
}

PrintWidgetTask::PrintWidgetTask(ElementWidget *widget, ElementData *data)
    : ElementWidgetTask(widget, data)
{
}

PrintWidgetTask::~PrintWidgetTask() = default;

void PrintWidgetTask::run()
{
    const ElementData record = _elementData ? *_elementData : ElementData();
    QXmlNamePool namePool;
    QXmlQuery query(QXmlQuery::XSLT20, namePool);
    // A document that does not parse shows up as a failed evaluation below.
    query.setFocus(record.value(xmlTextKey).toString());
    query.setQuery(QUrl(record.value(templateNameKey).toString(), QUrl::TolerantMode), QUrl());

    QString html;
    if (query.isValid() && query.evaluateTo(&html)) {
        if (!_elementData)
            _elementData = new ElementData;
        _elementData->insert(htmlTextKey, html);
        _taskDescription.setStatus(TaskDescription::Success);
    } else {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("Internal error: %1").arg(tr("XML transformation failed")));
    }
    AbstractTask::run();
}

void PrintWidgetTask::afterRun()
{
    if (failed(this) || !_elementData || !_elementData->contains(htmlTextKey))
        return;
    PreviewDialog::instance(nullptr)->preview(_elementData->value(htmlTextKey).toString());
}
