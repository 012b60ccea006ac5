// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_THREAD_H
#define KVT_THREAD_H

#include "kvtcommon_export.h"

#include <QAtomicInt>
#include <QMutex>
#include <QSemaphore>
#include <QThread>

#include <atomic>

class AbstractTask;

/*!
 * A worker thread. All workers share one ring of 64 task slots: put()
 * stores a task without ever blocking, and any started worker takes it out
 * and runs it.
 *
 * The application decides how many workers it starts (one or more).
 * Destroying any one Thread stops them all, and tasks still waiting in the
 * ring are deleted without running. Workers cannot be restarted afterwards in
 * the same process.
 *
 * A task put here directly, not through TaskObserver::performTask(), gets
 * no row in the task list, but its completion is still handled by the
 * observer: afterRun() and deletion in the interface thread. put() refuses a
 * task (false, the caller keeps it) while the ring is full or before the
 * first worker has started.
 */
class KVTCOMMON_EXPORT Thread : public QThread
{
    Q_OBJECT

public:
    //! Number of slots in the ring shared by all workers.
    static const int BufferSize = 64;

    //! Creates a worker; it takes tasks once start()ed.
    explicit Thread(QObject *parent = nullptr);
    /*!
     * Stops every worker (not only this one) and waits for this thread to end.
     * Tasks still queued are deleted without running and never reach afterRun().
     */
    ~Thread() override;

    /*!
     * Queues \a task for the workers; only the interface thread calls it.
     * Returns false at once, without taking the task, when it is null or no
     * slot is free (also before any worker has started), and once the
     * workers have been stopped.
     */
    static bool put(AbstractTask *task);

    /*!
     * The order in which this worker started (0 for the first), or -1 until its
     * run() has begun. The ring accepts tasks once the first worker reached that
     * point: wait until threadIndex() is not -1 before the first performTask().
     */
    int threadIndex() const { return _threadIndex.load(std::memory_order_acquire); }

protected:
    //! The worker loop: takes tasks from the ring and runs them until the workers stop.
    void run() override;

private:
    static void takeFilledSlot();

    // Written by the worker when it starts, read by the interface thread.
    std::atomic<int> _threadIndex;

    static AbstractTask *_buffer[BufferSize];
    static int _frontBound;
    static int _rearBound;
    static QMutex _frontBoundMutex;
    static QSemaphore _emptyBuffer;
    static QSemaphore _fullBuffer;
    static std::atomic<bool> _stopThread;
    static QAtomicInt _threadsCount;
};

static_assert(sizeof(std::atomic<int>) == sizeof(int), "the thread index keeps the size of an int");

#endif // KVT_THREAD_H
