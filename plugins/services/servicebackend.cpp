// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "servicebackend.h"

#include "../shared/admintools.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QSet>

ServiceBackend ServiceBackend::detect(const QString &systemdRunDir, const QString &initDir)
{
    ServiceBackend backend;
    backend._initDir = initDir;
    if (QFileInfo(systemdRunDir).isDir())
        backend._kind = Systemd;
    else if (!initScripts(initDir).isEmpty())
        backend._kind = SysV;
    return backend;
}

QString ServiceBackend::unavailableReason() const
{
    if (_kind != None)
        return QString();
    return QCoreApplication::translate("ServiceBackend",
                                       "systemd is not the running init and %1 holds no service script.")
        .arg(_initDir);
}

QString ServiceBackend::program() const
{
    return _kind == Systemd ? QStringLiteral("systemctl") : QStringLiteral("service");
}

QStringList ServiceBackend::serviceArguments(const QString &service) const
{
    if (_kind == Systemd)
        return {QStringLiteral("--no-pager"), service + QStringLiteral(".service")};
    return {service};
}

QStringList ServiceBackend::listServices(QString *error) const
{
    QStringList services;
    if (_kind == Systemd) {
        const KvtAdmin::ProgramResult result = KvtAdmin::runProgram(
            QStringLiteral("systemctl"), {QStringLiteral("list-unit-files"), QStringLiteral("--type=service"),
                                          QStringLiteral("--no-legend"), QStringLiteral("--no-pager")});
        if (!result.ok()) {
            if (error)
                *error = result.message(QStringLiteral("systemctl"));
            return services;
        }
        services = parseUnitFiles(result.output);
    } else if (_kind == SysV) {
        services = initScripts(_initDir);
    } else if (error) {
        *error = unavailableReason();
    }
    return services;
}

QStringList ServiceBackend::parseUnitFiles(const QString &output)
{
    static const QString suffix = QStringLiteral(".service");
    QSet<QString> seen;
    QStringList services;
    const QStringList lines = output.split(QLatin1Char('\n'), Qt::SkipEmptyParts);
    for (const QString &line : lines) {
        const QString unit = line.simplified().section(QLatin1Char(' '), 0, 0);
        if (!unit.endsWith(suffix))
            continue;
        const QString name = unit.left(unit.size() - suffix.size());
        // "getty@.service" is a template: it runs only as an instance.
        if (name.endsWith(QLatin1Char('@')) || !KvtAdmin::isSafeName(name) || seen.contains(name))
            continue;
        seen.insert(name);
        services << name;
    }
    services.sort();
    return services;
}

QStringList ServiceBackend::initScripts(const QString &initDir)
{
    // Files of the directory that are not services of their own.
    static const QSet<QString> notServices = {QStringLiteral("README"), QStringLiteral("skeleton"),
                                              QStringLiteral("rc"), QStringLiteral("rcS"),
                                              QStringLiteral("functions")};
    QStringList services;
    const QFileInfoList entries = QDir(initDir).entryInfoList(QDir::Files | QDir::Executable, QDir::Name);
    for (const QFileInfo &entry : entries) {
        const QString name = entry.fileName();
        if (notServices.contains(name) || name.contains(QLatin1String(".dpkg-"))
            || name.startsWith(QLatin1Char('.')) || !KvtAdmin::isSafeName(name))
            continue;
        services << name;
    }
    return services;
}
