// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Timer.h"

#include "host/http/EventLog.h"

#include <exception>
#include <string>
#include <utility>

namespace Host::Http {

namespace {

void perform(const std::function<void()>& action) noexcept
{
    try {
        action();
    } catch (const std::exception& error) {
        report({"perform", "Timer", __LINE__}, error.what());
    } catch (...) {
        report({"perform", "Timer", __LINE__}, "something failed for no known reason");
    }
}

} // namespace

Timer::Timer() : thread_([this] { run(); }) {}

void Timer::at(Time time, std::function<void()> action)
{
    add(time, {std::move(action), false});
}

void Timer::atOrSooner(Time time, std::function<void()> action)
{
    add(time, {std::move(action), true});
}

void Timer::add(Time time, Action action)
{
    {
        const std::lock_guard lock(mutex_);
        if (!isEnding_) {
            actions_.emplace(isHurried_ && action.mayBeSooner ? Time{} : time, std::move(action));
            changed_.notify_all();
            return;
        }
    }
    perform(action.function);
}

void Timer::hurry()
{
    {
        const std::lock_guard lock(mutex_);
        isHurried_ = true;
        for (auto next = actions_.begin(); next != actions_.end();) {
            const auto action = next++;
            if (!action->second.mayBeSooner)
                continue;
            auto sooner = actions_.extract(action);
            sooner.key() = Time{};
            actions_.insert(std::move(sooner));
        }
    }
    changed_.notify_all();
}

void Timer::end()
{
    {
        const std::lock_guard lock(mutex_);
        isEnding_ = true;
    }
    changed_.notify_all();
    if (thread_.joinable())
        thread_.join();
}

void Timer::run()
{
    std::unique_lock lock(mutex_);
    for (;;) {
        if (actions_.empty()) {
            if (isEnding_)
                return;
            changed_.wait(lock);
            continue;
        }
        const auto first = actions_.begin();
        const Time due = first->first;
        if (!isEnding_ && std::chrono::steady_clock::now() < due) {
            changed_.wait_until(lock, due);
            continue;
        }
        const auto action = std::move(first->second.function);
        actions_.erase(first);
        lock.unlock();
        perform(action);
        lock.lock();
    }
}

} // namespace Host::Http
