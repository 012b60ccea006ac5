// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "controlservicetask.h"

#include <QProcess>
#include <QRegExp>

namespace {
const int packageQueryTimeout = 30000;

// The package name as a pattern for the status lines: dpkg-query accepts
// shell wildcards in the name, so "*", "?" and bracket expressions keep that
// meaning (within one name); every other character stands for itself, so
// "libstdc++6" is found as written.
QString packagePattern(const QString &name)
{
    QString pattern;
    for (int i = 0; i < name.size(); ++i) {
        const QChar c = name.at(i);
        if (c == QLatin1Char('*')) {
            pattern += QLatin1String("\\S*");
        } else if (c == QLatin1Char('?')) {
            pattern += QLatin1String("\\S");
        } else if (c == QLatin1Char('[')) {
            const int close = name.indexOf(QLatin1Char(']'), i + 2);
            if (close < 0) {
                pattern += QLatin1String("\\[");
                continue;
            }
            QString set = name.mid(i + 1, close - i - 1);
            if (set.startsWith(QLatin1Char('!')))
                set[0] = QLatin1Char('^');
            pattern += QLatin1Char('[') + set.replace(QLatin1Char('\\'), QLatin1String("\\\\")) + QLatin1Char(']');
            i = close;
        } else {
            pattern += QRegExp::escape(QString(c));
        }
    }
    return pattern;
}
} // namespace

ControlServiceTask::ControlServiceTask(Element *element)
    : ElementTask(element)
{
}

ControlServiceTask::~ControlServiceTask() = default;

void ControlServiceTask::run()
{
    QString executable = _program;
    QStringList arguments = _arguments;
    if (!_user.isEmpty()) {
        executable = QStringLiteral("runuser");
        arguments = QStringList{QStringLiteral("-u"), _user, _program} + _arguments;
    }
    if (QProcess::startDetached(executable, arguments)) {
        _taskDescription.setStatus(TaskDescription::Success);
    } else {
        _taskDescription.setStatus(TaskDescription::Fail);
        _taskDescription.setMessage(tr("Failed to execute command \"%1 %2\"")
                                        .arg(executable, arguments.join(QLatin1Char(' '))));
    }
    AbstractTask::run();
}

void ControlServiceTask::afterRun()
{
}

bool ControlServiceTask::existPackage(const QString &name)
{
    QProcess process;
    process.start(QStringLiteral("dpkg-query"),
                  {QStringLiteral("--show"), QStringLiteral("--showformat=${db:Status-Abbrev}${binary:Package}\n"),
                   name},
                  QIODevice::ReadOnly);
    if (!process.waitForFinished(packageQueryTimeout) || process.exitStatus() == QProcess::CrashExit
        || process.exitCode() != 0)
        return false;
    // The status letters and the name are set apart by white space: "ii"
    // glued to the name is no match.
    const QRegExp installed(QStringLiteral("ii\\s%1").arg(packagePattern(name)));
    const QStringList lines = QString::fromLocal8Bit(process.readAllStandardOutput()).split(QLatin1Char('\n'));
    for (const QString &line : lines) {
        if (installed.indexIn(line) != -1)
            return true;
    }
    return false;
}
