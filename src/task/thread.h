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
    static const int BufferSize = 64;

    explicit Thread(QObject *parent = nullptr);
    ~Thread() override;

    /*!
     * Queues \a task for the workers; only the interface thread calls it.
     * Returns false at once, without taking the task, when it is null or no
     * slot is free (also before any worker has started).
     */
    static bool put(AbstractTask *task);

    int threadIndex() const { return _threadIndex; }

protected:
    void run() override;

private:
    static void takeFilledSlot();

    int _threadIndex;

    static AbstractTask *_buffer[BufferSize];
    static int _frontBound;
    static int _rearBound;
    static QMutex _frontBoundMutex;
    static QSemaphore _emptyBuffer;
    static QSemaphore _fullBuffer;
    static std::atomic<bool> _stopThread;
    static QAtomicInt _threadsCount;
};

#endif // KVT_THREAD_H
