// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_HANDOVER_P_H
#define KVT_HANDOVER_P_H

// Work handed from one thread to another through Qt's event queue (a posted
// event, a queued call) is ordered by locks inside QtCore. A ThreadSanitizer
// build of this library does not see into an uninstrumented QtCore, so the
// two ends of each hand-over say so themselves: handOver() in the sending
// thread before posting, takeOver() on the same address in the receiving
// thread before touching what was sent. Both do nothing in other builds.

#if defined(__SANITIZE_THREAD__)
#define KVT_THREAD_SANITIZER 1
#elif defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define KVT_THREAD_SANITIZER 1
#endif
#endif

#include <QtGlobal>

#ifdef KVT_THREAD_SANITIZER
#include <sanitizer/tsan_interface.h>
#endif

namespace KvtHandOver {

inline void handOver(const void *address)
{
#ifdef KVT_THREAD_SANITIZER
    __tsan_release(const_cast<void *>(address));
#else
    Q_UNUSED(address)
#endif
}

inline void takeOver(const void *address)
{
#ifdef KVT_THREAD_SANITIZER
    __tsan_acquire(const_cast<void *>(address));
#else
    Q_UNUSED(address)
#endif
}

} // namespace KvtHandOver

#endif // KVT_HANDOVER_P_H
