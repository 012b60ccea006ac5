// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "hostfixtures.h"

#include "admintest.h"
#include "mainwindow.h"

#include <kvt-common/elementtreeview.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/vieweditelementwidget.h>

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QStandardPaths>

#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

namespace HostFixtures {

bool closeWindow(std::unique_ptr<MainWindow> &window)
{
    if (!window)
        return true;
    if (TaskObserverDialog *dialog = TaskObserver::instance()->dialog())
        dialog->reject();
    bool idle = AdminTest::waitIdle();
    // Whatever a failed check left unapplied is discarded, not asked about.
    if (ViewEditElementWidget *widget = window->shownEditWidget())
        widget->setUnchanged();
    window.reset();
    return idle;
}

int run(const QString &program, const QStringList &arguments, QString *output)
{
    QProcess process;
    process.start(program, arguments);
    if (!process.waitForStarted(10000) || !process.waitForFinished(60000))
        return -1;
    if (output)
        *output = QString::fromLocal8Bit(process.readAllStandardOutput());
    return process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1;
}

QString whyNotRoot()
{
    return ::geteuid() == 0 ? QString() : QStringLiteral("these tests change the host and need root");
}

QString serverVersion()
{
    QStringList versions = QDir(QStringLiteral("/usr/lib/postgresql")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    std::sort(versions.begin(), versions.end(),
              [](const QString &a, const QString &b) { return a.toDouble() < b.toDouble(); });
    for (auto it = versions.crbegin(); it != versions.crend(); ++it) {
        if (QFile::exists(QStringLiteral("/usr/lib/postgresql/%1/bin/postgres").arg(*it)))
            return *it;
    }
    return QString();
}

QString whyNoPostgresql()
{
    const QString root = whyNotRoot();
    if (!root.isEmpty())
        return root;
    if (QStandardPaths::findExecutable(QStringLiteral("pg_createcluster")).isEmpty() || serverVersion().isEmpty())
        return QStringLiteral("no PostgreSQL server is installed (pg_createcluster and a server are needed)");
    return QString();
}

namespace {

int freePort()
{
    // A port nobody listens on now, away from the usual 5432 and its neighbours.
    for (int port = 25000 + int(::getpid() % 5000); port < 65000; port += 7) {
        const int fd = ::socket(AF_INET, SOCK_STREAM, 0);
        if (fd < 0)
            return 0;
        sockaddr_in address {};
        address.sin_family = AF_INET;
        address.sin_port = htons(quint16(port));
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        const bool free = ::bind(fd, reinterpret_cast<sockaddr *>(&address), sizeof address) == 0;
        ::close(fd);
        if (free)
            return port;
    }
    return 0;
}

} // namespace

Cluster::Cluster(const QString &name)
    : _version(serverVersion())
    , _name(name)
    , _port(freePort())
{
    if (_version.isEmpty() || _port == 0)
        return;
    _valid = run(QStringLiteral("pg_createcluster"),
                 {_version, _name, QStringLiteral("-p"), QString::number(_port)})
             == 0;
}

Cluster::~Cluster()
{
    if (!_version.isEmpty())
        run(QStringLiteral("pg_dropcluster"), {QStringLiteral("--stop"), _version, _name});
}

bool Cluster::isOnline() const
{
    return run(QStringLiteral("pg_ctlcluster"), {_version, _name, QStringLiteral("status")}) == 0;
}

QStringList Cluster::users() const
{
    QString output;
    run(QStringLiteral("runuser"),
        {QStringLiteral("-u"), QStringLiteral("postgres"), QStringLiteral("--"), QStringLiteral("psql"),
         QStringLiteral("-X"), QStringLiteral("-A"), QStringLiteral("-t"), QStringLiteral("-p"), QString::number(_port),
         QStringLiteral("-c"), QStringLiteral("SELECT usename FROM pg_catalog.pg_user")},
        &output);
    return output.split(QLatin1Char('\n'), Qt::SkipEmptyParts);
}

InitScript::InitScript(const QString &name, const Cluster &cluster)
    : _path(QStringLiteral("/etc/init.d/") + name)
    , _name(name)
{
    QFile file(_path);
    if (QFile::exists(_path) || !file.open(QIODevice::WriteOnly))
        return;
    const QString control = QStringLiteral("pg_ctlcluster %1 %2").arg(cluster.version(), cluster.name());
    file.write(QStringLiteral("#!/bin/sh\n"
                              "# Test service of the kvt-admin tests; removed by them.\n"
                              "case \"$1\" in\n"
                              "start|stop|restart|status) exec %1 \"$1\" ;;\n"
                              "reload|force-reload) exec %1 reload ;;\n"
                              "*) echo \"Usage: $0 {start|stop|restart|reload|status}\" >&2; exit 2 ;;\n"
                              "esac\n")
                   .arg(control)
                   .toUtf8());
    file.close();
    _valid = file.setPermissions(QFileDevice::ReadOwner | QFileDevice::WriteOwner | QFileDevice::ExeOwner
                                 | QFileDevice::ReadGroup | QFileDevice::ExeGroup | QFileDevice::ReadOther
                                 | QFileDevice::ExeOther);
}

InitScript::~InitScript()
{
    if (_valid)
        QFile::remove(_path);
}

Account::Account(const QString &user, const QString &group)
    : _user(user)
    , _group(group)
{
    if (run(QStringLiteral("groupadd"), {_group}) != 0)
        return;
    if (run(QStringLiteral("useradd"), {QStringLiteral("-M"), QStringLiteral("-c"), QStringLiteral("Test User,1,2,3"), _user}) != 0) {
        run(QStringLiteral("groupdel"), {_group});
        _group.clear();
        return;
    }
    _valid = true;
}

Account::~Account()
{
    if (_valid)
        run(QStringLiteral("userdel"), {_user});
    if (!_group.isEmpty())
        run(QStringLiteral("groupdel"), {_group});
}

QString Account::passwdLine() const
{
    QString output;
    run(QStringLiteral("getent"), {QStringLiteral("passwd"), _user}, &output);
    return output.trimmed();
}

QString Account::groupLine() const
{
    QString output;
    run(QStringLiteral("getent"), {QStringLiteral("group"), _group}, &output);
    return output.trimmed();
}

} // namespace HostFixtures
