// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <map>
#include <mutex>
#include <thread>

namespace Host::Http {

// A thread that does small things at their time. Thread-safe.
class Timer {
public:
    using Time = std::chrono::steady_clock::time_point;

    Timer();
    ~Timer() { end(); }
    Timer(const Timer&) = delete;
    Timer& operator=(const Timer&) = delete;

    // The action must be quick. One that throws has failed, which goes to the log.
    void at(Time time, std::function<void()> action);
    // The same, but at once where there is a hurry.
    void atOrSooner(Time time, std::function<void()> action);
    // There is one, from now on.
    void hurry();
    // Does at once what is waiting; from then on at() does so itself. Idempotent, but not for two
    // threads at once.
    void end();

private:
    struct Action {
        std::function<void()> function;
        bool mayBeSooner;
    };

    void add(Time time, Action action);
    void run();

    std::mutex mutex_;
    std::condition_variable changed_;
    std::multimap<Time, Action> actions_;
    bool isHurried_ = false;
    bool isEnding_ = false;
    std::thread thread_;
};

} // namespace Host::Http
