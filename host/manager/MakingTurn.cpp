// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/MakingTurn.h"

#include <condition_variable>
#include <map>
#include <mutex>
#include <stdexcept>
#include <thread>

namespace Host {

namespace {

// Who makes what and who waits for what, in the whole process: threads may wait for one another
// across managers.
struct Turns {
    std::mutex mutex;
    std::condition_variable ended;
    std::map<std::string, std::thread::id> makers;
    std::map<std::thread::id, std::string> awaited;
};

Turns& turns()
{
    static Turns all;
    return all;
}

// Whether the thing waits for this thread, through however many others.
bool waitsForThisThread(const Turns& all, const std::string& thing)
{
    const std::string* wanted = &thing;
    for (;;) {
        const auto maker = all.makers.find(*wanted);
        if (maker == all.makers.end())
            return false;
        if (maker->second == std::this_thread::get_id())
            return true;
        const auto next = all.awaited.find(maker->second);
        if (next == all.awaited.end())
            return false;
        wanted = &next->second;
    }
}

} // namespace

MakingTurn::MakingTurn(const std::string& thing) : thing_(thing)
{
    Turns& all = turns();
    std::unique_lock lock(all.mutex);
    while (all.makers.contains(thing)) {
        if (waitsForThisThread(all, thing))
            throw std::runtime_error(thing + " is asked for while it is made");
        all.awaited.insert_or_assign(std::this_thread::get_id(), thing);
        all.ended.wait(lock);
        all.awaited.erase(std::this_thread::get_id());
    }
    all.makers.emplace(thing, std::this_thread::get_id());
}

MakingTurn::~MakingTurn()
{
    Turns& all = turns();
    const std::lock_guard lock(all.mutex);
    all.makers.erase(thing_);
    all.ended.notify_all();
}

} // namespace Host
