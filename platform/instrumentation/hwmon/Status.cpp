// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Status.h"

#include "platform/instrumentation/NodeStatus.h"

#include <cmath>

namespace Vorn::Hwmon {

namespace {

using namespace NodeStatus;

bool isUnset(const std::optional<double>& limit)
{
    return limit.value_or(0.0) == 0.0;
}

bool isUnreadable(const std::optional<double>& limit)
{
    return limit && std::isnan(*limit);
}

bool isRaised(const std::optional<bool>& alarm)
{
    return alarm.value_or(false);
}

bool isAtOrAbove(double reading, const std::optional<double>& limit)
{
    return limit && reading >= *limit;
}

bool isAtOrBelow(double reading, const std::optional<double>& limit)
{
    return limit && reading <= *limit;
}

} // namespace

ChannelLimits withoutUnset(const ChannelLimits& limits)
{
    ChannelLimits set = limits;
    if (isUnset(limits.min) && isUnset(limits.max))
        set.min = set.max = std::nullopt;
    if (isUnset(limits.lcrit) && isUnset(limits.crit))
        set.lcrit = set.crit = std::nullopt;
    if (isUnset(limits.emergency))
        set.emergency = std::nullopt;
    for (std::optional<double>* const limit :
        {&set.min, &set.max, &set.lcrit, &set.crit, &set.emergency})
        if (isUnreadable(*limit))
            *limit = std::nullopt;
    return set;
}

unsigned statusOf(const ChannelState& channel)
{
    if (channel.hasFault || !channel.reading)
        return lostCommunication;
    if (!channel.isEnabled.value_or(true))
        return disabled;
    const double reading = *channel.reading;
    const ChannelLimits& limits = channel.limits;
    const Alarms& alarms = channel.alarms;
    if (isRaised(alarms.emergency) || isRaised(alarms.crit) || isAtOrAbove(reading, limits.crit))
        return criticalHigh;
    if (isRaised(alarms.lcrit) || isAtOrBelow(reading, limits.lcrit))
        return criticalLow;
    if (isRaised(alarms.max) || isAtOrAbove(reading, limits.max))
        return warningHigh;
    // This includes a fan with a plain alarm that is at or below its minimum.
    if (isRaised(alarms.min) || isAtOrBelow(reading, limits.min))
        return warningLow;
    return isRaised(alarms.plain) ? warning : normal;
}

std::vector<unsigned> possibleStatesOf(const ChannelState& channel)
{
    const ChannelLimits& limits = channel.limits;
    const Alarms& alarms = channel.alarms;
    std::vector<unsigned> states;
    states.reserve(7);
    states.push_back(normal);
    const auto addIf = [&](bool canHappen, unsigned state) {
        if (canHappen)
            states.push_back(state);
    };
    addIf(channel.isEnabled.has_value(), disabled);
    addIf(alarms.plain.has_value(), warning);
    addIf(limits.min || alarms.min, warningLow);
    addIf(limits.max || alarms.max, warningHigh);
    addIf(limits.lcrit || alarms.lcrit, criticalLow);
    addIf(limits.crit || alarms.crit || alarms.emergency, criticalHigh);
    return states;
}

} // namespace Vorn::Hwmon
