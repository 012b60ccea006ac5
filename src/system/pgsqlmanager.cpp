// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "pgsqlmanager.h"

#include "package.h"
#include "pgsql_p.h"
#include "pgsqlcluster.h"
#include "process.h"
#include "stringsplit_p.h"

PgsqlManager::PgsqlManager(QObject *parent)
    : QObject(parent)
{
}

PgsqlManager::~PgsqlManager()
{
    qDeleteAll(_clusters);
}

bool PgsqlManager::packagesInslled() const
{
    return Package(QLatin1String(KvtPgsql::serverPackagePattern)).isInstalled();
}

void PgsqlManager::readClusters()
{
    qDeleteAll(_clusters);
    _clusters.clear();

    Process process;
    process.simpleStart(QLatin1String(KvtPgsql::clusterListProgram), {QStringLiteral("--no-header")}, true);
    const QStringList lines = splitSkippingEmpty(process.output(), QLatin1Char('\n'));
    for (const QString &line : lines)
        _clusters.append(PgsqlCluster::fromString(line));
}

bool PgsqlManager::allClustersWork(QList<PgsqlCluster *> clusters)
{
    for (const PgsqlCluster *cluster : qAsConst(clusters)) {
        if (!cluster->isWork())
            return false;
    }
    return true;
}
