// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/ChannelReader.h"

#include <cmath>
#include <fstream>
#include <limits>

namespace Vorn::Hwmon {

namespace {

using Subfeature = sensors_subfeature_type;

// The subfeatures of one feature type; `none` where the kernel's sysfs-interface defines no such
// attribute.
constexpr Subfeature none = SENSORS_SUBFEATURE_UNKNOWN;

struct Subfeatures {
    Subfeature input, average, fault;
    Subfeature min, max, lcrit, crit, emergency;
    Subfeature alarm, minAlarm, maxAlarm, lcritAlarm, critAlarm, emergencyAlarm;
};

constexpr Subfeatures fan{
    .input = SENSORS_SUBFEATURE_FAN_INPUT,
    .average = none,
    .fault = SENSORS_SUBFEATURE_FAN_FAULT,
    .min = SENSORS_SUBFEATURE_FAN_MIN,
    .max = SENSORS_SUBFEATURE_FAN_MAX,
    .lcrit = none,
    .crit = none,
    .emergency = none,
    .alarm = SENSORS_SUBFEATURE_FAN_ALARM,
    .minAlarm = SENSORS_SUBFEATURE_FAN_MIN_ALARM,
    .maxAlarm = SENSORS_SUBFEATURE_FAN_MAX_ALARM,
    .lcritAlarm = none,
    .critAlarm = none,
    .emergencyAlarm = none,
};

constexpr Subfeatures voltage{
    .input = SENSORS_SUBFEATURE_IN_INPUT,
    .average = SENSORS_SUBFEATURE_IN_AVERAGE,
    .fault = none,
    .min = SENSORS_SUBFEATURE_IN_MIN,
    .max = SENSORS_SUBFEATURE_IN_MAX,
    .lcrit = SENSORS_SUBFEATURE_IN_LCRIT,
    .crit = SENSORS_SUBFEATURE_IN_CRIT,
    .emergency = none,
    .alarm = SENSORS_SUBFEATURE_IN_ALARM,
    .minAlarm = SENSORS_SUBFEATURE_IN_MIN_ALARM,
    .maxAlarm = SENSORS_SUBFEATURE_IN_MAX_ALARM,
    .lcritAlarm = SENSORS_SUBFEATURE_IN_LCRIT_ALARM,
    .critAlarm = SENSORS_SUBFEATURE_IN_CRIT_ALARM,
    .emergencyAlarm = none,
};

constexpr Subfeatures temperature{
    .input = SENSORS_SUBFEATURE_TEMP_INPUT,
    .average = none,
    .fault = SENSORS_SUBFEATURE_TEMP_FAULT,
    .min = SENSORS_SUBFEATURE_TEMP_MIN,
    .max = SENSORS_SUBFEATURE_TEMP_MAX,
    .lcrit = SENSORS_SUBFEATURE_TEMP_LCRIT,
    .crit = SENSORS_SUBFEATURE_TEMP_CRIT,
    .emergency = SENSORS_SUBFEATURE_TEMP_EMERGENCY,
    .alarm = SENSORS_SUBFEATURE_TEMP_ALARM,
    .minAlarm = SENSORS_SUBFEATURE_TEMP_MIN_ALARM,
    .maxAlarm = SENSORS_SUBFEATURE_TEMP_MAX_ALARM,
    .lcritAlarm = SENSORS_SUBFEATURE_TEMP_LCRIT_ALARM,
    .critAlarm = SENSORS_SUBFEATURE_TEMP_CRIT_ALARM,
    .emergencyAlarm = SENSORS_SUBFEATURE_TEMP_EMERGENCY_ALARM,
};

const Subfeatures& subfeaturesOf(sensors_feature_type type)
{
    if (type == SENSORS_FEATURE_FAN)
        return fan;
    return type == SENSORS_FEATURE_IN ? voltage : temperature;
}

const sensors_subfeature* findSubfeature(const Feature& feature, Subfeature type)
{
    return type == none ? nullptr : sensors_get_subfeature(feature.chip, feature.feature, type);
}

// Returns nothing when there is no such attribute, when it cannot be read, and when its value,
// after a `compute` line, is not a finite number.
std::optional<double> valueOf(const Feature& feature, Subfeature type)
{
    const sensors_subfeature* subfeature = findSubfeature(feature, type);
    double value = 0.0;
    if (subfeature == nullptr || sensors_get_value(feature.chip, subfeature->number, &value) < 0 ||
        !std::isfinite(value))
        return std::nullopt;
    return feature.feature->type == SENSORS_FEATURE_IN ? keepingMillivolts(value) : value;
}

// Returns nothing when there is no such limit, and NaN when it cannot be read.
std::optional<double> limitOf(const Feature& feature, Subfeature type)
{
    if (findSubfeature(feature, type) == nullptr)
        return std::nullopt;
    return valueOf(feature, type).value_or(std::numeric_limits<double>::quiet_NaN());
}

bool isSet(const Feature& feature, Subfeature type)
{
    return valueOf(feature, type).value_or(0.0) != 0.0;
}

std::optional<bool> alarmOf(const Feature& feature, Subfeature type)
{
    if (findSubfeature(feature, type) == nullptr)
        return std::nullopt;
    return isSet(feature, type);
}

// Reads the file, since libsensors has no subfeature for this attribute.
std::optional<bool> enableOf(const Feature& feature)
{
    std::ifstream attribute(
        std::string(feature.chip->path) + "/" + feature.feature->name + "_enable");
    int value = 0;
    if (!(attribute >> value))
        return std::nullopt;
    return value != 0;
}

std::optional<double> readingOf(const Feature& feature, const Subfeatures& types)
{
    const bool hasInput = findSubfeature(feature, types.input) != nullptr;
    return valueOf(feature, hasInput ? types.input : types.average);
}

} // namespace

double keepingMillivolts(double volts)
{
    const double millivolts = std::round(volts * 1000.0);
    const bool isNearest = millivolts / 1000.0 == volts;
    // Records multiply with this precision.
    const bool fallsShort = std::fabs(volts * 1000.0L) < std::fabs(millivolts);
    if (!isNearest || !fallsShort)
        return volts;
    return std::nextafter(volts, std::copysign(std::numeric_limits<double>::infinity(), volts));
}

Channel readChannel(const Feature& feature)
{
    const Subfeatures& types = subfeaturesOf(feature.feature->type);
    Channel channel;
    channel.hasFault = isSet(feature, types.fault);
    channel.isEnabled = enableOf(feature);
    channel.reading = readingOf(feature, types);
    channel.limits = withoutUnset({.min = limitOf(feature, types.min),
        .max = limitOf(feature, types.max),
        .lcrit = limitOf(feature, types.lcrit),
        .crit = limitOf(feature, types.crit),
        .emergency = limitOf(feature, types.emergency)});
    channel.alarms = {.plain = alarmOf(feature, types.alarm),
        .min = alarmOf(feature, types.minAlarm),
        .max = alarmOf(feature, types.maxAlarm),
        .lcrit = alarmOf(feature, types.lcritAlarm),
        .crit = alarmOf(feature, types.critAlarm),
        .emergency = alarmOf(feature, types.emergencyAlarm)};
    return channel;
}

} // namespace Vorn::Hwmon
