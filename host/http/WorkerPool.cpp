// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/WorkerPool.h"

#include <utility>

namespace Host::Http {

WorkerPool::WorkerPool(std::size_t workers, std::size_t maximumQueue) : maximumQueue_(maximumQueue)
{
    threads_.reserve(workers);
    try {
        for (std::size_t i = 0; i < workers; ++i)
            threads_.emplace_back([this] { work(); });
    } catch (...) {
        end();
        throw;
    }
}

WorkerPool::~WorkerPool()
{
    end();
}

bool WorkerPool::take(std::function<void()> job)
{
    {
        const std::lock_guard lock(mutex_);
        if (isEnding_ || queue_.size() >= maximumQueue_)
            return false;
        queue_.push_back(std::move(job));
    }
    changed_.notify_one();
    return true;
}

void WorkerPool::work()
{
    for (;;) {
        std::function<void()> job;
        {
            std::unique_lock lock(mutex_);
            changed_.wait(lock, [this] { return isEnding_ || !queue_.empty(); });
            if (queue_.empty())
                return;
            job = std::move(queue_.front());
            queue_.pop_front();
        }
        job();
    }
}

void WorkerPool::end()
{
    {
        const std::lock_guard lock(mutex_);
        isEnding_ = true;
    }
    changed_.notify_all();
    for (std::thread& thread : threads_)
        thread.join();
    threads_.clear();
}

} // namespace Host::Http
