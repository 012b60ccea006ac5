// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "recordingmodule.h"

#include <kvt-common/contextoperation.h>

RecordingModule::RecordingModule(const QString &name, QObject *parent, bool paranoid)
    : Module(name, parent, paranoid)
{
}

QString RecordingModule::operationName(OperationType type)
{
    switch (type) {
    case InsertedOperation: return QStringLiteral("Inserted");
    case RemovedOperation: return QStringLiteral("Removed");
    case CreateOperation: return QStringLiteral("Create");
    case ReadContentOperation: return QStringLiteral("ReadContent");
    case ResetOperation: return QStringLiteral("Reset");
    case ReadPropertyOperation: return QStringLiteral("ReadProperty");
    case UpdateOperation: return QStringLiteral("Update");
    case DeleteOperation: return QStringLiteral("Delete");
    case ChangeDisplayOperation: return QStringLiteral("ChangeDisplay");
    case LoginExtraOperation1: return QStringLiteral("LoginExtra1");
    case LoginExtraOperation2: return QStringLiteral("LoginExtra2");
    }
    return QStringLiteral("0x%1").arg(quint64(type), 0, 16);
}

void RecordingModule::performOperation(ContextOperation *context, OperationType type,
                                       ElementData *data, int flags)
{
    QString who = QStringLiteral("null");
    if (context) {
        if (Element *element = context->elementContext())
            who = element->id();
        else
            who = QStringLiteral("widget");
    }
    QString entry = QStringLiteral("%1(%2)").arg(operationName(type), who);
    if (flags)
        entry += QStringLiteral(" flags=%1").arg(flags);
    log.append(entry);
    dataLog.append(data);
    if (onOperation)
        onOperation(context, type, data);
    Module::performOperation(context, type, data, flags);
}

bool rightsYes(const Module &)
{
    return true;
}

bool rightsNo(const Module &)
{
    return false;
}
