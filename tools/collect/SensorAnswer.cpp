// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorAnswer.h"

#include "platform/instrumentation/NodeStatus.h"
#include "tools/collect/Transport.h"

#include <algorithm>

namespace Ipmi {

using namespace Vorn::NodeStatus;

bool meansUnavailable(std::uint8_t completionCode)
{
    using namespace CompletionCode;
    constexpr std::array codes = {invalidCommand, notPresent, invalidField, illegalCommand};
    return std::find(codes.begin(), codes.end(), completionCode) != codes.end();
}

SensorAnswer interpret(std::span<const std::uint8_t> answer, bool ignoresScanning)
{
    constexpr unsigned unavailableBit = 0x20;
    constexpr unsigned scanningBit = 0x40;
    using Kind = SensorAnswer::Kind;
    if (answer.empty())
        return {Kind::failed};
    if (meansUnavailable(answer[0]))
        return {Kind::unavailable};
    if (answer[0] != CompletionCode::success || answer.size() < 3)
        return {Kind::failed};
    if ((answer[2] & unavailableBit) != 0)
        return {Kind::unavailable};
    if ((answer[2] & scanningBit) == 0 && !ignoresScanning)
        return {Kind::disabled};
    SensorAnswer reading{Kind::reading, answer[1]};
    if (answer.size() > 3)
        reading.crossed = answer[3] & 0x3FU;
    return reading;
}

ThresholdMask crossedBy(double reading, const Limits& limits)
{
    ThresholdMask crossed;
    for (std::size_t threshold = 0; threshold < thresholdCount; ++threshold)
        if (const auto limit = limits[threshold])
            crossed[threshold] =
                threshold < upperNonCritical ? reading <= *limit : reading >= *limit;
    return crossed;
}

bool isLow(const ThresholdMask& crossed)
{
    return crossed[lowerNonCritical] || crossed[lowerCritical] || crossed[lowerNonRecoverable];
}

unsigned statusOf(const ThresholdMask& crossed)
{
    if (crossed[upperNonRecoverable] || crossed[upperCritical])
        return criticalHigh;
    if (crossed[lowerNonRecoverable] || crossed[lowerCritical])
        return criticalLow;
    if (crossed[upperNonCritical])
        return warningHigh;
    return crossed[lowerNonCritical] ? warningLow : normal;
}

std::vector<unsigned> possibleStates(const ThresholdMask& thresholds)
{
    std::vector<unsigned> states{normal, disabled};
    for (const unsigned state : {warningLow, warningHigh, criticalLow, criticalHigh})
        for (std::size_t threshold = 0; threshold < thresholdCount; ++threshold)
            if (thresholds[threshold] && statusOf(ThresholdMask(1U << threshold)) == state &&
                states.back() != state)
                states.push_back(state);
    return states;
}

} // namespace Ipmi
