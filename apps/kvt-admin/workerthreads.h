// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMIN_WORKERTHREADS_H
#define KVT_ADMIN_WORKERTHREADS_H

#include <memory>
#include <vector>

class Thread;

/*!
 * The worker threads of the process: started once, stopped once. Stopping
 * any worker stops them all for good (tasks still queued are dropped), so a
 * process has one WorkerThreads, made at start-up and stopped at exit after
 * the tasks have had their chance to finish (MainWindow::waitForTasks()).
 */
class WorkerThreads
{
public:
    explicit WorkerThreads(int count);
    ~WorkerThreads();

    int count() const { return int(_threads.size()); }

    /*!
     * Stops every worker (waiting for the task each one runs), then delivers
     * the completions still pending, so every task that ran gets its
     * afterRun() while the elements it points to still exist.
     */
    void stop();

    WorkerThreads(const WorkerThreads &) = delete;
    WorkerThreads &operator=(const WorkerThreads &) = delete;

private:
    std::vector<std::unique_ptr<Thread>> _threads;
};

#endif
