// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PGSQLMANAGERASYNC_H
#define KVT_PGSQLMANAGERASYNC_H

#include "kvtcommon_export.h"

#include "appexception.h"
#include "pgsqlmanager.h"

#include <QFutureWatcher>
#include <QList>
#include <QObject>

class PgsqlCluster;

/*!
 * Reads the cluster list on the global thread pool and reports by signals.
 *
 * A read that fails emits exceptionArise() from the worker thread (receivers
 * in other threads get it queued), then, like every read, clustersReaded()
 * from this object's thread with the clusters parsed before the failure. The
 * clusters belong to the object and are replaced by the next read.
 *
 * One read at a time: startReadClusters() while a read runs, or before its
 * clustersReaded() has been delivered, starts one more read once that one has
 * reported (several such requests make one read). Destruction waits for a
 * running read to end.
 */
class KVTCOMMON_EXPORT PgsqlManagerAsync : public QObject
{
    Q_OBJECT

public:
    //! Creates the reader; nothing is read yet.
    explicit PgsqlManagerAsync(QObject *parent = nullptr);
    ~PgsqlManagerAsync() override;

    //! Starts a read on the global thread pool; returns at once.
    void startReadClusters();
    //! The body of a read, run on a pool thread.
    void performReadClusters();

Q_SIGNALS:
    // The spelling of the name is kept: receivers connect to it by name.
    //! A read ended; \a clusters belong to this object until the next read.
    void clustersReaded(const QList<PgsqlCluster *> &clusters);
    //! A read failed with \a exception; emitted from the pool thread.
    void exceptionArise(const AppException &exception);

private Q_SLOTS:
    void readClustersFinished();

private:
    QFutureWatcher<void> _watcher;
    PgsqlManager _manager;
};

#endif
