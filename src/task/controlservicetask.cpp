#include "controlservicetask.h"

#include <QProcess>
#include <QRegExp>

namespace {
const int packageQueryTimeout = 30000;
}

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
    const QRegExp installed(QStringLiteral("ii\\s%1").arg(name));
    const QStringList lines = QString::fromLocal8Bit(process.readAllStandardOutput()).split(QLatin1Char('\n'));
    for (const QString &line : lines) {
        if (installed.indexIn(line) != -1)
            return true;
    }
    return false;
}
