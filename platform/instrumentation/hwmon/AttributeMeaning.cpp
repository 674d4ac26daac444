// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/AttributeMeaning.h"

#include <algorithm>
#include <array>
#include <limits>

namespace Vorn::Hwmon {

namespace {

bool isSet(std::optional<double> value)
{
    return value.value_or(0.0) != 0.0;
}

void storeReading(ChannelState& channel, std::optional<double> value)
{
    channel.reading = value;
}

void storeFault(ChannelState& channel, std::optional<double> value)
{
    channel.hasFault = isSet(value);
}

void storeEnable(ChannelState& channel, std::optional<double> value)
{
    if (value)
        channel.isEnabled = isSet(value);
}

template <std::optional<double> ChannelLimits::*Limit>
void storeLimit(ChannelState& channel, std::optional<double> value)
{
    channel.limits.*Limit = value.value_or(std::numeric_limits<double>::quiet_NaN());
}

template <std::optional<bool> Alarms::*Alarm>
void storeAlarm(ChannelState& channel, std::optional<double> value)
{
    channel.alarms.*Alarm = isSet(value);
}

constexpr auto meanings = std::to_array<AttributeMeaning>({
    {SENSORS_SUBFEATURE_FAN_INPUT, 1.0, storeReading},
    {SENSORS_SUBFEATURE_FAN_FAULT, 1.0, storeFault},
    {SENSORS_SUBFEATURE_FAN_MIN, 1.0, storeLimit<&ChannelLimits::min>},
    {SENSORS_SUBFEATURE_FAN_MAX, 1.0, storeLimit<&ChannelLimits::max>},
    {SENSORS_SUBFEATURE_FAN_ALARM, 1.0, storeAlarm<&Alarms::plain>},
    {SENSORS_SUBFEATURE_FAN_MIN_ALARM, 1.0, storeAlarm<&Alarms::min>},
    {SENSORS_SUBFEATURE_FAN_MAX_ALARM, 1.0, storeAlarm<&Alarms::max>},

    {SENSORS_SUBFEATURE_IN_INPUT, 1000.0, storeReading},
    {SENSORS_SUBFEATURE_IN_AVERAGE, 1000.0, storeReading},
    {SENSORS_SUBFEATURE_IN_MIN, 1000.0, storeLimit<&ChannelLimits::min>},
    {SENSORS_SUBFEATURE_IN_MAX, 1000.0, storeLimit<&ChannelLimits::max>},
    {SENSORS_SUBFEATURE_IN_LCRIT, 1000.0, storeLimit<&ChannelLimits::lcrit>},
    {SENSORS_SUBFEATURE_IN_CRIT, 1000.0, storeLimit<&ChannelLimits::crit>},
    {SENSORS_SUBFEATURE_IN_ALARM, 1.0, storeAlarm<&Alarms::plain>},
    {SENSORS_SUBFEATURE_IN_MIN_ALARM, 1.0, storeAlarm<&Alarms::min>},
    {SENSORS_SUBFEATURE_IN_MAX_ALARM, 1.0, storeAlarm<&Alarms::max>},
    {SENSORS_SUBFEATURE_IN_LCRIT_ALARM, 1.0, storeAlarm<&Alarms::lcrit>},
    {SENSORS_SUBFEATURE_IN_CRIT_ALARM, 1.0, storeAlarm<&Alarms::crit>},

    {SENSORS_SUBFEATURE_TEMP_INPUT, 1000.0, storeReading},
    {SENSORS_SUBFEATURE_TEMP_FAULT, 1.0, storeFault},
    {SENSORS_SUBFEATURE_TEMP_MIN, 1000.0, storeLimit<&ChannelLimits::min>},
    {SENSORS_SUBFEATURE_TEMP_MAX, 1000.0, storeLimit<&ChannelLimits::max>},
    {SENSORS_SUBFEATURE_TEMP_LCRIT, 1000.0, storeLimit<&ChannelLimits::lcrit>},
    {SENSORS_SUBFEATURE_TEMP_CRIT, 1000.0, storeLimit<&ChannelLimits::crit>},
    {SENSORS_SUBFEATURE_TEMP_EMERGENCY, 1000.0, storeLimit<&ChannelLimits::emergency>},
    {SENSORS_SUBFEATURE_TEMP_ALARM, 1.0, storeAlarm<&Alarms::plain>},
    {SENSORS_SUBFEATURE_TEMP_MIN_ALARM, 1.0, storeAlarm<&Alarms::min>},
    {SENSORS_SUBFEATURE_TEMP_MAX_ALARM, 1.0, storeAlarm<&Alarms::max>},
    {SENSORS_SUBFEATURE_TEMP_LCRIT_ALARM, 1.0, storeAlarm<&Alarms::lcrit>},
    {SENSORS_SUBFEATURE_TEMP_CRIT_ALARM, 1.0, storeAlarm<&Alarms::crit>},
    {SENSORS_SUBFEATURE_TEMP_EMERGENCY_ALARM, 1.0, storeAlarm<&Alarms::emergency>},
});

} // namespace

const AttributeMeaning enableMeaning{SENSORS_SUBFEATURE_UNKNOWN, 1.0, storeEnable};

const AttributeMeaning* meaningOf(sensors_subfeature_type type)
{
    const auto* const found = std::find_if(meanings.begin(), meanings.end(),
        [&](const AttributeMeaning& meaning) { return meaning.type == type; });
    return found == meanings.end() ? nullptr : found;
}

} // namespace Vorn::Hwmon
