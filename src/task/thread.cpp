// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "thread.h"

#include "abstracttask.h"
#include "handover_p.h"

#include <QList>

AbstractTask *Thread::_buffer[Thread::BufferSize] = {};
int Thread::_frontBound = 0;
int Thread::_rearBound = 0;
QMutex Thread::_frontBoundMutex;
QSemaphore Thread::_emptyBuffer(0);
QSemaphore Thread::_fullBuffer(0);
std::atomic<bool> Thread::_stopThread(false);
QAtomicInt Thread::_threadsCount(0);

Thread::Thread(QObject *parent)
    : QThread(parent)
    , _threadIndex(-1)
{
}

Thread::~Thread()
{
    {
        // Under the ring's lock, so that a put() either lands before the stop
        // (and is dropped by the stop walk) or sees it and refuses the task.
        KvtHandOver::Locker locker(&_frontBoundMutex);
        _stopThread.store(true);
    }
    _fullBuffer.release(1);
    wait();
}

bool Thread::put(AbstractTask *task)
{
    if (!task)
        return false;
    {
        // The lock orders the store with the stop walk of the first worker,
        // which reads and clears the same slots.
        KvtHandOver::Locker locker(&_frontBoundMutex);
        // Once stopped, no worker takes anything out of the ring again: a
        // task accepted now would never run and never be freed.
        if (_stopThread.load())
            return false;
        if (!_emptyBuffer.tryAcquire(1))
            return false;
        _buffer[_rearBound] = task;
        _rearBound = (_rearBound + 1) % BufferSize;
    }
    _fullBuffer.release(1);
    return true;
}

namespace {

// Short tasks arrive one by one as the interface thread hands them out. A
// worker that went to sleep at once would be woken for nearly every task,
// and each wake-up takes the processor from the interface thread that is
// feeding the ring. So a worker that finds the ring empty first yields a few
// times, then blocks.
const int yieldsBeforeBlocking = 50;

} // namespace

void Thread::takeFilledSlot()
{
    if (_fullBuffer.tryAcquire(1))
        return;
    for (int i = 0; i < yieldsBeforeBlocking; ++i) {
        QThread::yieldCurrentThread();
        if (_fullBuffer.tryAcquire(1))
            return;
    }
    _fullBuffer.acquire(1);
}

void Thread::run()
{
    int index = -1;
    {
        KvtHandOver::Locker locker(&_frontBoundMutex);
        index = _threadsCount.fetchAndAddOrdered(1);
        _threadIndex.store(index, std::memory_order_release);
        if (index == 0) {
            // The first worker opens the ring: until now no slot was free, so
            // tasks put before any worker started were refused.
            for (AbstractTask *&slot : _buffer)
                slot = nullptr;
            _emptyBuffer.release(BufferSize);
        }
    }

    for (;;) {
        takeFilledSlot();
        if (_stopThread.load())
            break;
        AbstractTask *task = nullptr;
        {
            KvtHandOver::Locker locker(&_frontBoundMutex);
            task = _buffer[_frontBound];
            _buffer[_frontBound] = nullptr;
            _frontBound = (_frontBound + 1) % BufferSize;
        }
        _emptyBuffer.release(1);
        if (task)
            task->run();
    }

    if (index == 0) {
        // Tasks still waiting are dropped: they never run and never report.
        // Every slot is visited, not only front to rear: with all 64 slots
        // filled the two bounds meet. A slot is nulled when it is taken, so
        // only waiting tasks are found.
        QList<AbstractTask *> dropped;
        {
            KvtHandOver::Locker locker(&_frontBoundMutex);
            for (int n = 0; n < BufferSize; ++n) {
                const int i = (_frontBound + n) % BufferSize;
                if (_buffer[i])
                    dropped.append(_buffer[i]);
                _buffer[i] = nullptr;
            }
        }
        // Deleted outside the lock: a task's destructor tells the observer,
        // which must never wait for the ring while a worker holds it.
        qDeleteAll(dropped);
    }
    _threadsCount.fetchAndSubOrdered(1);
    // Wakes the next sleeping worker, so one release stops them all in turn.
    _fullBuffer.release(1);
}
