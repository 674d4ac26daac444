// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The node status of a hwmon channel.

#pragma once

#include <optional>
#include <vector>

namespace Vorn::Hwmon {

// The limits of a channel in the unit of the reading. The kernel's
// Documentation/hwmon/sysfs-interface.rst defines each attribute.
struct ChannelLimits {
    std::optional<double> min = {};
    std::optional<double> max = {};
    std::optional<double> lcrit = {};
    std::optional<double> crit = {};
    std::optional<double> emergency = {}; // temperatures only
};

// An alarm that the channel does not have is absent; one that cannot be read is not raised.
struct Alarms {
    std::optional<bool> plain = {}; // the chip does not say which limit
    std::optional<bool> min = {};
    std::optional<bool> max = {};
    std::optional<bool> lcrit = {};
    std::optional<bool> crit = {};
    std::optional<bool> emergency = {};
};

// The values of the attributes of a channel.
struct ChannelState {
    bool hasFault = false;
    std::optional<bool> isEnabled = {}; // absent when it cannot be switched off
    std::optional<double> reading = {}; // absent when it cannot be read
    ChannelLimits limits = {};
    Alarms alarms = {};
};

// Returns the limits without those that are unset. Drivers report 0 for an unset limit. A pair (min
// and max, lcrit and crit) whose ends are both 0 or missing counts as unset, and so does an
// emergency limit of 0. Where one end is set, a 0 of the other is a limit: 0 V below a positive
// maximum. An end that cannot be read, NaN here and absent in the result, may be set: a 0 of the
// other stays.
ChannelLimits withoutUnset(const ChannelLimits& limits);

// Returns the status code of the node. REQUIRES: the limits are withoutUnset().
unsigned statusOf(const ChannelState& channel);

// Returns the codes that statusOf() can return for a channel with these limits and alarms,
// ascending, without that of lost communication (13), which is no state of the sensor. REQUIRES:
// the limits are withoutUnset().
std::vector<unsigned> possibleStatesOf(const ChannelState& channel);

} // namespace Vorn::Hwmon
