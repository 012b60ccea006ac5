#include "pgsqlmanagerasync.h"

#include "pgsqlcluster.h"

#include <QThreadPool>
#include <QtConcurrent>

PgsqlManagerAsync::PgsqlManagerAsync(QObject *parent)
    : QObject(parent)
{
    // Both signals may cross threads.
    qRegisterMetaType<AppException>("AppException");
    qRegisterMetaType<QList<PgsqlCluster *>>("QList<PgsqlCluster*>");
    connect(&_watcher, SIGNAL(finished()), this, SLOT(readClustersFinished()));
}

PgsqlManagerAsync::~PgsqlManagerAsync()
{
    // A running read uses the manager destroyed next; it cannot be
    // interrupted, but it ends within the time-outs of its programs.
    _watcher.cancel();
    _watcher.waitForFinished();
}

void PgsqlManagerAsync::startReadClusters()
{
    // Two reads at once would delete and fill the same list.
    if (_watcher.isRunning())
        return;
    _watcher.setFuture(QtConcurrent::run(QThreadPool::globalInstance(), this,
                                         &PgsqlManagerAsync::performReadClusters));
}

void PgsqlManagerAsync::performReadClusters()
{
    // AppException must not travel through the future: it would arrive as a
    // plain QException without its text.
    try {
        _manager.readClusters();
    } catch (const AppException &e) {
        emit exceptionArise(e);
    }
}

void PgsqlManagerAsync::readClustersFinished()
{
    emit clustersReaded(_manager.getClusters());
}
