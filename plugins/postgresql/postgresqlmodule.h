// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_POSTGRESQLMODULE_H
#define KVT_ADMIN_POSTGRESQLMODULE_H

#include "../shared/toplevelgroup.h"

#include <kvt-common/containerelement.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>

#include <QPointer>

class AppException;
class PgsqlCluster;
class PgsqlManagerAsync;
class QAction;

namespace Pgsql {

const QString groupType = QStringLiteral("pgsqlClusters");
const QString clusterType = QStringLiteral("pgsqlCluster");
const QString userType = QStringLiteral("pgsqlUser");
//! The type of the widget that creates a user (a cluster's creation widget).
const QString newUserType = QStringLiteral("pgsqlNewUser");

//! Starting a stopped cluster, in a bit the library leaves to plugins.
const quint64 StartClusterOperation = 0x1000;

/*! The fields of one cluster, as listed by pg_lsclusters. */
struct ClusterInfo
{
    QString version;
    QString name;
    int port = 0;
    QString status;
    QString owner;
    QString dataDirectory;
    QString logFile;

    static ClusterInfo from(const PgsqlCluster &cluster);
    /*! A line that PgsqlCluster::fromString() reads back. */
    QString line() const;
    QString title() const { return version + QLatin1Char('/') + name; }
    bool isOnline() const { return status.startsWith(QLatin1String("online")); }
};

} // namespace Pgsql

/*! The persistent "PostgreSQL clusters" node; its children are read with
 *  the library's asynchronous cluster manager. */
class ClustersGroupElement : public KvtAdmin::TopLevelGroup
{
    Q_OBJECT

public:
    explicit ClustersGroupElement(Module &module);
    QString toolTipText() const override;
};

/*!
 * One cluster. Its database users are its children, read when it is first
 * expanded, and only while it runs. Creating below it creates a database
 * user; a stopped cluster can be started.
 */
class ClusterElement : public ContainerElement
{
    Q_OBJECT

public:
    ClusterElement(Module &module, const Pgsql::ClusterInfo &info);
    const Pgsql::ClusterInfo &info() const { return _info; }
    void setInfo(const Pgsql::ClusterInfo &info);
    /*! For the creation role, the widget that creates a database user in
     *  this cluster; otherwise the cluster's own widget. */
    ElementWidget *elementWidget(ElementWidgetRole role) override;
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    QString toolTipText() const override;

private:
    Pgsql::ClusterInfo _info;
};

/*! One database user of a cluster (its parent node). */
class PgUserElement : public OrdinaryElement
{
    Q_OBJECT

public:
    PgUserElement(Module &module, const QString &name);
    ClusterElement *cluster() const;
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    QString questionForRemove() const override;
    QString toolTipText() const override;
};

/*!
 * The PostgreSQL module: the host's clusters with their state, and the
 * database users of the running ones.
 */
class PostgresqlModule : public Module
{
    Q_OBJECT

public:
    explicit PostgresqlModule(QObject *parent);
    ~PostgresqlModule() override;

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    ClustersGroupElement *group() const { return _group; }
    ClusterElement *cluster(const QString &title) const;
    /*! Starts reading the cluster list (again). */
    void readClusters();
    /*! Whether a read of the cluster list is under way. */
    bool isReadingClusters() const { return _reading; }
    /*! The message of the last failed cluster read, empty after a good one. */
    QString lastError() const { return _lastError; }
    /*! Puts the names read for \a cluster under it. */
    void setUsers(ClusterElement *cluster, const QStringList &names);

Q_SIGNALS:
    void clustersRead();

private Q_SLOTS:
    void clustersReaded(const QList<PgsqlCluster *> &clusters);
    void exceptionArise(const AppException &exception);
    void startCurrentCluster();

private:
    void createUser(ClusterElement *cluster, ElementData *data);
    ClusterElement *currentCluster() const;
    /*! The cluster whose creation widget was asked for last: creation
     *  widgets are shown without an element. */
    void setCreateTarget(ClusterElement *cluster) { _createTarget = cluster; }

    ClustersGroupElement *_group;
    PgsqlManagerAsync *_manager;
    bool _reading = false;
    QString _lastError;
    QString _pendingError;
    QAction *_startAction;

    friend class ClusterElement;
    friend class PgsqlInfoWidget;
    friend class PgUserCreateWidget;
    QPointer<Element> _current;
    QPointer<ClusterElement> _createTarget;
};

#endif // KVT_ADMIN_POSTGRESQLMODULE_H
