// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PGSQLCLUSTER_H
#define KVT_PGSQLCLUSTER_H

#include "kvtcommon_export.h"

#include <QObject>
#include <QString>
#include <QStringList>

/*!
 * One PostgreSQL cluster as listed by pg_lsclusters: a snapshot that never
 * refreshes itself.
 *
 * Every operation runs the host's tools (pg_ctlcluster, and psql as the
 * database superuser through su) and throws AppException on failure.
 * Queries and user names are put on a shell command line, so anything that
 * could leave it is refused before a program runs.
 */
class KVTCOMMON_EXPORT PgsqlCluster : public QObject
{
    Q_OBJECT

public:
    //! Creates an empty cluster description; use fromString() to read one.
    explicit PgsqlCluster(QObject *parent = nullptr);
    ~PgsqlCluster() override;

    /*!
     * Parses one line of "pg_lsclusters --no-header" (version, name, port,
     * status, owner, data directory, log file, separated by blanks). The
     * caller owns the result. Throws AppException when the line does not fit.
     */
    static PgsqlCluster *fromString(const QString &line);

    //! The server version, for instance "15".
    QString version() const { return _version; }
    //! The cluster name, for instance "main".
    QString name() const { return _name; }
    //! The TCP port.
    int port() const { return _port; }
    //! The status pg_lsclusters reported ("online", "down", ...).
    QString status() const { return _status; }
    //! The system user owning the cluster.
    QString owner() const { return _owner; }
    //! The data directory.
    QString dataDirectory() const { return _dataDirectory; }
    //! The log file.
    QString logFile() const { return _logFile; }

    //! Whether the cluster runs ("pg_ctlcluster <version> <name> status" exits 0).
    bool isWork() const;
    //! Starts the cluster with pg_ctlcluster; throws AppException on failure.
    void start() const;

    /*!
     * Runs one SQL statement with psql as the database superuser and returns
     * psql's output. The statement may not contain a double quote, a
     * backslash, a dollar sign, a back quote or a line break.
     */
    QString sqlRequest(const QString &query) const;

    //! The names of the cluster's database users (roles).
    QStringList usernames() const;

    /*!
     * Creates, respectively drops, the database user \a name unless it
     * already exists, respectively does not exist. The name must be a plain
     * lower-case SQL identifier (letters, digits and '_', not starting with a
     * digit, at most 63 characters), the only names that the server stores
     * exactly as written when they are not quoted.
     */
    void createUser(const QString &name) const;
    //! Drops the database user \a name when it exists; see createUser() for the names accepted.
    void deleteUser(const QString &name) const;

private:
    QString _version;
    QString _name;
    int _port;
    QString _status;
    QString _owner;
    QString _dataDirectory;
    QString _logFile;
};

#endif
