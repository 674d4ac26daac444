// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A record that refuses the value that a test names. It replaces the real one, most of whose
// setters accept every value.

#include "tests/model/RefusingSensor.h"

#include "model/Sensor.h"

namespace Testing {

std::string refusedSetter;
std::vector<std::string> setterCalls;

namespace {

bool accepts(const char* setter)
{
    setterCalls.emplace_back(setter);
    return refusedSetter != setter;
}

} // namespace

} // namespace Testing

namespace Vorn::SensorProfileProvider {

using Testing::accepts;

bool Sensor::setDeviceID(std::string)
{
    return accepts("setDeviceID");
}
bool Sensor::setElementName(std::string)
{
    return accepts("setElementName");
}
bool Sensor::setSensorType(unsigned)
{
    return accepts("setSensorType");
}
bool Sensor::setCurrentState(unsigned)
{
    return accepts("setCurrentState");
}
bool Sensor::setEnabledState(unsigned)
{
    return accepts("setEnabledState");
}
bool Sensor::setOperationalStatus(unsigned)
{
    return accepts("setOperationalStatus");
}
bool Sensor::setHealthState(unsigned)
{
    return accepts("setHealthState");
}
bool Sensor::setRequestedState(unsigned code)
{
    return accepts(code == 1 ? "setRequestedState" : "setRequestedState of another code");
}
bool Sensor::setPossibleStates(const std::vector<unsigned>&)
{
    return accepts("setPossibleStates");
}
bool Sensor::setCurrentReading(double)
{
    return accepts("setCurrentReading");
}
bool Sensor::setLowerThresholdNonCritical(double)
{
    return accepts("setLowerThresholdNonCritical");
}
bool Sensor::setUpperThresholdNonCritical(double)
{
    return accepts("setUpperThresholdNonCritical");
}
bool Sensor::setLowerThresholdCritical(double)
{
    return accepts("setLowerThresholdCritical");
}
bool Sensor::setUpperThresholdCritical(double)
{
    return accepts("setUpperThresholdCritical");
}
bool Sensor::setLowerThresholdFatal(double)
{
    return accepts("setLowerThresholdFatal");
}
bool Sensor::setUpperThresholdFatal(double)
{
    return accepts("setUpperThresholdFatal");
}
bool Sensor::setBaseUnits(unsigned)
{
    return accepts("setBaseUnits");
}

} // namespace Vorn::SensorProfileProvider
