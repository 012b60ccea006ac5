// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "pgsqlmanagerasync.h"

#include "pgsqlcluster.h"

#include <QHash>
#include <QMutex>
#include <QPointer>
#include <QThreadPool>
#include <QtConcurrent>

namespace {

// The read state of every manager, kept beside the objects (their layout is
// fixed). A read is "busy" from its start until its completion has been
// delivered: the watcher stops running as soon as the pool thread is done,
// while its finished() may still wait in the event queue, and a new future
// set in between would read the list while that completion hands it out.
enum class ReadState { Busy, BusyAgain };

QMutex stateMutex;
QHash<const PgsqlManagerAsync *, ReadState> &readStates()
{
    static QHash<const PgsqlManagerAsync *, ReadState> states;
    return states;
}

} // namespace

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
    QMutexLocker locker(&stateMutex);
    readStates().remove(this);
}

void PgsqlManagerAsync::startReadClusters()
{
    {
        // Two reads at once would delete and fill the same list: a request
        // made while one is busy runs once that one has reported.
        QMutexLocker locker(&stateMutex);
        const auto it = readStates().find(this);
        if (it != readStates().end()) {
            *it = ReadState::BusyAgain;
            return;
        }
        readStates().insert(this, ReadState::Busy);
    }
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
    // Still busy while the receivers look at the list, so that a refresh they
    // ask for waits until every receiver has seen this one.
    const QPointer<PgsqlManagerAsync> self(this);
    emit clustersReaded(_manager.getClusters());
    if (!self)
        return;
    bool again = false;
    {
        QMutexLocker locker(&stateMutex);
        again = readStates().take(this) == ReadState::BusyAgain;
    }
    if (again)
        startReadClusters();
}
