// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Preloaded into the tests of a ThreadSanitizer build (KVT_TSAN). Qt 5 comes
// uninstrumented, so ThreadSanitizer does not see the ordering that QMutex
// and QSemaphore give: a mutex taken on its contended path, or a semaphore
// released by one thread and acquired by another, looks like no
// synchronisation at all, and every access it protects like a race. This
// library wraps the out-of-line entry points of both classes (and of
// QFutureInterfaceBase, below) that instrumented code calls, and tells
// ThreadSanitizer about the ordering on the object's address: a release before unlocking or releasing, an acquire
// after locking or acquiring. (The inline fast path of QBasicMutex is an
// atomic operation in instrumented code already, on the same address.)
//
// It is deliberately built without instrumentation and resolves the
// ThreadSanitizer entry points at run time from the process.

#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>

extern "C" {
void __tsan_acquire(void *address);
void __tsan_release(void *address);
}

namespace {

template <typename Function>
Function real(const char *symbol)
{
    void *found = dlsym(RTLD_NEXT, symbol);
    if (!found) {
        std::fprintf(stderr, "qtsync: %s not found\n", symbol);
        std::abort();
    }
    return reinterpret_cast<Function>(found);
}

} // namespace

#define KVT_REAL(type, symbol) static const auto next = real<type>(symbol)

extern "C" {

// QMutex::lock()
void _ZN6QMutex4lockEv(void *mutex)
{
    KVT_REAL(void (*)(void *), "_ZN6QMutex4lockEv");
    next(mutex);
    __tsan_acquire(mutex);
}

// QMutex::tryLock(int)
bool _ZN6QMutex7tryLockEi(void *mutex, int timeout)
{
    KVT_REAL(bool (*)(void *, int), "_ZN6QMutex7tryLockEi");
    const bool locked = next(mutex, timeout);
    if (locked)
        __tsan_acquire(mutex);
    return locked;
}

// QMutex::unlock()
void _ZN6QMutex6unlockEv(void *mutex)
{
    KVT_REAL(void (*)(void *), "_ZN6QMutex6unlockEv");
    __tsan_release(mutex);
    next(mutex);
}

// QBasicMutex::lockInternal(), the contended path of the inline lock()
void _ZN11QBasicMutex12lockInternalEv(void *mutex)
{
    KVT_REAL(void (*)(void *), "_ZN11QBasicMutex12lockInternalEv");
    next(mutex);
    __tsan_acquire(mutex);
}

// QBasicMutex::lockInternal(int)
bool _ZN11QBasicMutex12lockInternalEi(void *mutex, int timeout)
{
    KVT_REAL(bool (*)(void *, int), "_ZN11QBasicMutex12lockInternalEi");
    const bool locked = next(mutex, timeout);
    if (locked)
        __tsan_acquire(mutex);
    return locked;
}

// QBasicMutex::unlockInternal(), the contended path of the inline unlock()
void _ZN11QBasicMutex14unlockInternalEv(void *mutex)
{
    KVT_REAL(void (*)(void *), "_ZN11QBasicMutex14unlockInternalEv");
    __tsan_release(mutex);
    next(mutex);
}

// QSemaphore::acquire(int)
void _ZN10QSemaphore7acquireEi(void *semaphore, int n)
{
    KVT_REAL(void (*)(void *, int), "_ZN10QSemaphore7acquireEi");
    next(semaphore, n);
    __tsan_acquire(semaphore);
}

// QSemaphore::tryAcquire(int)
bool _ZN10QSemaphore10tryAcquireEi(void *semaphore, int n)
{
    KVT_REAL(bool (*)(void *, int), "_ZN10QSemaphore10tryAcquireEi");
    const bool acquired = next(semaphore, n);
    if (acquired)
        __tsan_acquire(semaphore);
    return acquired;
}

// QSemaphore::tryAcquire(int, int)
bool _ZN10QSemaphore10tryAcquireEii(void *semaphore, int n, int timeout)
{
    KVT_REAL(bool (*)(void *, int, int), "_ZN10QSemaphore10tryAcquireEii");
    const bool acquired = next(semaphore, n, timeout);
    if (acquired)
        __tsan_acquire(semaphore);
    return acquired;
}

// QSemaphore::release(int)
void _ZN10QSemaphore7releaseEi(void *semaphore, int n)
{
    KVT_REAL(void (*)(void *, int), "_ZN10QSemaphore7releaseEi");
    __tsan_release(semaphore);
    next(semaphore, n);
}

// QtConcurrent::run() hands its task to a pool thread through QThreadPool's
// queue, and the result back through QFutureInterface, both locked inside
// QtCore. The task object is the QFutureInterfaceBase whose reportStarted()
// the starting thread calls before queueing it and whose isCanceled() the
// pool thread calls first; reportFinished() ends the work, and the waiting
// side learns of it through waitForResult(), waitForFinished() or
// isFinished().

// QFutureInterfaceBase::reportStarted()
void _ZN20QFutureInterfaceBase13reportStartedEv(void *future)
{
    KVT_REAL(void (*)(void *), "_ZN20QFutureInterfaceBase13reportStartedEv");
    __tsan_release(future);
    next(future);
}

// QFutureInterfaceBase::isCanceled() const
bool _ZNK20QFutureInterfaceBase10isCanceledEv(void *future)
{
    KVT_REAL(bool (*)(void *), "_ZNK20QFutureInterfaceBase10isCanceledEv");
    const bool canceled = next(future);
    __tsan_acquire(future);
    return canceled;
}

// QFutureInterfaceBase::reportFinished()
void _ZN20QFutureInterfaceBase14reportFinishedEv(void *future)
{
    KVT_REAL(void (*)(void *), "_ZN20QFutureInterfaceBase14reportFinishedEv");
    __tsan_release(future);
    next(future);
}

// QFutureInterfaceBase::waitForResult(int)
void _ZN20QFutureInterfaceBase13waitForResultEi(void *future, int index)
{
    KVT_REAL(void (*)(void *, int), "_ZN20QFutureInterfaceBase13waitForResultEi");
    next(future, index);
    __tsan_acquire(future);
}

// QFutureInterfaceBase::waitForFinished()
void _ZN20QFutureInterfaceBase15waitForFinishedEv(void *future)
{
    KVT_REAL(void (*)(void *), "_ZN20QFutureInterfaceBase15waitForFinishedEv");
    next(future);
    __tsan_acquire(future);
}

// QFutureInterfaceBase::isFinished() const
bool _ZNK20QFutureInterfaceBase10isFinishedEv(void *future)
{
    KVT_REAL(bool (*)(void *), "_ZNK20QFutureInterfaceBase10isFinishedEv");
    const bool finished = next(future);
    if (finished)
        __tsan_acquire(future);
    return finished;
}

} // extern "C"
