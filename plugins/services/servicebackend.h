// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_SERVICEBACKEND_H
#define KVT_ADMIN_SERVICEBACKEND_H

#include <QString>
#include <QStringList>

/*!
 * How services are found and driven on this host: through systemd when it
 * is the running init, otherwise through the scripts of /etc/init.d and the
 * "service" program.
 */
class ServiceBackend
{
public:
    enum Kind { None, Systemd, SysV };

    /*! Looks at the host: systemd runs when \a systemdRunDir exists (it is
     *  made by systemd at boot); otherwise the scripts of \a initDir. */
    static ServiceBackend detect(const QString &systemdRunDir = QStringLiteral("/run/systemd/system"),
                                 const QString &initDir = QStringLiteral("/etc/init.d"));

    Kind kind() const { return _kind; }
    bool isValid() const { return _kind != None; }
    /*! Why no service can be managed here (empty when one can). */
    QString unavailableReason() const;

    /*! The control program: "systemctl" or "service". */
    QString program() const;
    /*! Whether the command word goes before the service name
     *  ("systemctl start NAME", but "service NAME start"). */
    bool commandFirst() const { return _kind == Systemd; }
    /*! The arguments naming \a service for the control program. */
    QStringList serviceArguments(const QString &service) const;

    /*! The services of the host, sorted; runs programs or reads a directory,
     *  so call it on a worker. On failure returns an empty list and sets
     *  \a error. */
    QStringList listServices(QString *error) const;

    /*! Parses the output of "systemctl list-unit-files --type=service
     *  --no-legend": unit names without ".service"; templates are skipped. */
    static QStringList parseUnitFiles(const QString &output);
    /*! The init scripts in \a initDir that name a service. */
    static QStringList initScripts(const QString &initDir);

private:
    Kind _kind = None;
    QString _initDir;
};

#endif // KVT_ADMIN_SERVICEBACKEND_H
