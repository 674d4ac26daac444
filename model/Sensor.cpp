// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/Sensor.h"

#include "model/ValueTables.h"
#include "platform/utilities/ProviderUtilities.h"

#include <limits>
#include <utility>

namespace Vorn::SensorProfileProvider {

namespace {

// The product keeps 64 bits of significand and is cut as it stands: 3.3 V become 3299 mV.
// Rounded to double first it would be 3300.
static_assert(std::numeric_limits<long double>::digits >= 64);

std::int32_t truncated(long double product)
{
    constexpr std::int32_t OutOfRange = std::numeric_limits<std::int32_t>::min();
    constexpr long double Above = 2147483648.0L;
    constexpr long double Below = -2147483649.0L;
    if (product > Below && product < Above) // false for what is not a number
        return static_cast<std::int32_t>(product);
    return OutOfRange;
}

std::vector<std::uint16_t> withThresholdCodes(std::vector<std::uint16_t>& codes)
{
    codes.insert(codes.end(), ThresholdCodes.begin(), ThresholdCodes.end());
    return codes;
}

} // namespace

std::string Sensor::getDeviceID() const
{
    return stripSpaces(deviceID_);
}

std::string Sensor::getElementName() const
{
    return stripSpaces(elementName_);
}

std::vector<std::string> Sensor::getPossibleStates()
{
    for (const char* const label : FixedStateLabels)
        possibleStates_.append(label);
    return possibleStates_.as<std::string>();
}

std::uint16_t Sensor::getRateUnits()
{
    rateUnits_ = 0;
    return rateUnits_;
}

std::vector<std::uint16_t> Sensor::getSupportedThresholds()
{
    return withThresholdCodes(supportedThresholds_);
}

std::vector<std::uint16_t> Sensor::getSettableThresholds()
{
    return withThresholdCodes(settableThresholds_);
}

bool Sensor::setDeviceID(std::string deviceID)
{
    deviceID_ = std::move(deviceID);
    return !deviceID_.empty();
}

bool Sensor::setElementName(std::string elementName)
{
    elementName_ = std::move(elementName);
    return !elementName_.empty();
}

bool Sensor::setBaseUnits(unsigned code)
{
    baseUnits_ = static_cast<std::uint16_t>(code);
    return true;
}

bool Sensor::setRateUnits(unsigned code)
{
    rateUnits_ = static_cast<std::uint16_t>(code);
    return rateUnits_ != 0;
}

bool Sensor::setUnitModifier(int powerOfTen)
{
    unitModifier_ = powerOfTen;
    return true;
}

bool Sensor::setSensorType(unsigned sensorType)
{
    const TypeAndScale& found = SensorTypes[sensorType];
    sensorType_ = found.sensorType;
    readingMultiplier_ = found.multiplier;
    unitModifier_ = found.unitModifier;
    if (!found.isKnown)
        baseUnits_ = 0;
    return true;
}

bool Sensor::setEnabledState(unsigned nodeStatus)
{
    enabledState_ = EnabledStates[nodeStatus];
    return true;
}

bool Sensor::setRequestedState(unsigned code)
{
    requestedState_ = RequestedStates[code];
    return true;
}

bool Sensor::setHealthState(unsigned nodeStatus)
{
    const Health& health = HealthStates[nodeStatus];
    healthState_ = health.state;
    healthStatus_ = health.status;
    return true;
}

bool Sensor::setCurrentState(unsigned nodeStatus)
{
    currentState_ = StateLabels[nodeStatus];
    return true;
}

bool Sensor::setOperationalStatus(unsigned nodeStatus)
{
    operationalStatus_.append(OperationalStatuses[nodeStatus]);
    return true;
}

bool Sensor::setPossibleStates(std::vector<unsigned> nodeStatuses)
{
    possibleStates_.clear();
    for (const unsigned status : nodeStatuses)
        possibleStates_.append(StateLabels[status]);
    return true;
}

bool Sensor::storeScaled(std::int32_t& field, double value) const
{
    field = truncated(static_cast<long double>(value) * readingMultiplier_);
    return true;
}

bool Sensor::setCurrentReading(double value)
{
    return storeScaled(currentReading_, value);
}

bool Sensor::setLowerThresholdNonCritical(double value)
{
    return storeScaled(lowerThresholdNonCritical_, value);
}

bool Sensor::setUpperThresholdNonCritical(double value)
{
    return storeScaled(upperThresholdNonCritical_, value);
}

bool Sensor::setLowerThresholdCritical(double value)
{
    return storeScaled(lowerThresholdCritical_, value);
}

bool Sensor::setUpperThresholdCritical(double value)
{
    return storeScaled(upperThresholdCritical_, value);
}

bool Sensor::setLowerThresholdFatal(double value)
{
    return storeScaled(lowerThresholdFatal_, value);
}

bool Sensor::setUpperThresholdFatal(double value)
{
    return storeScaled(upperThresholdFatal_, value);
}

} // namespace Vorn::SensorProfileProvider
