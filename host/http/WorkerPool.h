// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <mutex>
#include <thread>
#include <vector>

namespace Host::Http {

// A fixed number of threads that take jobs in the order in which they came. Thread-safe.
class WorkerPool {
public:
    // Throws std::system_error when a thread cannot be started.
    WorkerPool(std::size_t workers, std::size_t maximumQueue);
    // Finishes the jobs that run and those that wait.
    ~WorkerPool();
    WorkerPool(const WorkerPool&) = delete;
    WorkerPool& operator=(const WorkerPool&) = delete;

    // False when too many wait already. The job must not throw.
    bool take(std::function<void()> job);

private:
    void work();
    void end();

    const std::size_t maximumQueue_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::deque<std::function<void()>> queue_;
    bool isEnding_ = false;
    std::vector<std::thread> threads_;
};

} // namespace Host::Http
