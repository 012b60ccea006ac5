// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "servicetask.h"

#include "servicelightelementdata.h"

#include <QProcess>

namespace {
const int startTimeout = 30000;
}

ServiceTask::ServiceTask(Element *element, ElementData *data)
    : ElementTask(element, data)
    , _commandFirst(true)
{
}

ServiceTask::~ServiceTask() = default;

QStringList ServiceTask::commandLine() const
{
    return _commandFirst ? QStringList(_command) + _arguments : _arguments + QStringList(_command);
}

void ServiceTask::run()
{
    auto *state = dynamic_cast<ServiceLightElementData *>(_elementData);
    const QStringList arguments = commandLine();
    const QString joined = arguments.join(QLatin1Char(' '));

    QProcess process;
    process.start(_program, arguments, QIODevice::ReadOnly);
    if (!process.waitForStarted(startTimeout)) {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("Process: \"%1 %2\". Error: %3.\n\"Not started\"")
                                        .arg(_program, joined, process.errorString()));
    } else if (!process.waitForFinished(-1) || process.exitStatus() == QProcess::CrashExit) {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("Process: \"%1 %2\". Error: %3.\n\"Not finished\"")
                                        .arg(_program, joined, process.errorString()));
    } else if (state) {
        // A status query: a stopped service is an answer, not a failure.
        state->setState(process.exitCode() == 0, QString());
        _taskDescription.setStatus(TaskDescription::Success);
    } else if (process.exitCode() == 0) {
        _taskDescription.setStatus(TaskDescription::Success);
    } else {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(
            tr("Process: \"%1 %2\". Exit code: %3.\n\"%4\"")
                .arg(_program, joined, QString::number(process.exitCode()),
                     QString::fromLocal8Bit(process.readAllStandardError()).trimmed()));
    }
    AbstractTask::run();
}
