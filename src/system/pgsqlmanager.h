// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PGSQLMANAGER_H
#define KVT_PGSQLMANAGER_H

#include "kvtcommon_export.h"

#include <QList>
#include <QObject>

class PgsqlCluster;

/*!
 * The PostgreSQL installation of the host: whether a server package is
 * installed and which clusters exist.
 *
 * The manager owns the clusters of its last read; each readClusters() deletes
 * them before reading again, so pointers taken from getClusters() are valid
 * only until the next read. Not thread-safe.
 */
class KVTCOMMON_EXPORT PgsqlManager : public QObject
{
    Q_OBJECT

public:
    //! Creates a manager with no clusters read.
    explicit PgsqlManager(QObject *parent = nullptr);
    ~PgsqlManager() override;

    //! Whether a versioned server package is installed (the name is spelled so on purpose).
    bool packagesInslled() const;

    /*!
     * Replaces the list by the clusters pg_lsclusters reports. Throws
     * AppException; the clusters parsed before a failing line stay listed.
     */
    void readClusters();

    //! The clusters of the last read, owned by the manager.
    QList<PgsqlCluster *> getClusters() const { return _clusters; }

    //! True when every cluster runs, and for an empty list.
    static bool allClustersWork(QList<PgsqlCluster *> clusters);

private:
    QList<PgsqlCluster *> _clusters;
};

#endif
