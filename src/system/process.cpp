// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "process.h"

#include "appexception.h"

namespace {

const int processTimeoutMs = 30000;
// How long a program that missed its time-out may take to die after SIGKILL.
const int killGraceMs = 5000;

QString commandText(const QString &program, const QStringList &arguments)
{
    // No quoting: the text is for people reading the message, not for a shell.
    if (arguments.isEmpty())
        return program;
    return program + QLatin1Char(' ') + arguments.join(QLatin1Char(' '));
}

} // namespace

Process::Process(QObject *parent)
    : QProcess(parent)
{
}

Process::~Process() = default;

void Process::simpleStart(const QString &program, const QStringList &arguments, bool checkExitCode)
{
    start(program, arguments, QIODevice::ReadOnly);
    const QString command = commandText(program, arguments);

    const bool finished = waitForFinished(processTimeoutMs);
    if (!finished || exitStatus() == QProcess::CrashExit) {
        // A program still running after the time-out is ended here rather than
        // left to the destructor, so that the caller's thread is not blocked
        // again there and no stray child outlives the failed call.
        if (state() != QProcess::NotRunning) {
            kill();
            waitForFinished(killGraceMs);
        }
        // A crash reports the same text as a time-out on purpose.
        throw AppException(tr("Process '%1' not finished").arg(command));
    }

    if (!checkExitCode || exitCode() == 0)
        return;

    // Both placeholders are filled in one pass, so a '%' in the command text
    // cannot be mistaken for the second one.
    QString message = tr("Process '%1' execute with error code '%2'")
                          .arg(command, QString::number(exitCode()));
    // The conversion stops at the first NUL byte; the text is otherwise kept
    // as the program wrote it, trailing newline included.
    const QString errorText = QString::fromLocal8Bit(readAllStandardError());
    if (!errorText.isEmpty())
        message += QLatin1String(". ") + errorText;
    throw AppException(message);
}

QString Process::output()
{
    return QString::fromLocal8Bit(readAllStandardOutput());
}
