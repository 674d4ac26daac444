// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/Samples.h"

#include <algorithm>
#include <cmath>
#include <type_traits>

namespace Tools {

static_assert(std::is_trivially_copyable_v<Samples> && sizeof(Samples) <= std::size_t{21} << 10);

namespace {

// Returns the place in a ring of that size, also for times before 1970.
std::size_t placeOf(SlotNumber time, SlotNumber size)
{
    return static_cast<std::size_t>((time % size + size) % size);
}

float nearestFloat(double number)
{
    constexpr double greatest = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(number, -greatest, greatest));
}

} // namespace

unsigned moreUrgent(unsigned earlier, unsigned later)
{
    if (earlier == 0 || later == 0)
        return std::max(earlier, later);
    return stateNumbered(earlier).urgency > stateNumbered(later).urgency ? earlier : later;
}

Samples::Samples()
{
    values_.fill(absent);
    states_.fill(0);
    for (auto* const each : {&minima_, &means_, &maxima_})
        each->fill(absent);
    statesOfMinutes_.fill(0);
}

void Samples::add(SlotNumber slot, const Sensor& sensor)
{
    const auto state = static_cast<std::uint8_t>(numberOf(sensor.state));
    const float value = sensor.reading ? nearestFloat(sensor.reading->number()) : absent;
    const auto place = placeOf(slot, slotsKept);
    values_.at(place) = value;
    states_.at(place) = state;

    const auto minute = placeOf(minuteOf(slot), minutesKept);
    std::uint8_t& stateOfMinute = statesOfMinutes_.at(minute);
    stateOfMinute = static_cast<std::uint8_t>(moreUrgent(stateOfMinute, state));
    if (std::isnan(value))
        return;
    float& mean = means_.at(minute);
    if (std::isnan(mean)) {
        readingsOfMinute_ = 1;
        minima_.at(minute) = mean = maxima_.at(minute) = value;
        return;
    }
    mean += (value - mean) / static_cast<float>(++readingsOfMinute_);
    minima_.at(minute) = std::min(minima_.at(minute), value);
    maxima_.at(minute) = std::max(maxima_.at(minute), value);
}

void Samples::clearSlot(SlotNumber slot)
{
    const auto place = placeOf(slot, slotsKept);
    values_.at(place) = absent;
    states_.at(place) = 0;
}

void Samples::clearMinute(SlotNumber minute)
{
    const auto place = placeOf(minute, minutesKept);
    minima_.at(place) = means_.at(place) = maxima_.at(place) = absent;
    statesOfMinutes_.at(place) = 0;
}

Samples::OfSlot Samples::ofSlot(SlotNumber slot) const
{
    const auto place = placeOf(slot, slotsKept);
    return {values_.at(place), states_.at(place)};
}

Samples::OfMinute Samples::ofMinute(SlotNumber minute) const
{
    const auto place = placeOf(minute, minutesKept);
    return {minima_.at(place), means_.at(place), maxima_.at(place), statesOfMinutes_.at(place)};
}

bool Samples::isValid() const
{
    const auto isState = [](std::uint8_t number) { return number <= greatestStateNumber; };
    constexpr std::uint32_t many = 1'000'000; // after as many restarts
    return readingsOfMinute_ < many && std::all_of(states_.begin(), states_.end(), isState) &&
           std::all_of(statesOfMinutes_.begin(), statesOfMinutes_.end(), isState);
}

} // namespace Tools
