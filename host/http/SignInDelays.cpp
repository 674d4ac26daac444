// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/SignInDelays.h"

#include <algorithm>

namespace Host::Http {

SignInDelays::Time SignInDelays::admission(const std::string& address, Time now)
{
    const std::lock_guard lock(mutex_);
    const auto found = failures_.find(address);
    return found == failures_.end() ? now : std::max(now, found->second.notBefore);
}

SignInDelays::Time SignInDelays::admit(const std::string& address, Time now)
{
    const std::lock_guard lock(mutex_);
    const auto found = failures_.find(address);
    if (found == failures_.end() || isOld(found->second, now))
        return now;
    Failures& failures = found->second;
    if (failures.notBefore > now)
        return failures.notBefore;
    failures.notBefore = now + delayAfter(failures);
    return now;
}

SignInDelays::Time SignInDelays::failed(const std::string& address, Time now)
{
    const std::lock_guard lock(mutex_);
    if (!failures_.contains(address))
        makeRoom(now);
    Failures& failures = failures_[address];
    if (failures.count > 0 && isOld(failures, now))
        failures = {};
    const Duration delay = delayAfter(failures);
    ++failures.count;
    failures.last = now;
    failures.notBefore = std::max(failures.notBefore, now + delay);
    return failures.notBefore;
}

std::size_t SignInDelays::size()
{
    const std::lock_guard lock(mutex_);
    return failures_.size();
}

void SignInDelays::makeRoom(Time now)
{
    if (failures_.size() < capacity)
        return;
    std::erase_if(failures_, [now](const auto& each) { return isOld(each.second, now); });
    if (failures_.size() >= capacity)
        failures_.erase(std::min_element(
            failures_.begin(), failures_.end(), [](const auto& one, const auto& other) {
                return one.second.last < other.second.last;
            }));
}

} // namespace Host::Http
