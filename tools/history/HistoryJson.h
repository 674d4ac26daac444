// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The samples of a sensor as an object of JSON: the oldest first, null where nothing was recorded.

#pragma once

#include "tools/history/Samples.h"

#include <string>
#include <string_view>

namespace Tools {

// The number of samples to which an hour is thinned, each of a minute.
inline constexpr SlotNumber thinnedSamples = Samples::slotsKept / slotsOfMinute;

void appendHour(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest);
// A sample is the mean of the readings in its minute and has its most urgent state.
void appendThinnedHour(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest);
void appendDay(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest);

} // namespace Tools
