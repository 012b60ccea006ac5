// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Throw-away things on the real host for the end-to-end tests of the
// services, PostgreSQL and accounts plugins: a PostgreSQL cluster, an init
// script, a user and a group. Each has a name of its own (the process id)
// and is removed by its destructor, also when a test fails half-way.

#ifndef KVT_HOSTFIXTURES_H
#define KVT_HOSTFIXTURES_H

#include <QByteArray>
#include <QString>
#include <QStringList>

#include <memory>

class MainWindow;

namespace HostFixtures {

/*!
 * Closes the task dialog, waits for the tasks and destroys \a window. The
 * element selection is cleared first: the window keeps the element actions
 * of the selected element as plain pointers, and those actions go with
 * their module while the window unloads the plugins.
 */
bool closeWindow(std::unique_ptr<MainWindow> &window);

//! Runs \a program without a shell; its exit code, -1 when it did not run.
int run(const QString &program, const QStringList &arguments, QString *output = nullptr);

//! Why the tests cannot change this host (not root), or empty.
QString whyNotRoot();
//! Why no cluster can be made here (not root, no server), or empty.
QString whyNoPostgresql();

//! The newest installed PostgreSQL server version ("15"), empty without one.
QString serverVersion();

//! A stopped cluster of its own on a free port.
class Cluster
{
public:
    explicit Cluster(const QString &name);
    ~Cluster();
    bool isValid() const { return _valid; }
    QString version() const { return _version; }
    QString name() const { return _name; }
    int port() const { return _port; }
    //! "version/name", the cluster's title in the element tree.
    QString title() const { return _version + QLatin1Char('/') + _name; }
    bool isOnline() const;
    //! The cluster's database users, through psql.
    QStringList users() const;

private:
    QString _version;
    QString _name;
    int _port = 0;
    bool _valid = false;
};

//! An init script /etc/init.d/<name> that starts and stops \a cluster.
class InitScript
{
public:
    InitScript(const QString &name, const Cluster &cluster);
    ~InitScript();
    bool isValid() const { return _valid; }
    QString name() const { return _name; }

private:
    QString _path;
    QString _name;
    bool _valid = false;
};

//! A local user and a group of its own, made with useradd and groupadd.
class Account
{
public:
    Account(const QString &user, const QString &group);
    ~Account();
    bool isValid() const { return _valid; }
    QString user() const { return _user; }
    QString group() const { return _group; }
    //! The user's line of /etc/passwd and the group's line of /etc/group.
    QString passwdLine() const;
    QString groupLine() const;

private:
    QString _user;
    QString _group;
    bool _valid = false;
};

} // namespace HostFixtures

#endif
