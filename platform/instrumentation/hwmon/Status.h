// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// From what a hwmon channel shows to the status of its node.

#pragma once

#include <optional>
#include <vector>

namespace Vorn::Hwmon {

// Limits in the unit of the reading; see Documentation/hwmon/sysfs-interface.rst of the kernel
// for what each attribute means.
struct Limits {
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

struct Channel {
    bool hasFault = false;
    std::optional<bool> isEnabled = {}; // absent when it cannot be switched off
    std::optional<double> reading = {}; // absent when it cannot be read
    Limits limits = {};
    Alarms alarms = {};
};

// Chips and drivers show 0 for limits that nobody set. A pair of limits (min and max, lcrit and
// crit) in which no end differs from 0 is therefore taken for absent, and so is an emergency
// limit of 0; an end that the channel does not have counts as 0. Where one end is set, the other
// one's 0 is meant: 0 V below a positive maximum. An end that is there but cannot be read, which
// is NaN here and absent afterwards, may well be set: the other one's 0 stays.
Limits withoutUnset(const Limits& limits);

// The status code of the node. REQUIRES: the limits are withoutUnset().
unsigned statusOf(const Channel& channel);

// The codes that statusOf() can give for a channel with these limits and alarms, ascending. A
// lost channel (13) is left out: it says nothing about the sensor. REQUIRES: as above.
std::vector<unsigned> possibleStatesOf(const Channel& channel);

} // namespace Vorn::Hwmon
