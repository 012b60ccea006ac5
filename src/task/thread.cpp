#include "thread.h"

#include "abstracttask.h"

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
    _stopThread.store(true);
    _fullBuffer.release(1);
    wait();
}

bool Thread::put(AbstractTask *task)
{
    if (!task)
        return false;
    if (!_emptyBuffer.tryAcquire(1))
        return false;
    _buffer[_rearBound] = task;
    _rearBound = (_rearBound + 1) % BufferSize;
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
    {
        QMutexLocker locker(&_frontBoundMutex);
        _threadIndex = _threadsCount.fetchAndAddOrdered(1);
        if (_threadIndex == 0) {
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
            QMutexLocker locker(&_frontBoundMutex);
            task = _buffer[_frontBound];
            _buffer[_frontBound] = nullptr;
            _frontBound = (_frontBound + 1) % BufferSize;
        }
        _emptyBuffer.release(1);
        if (task)
            task->run();
    }

    if (_threadIndex == 0) {
        // Tasks still waiting are dropped: they never run and never report.
        // Every slot is visited, not only front to rear: with all 64 slots
        // filled the two bounds meet. A slot is nulled when it is taken, so
        // only waiting tasks are found.
        QMutexLocker locker(&_frontBoundMutex);
        for (int n = 0; n < BufferSize; ++n) {
            const int i = (_frontBound + n) % BufferSize;
            delete _buffer[i];
            _buffer[i] = nullptr;
        }
    }
    _threadsCount.fetchAndSubOrdered(1);
    // Wakes the next sleeping worker, so one release stops them all in turn.
    _fullBuffer.release(1);
}
