// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Finds the registration of the profile and the sensors that conform to it, by up-calls: the
// sensors may be registered in any namespace, and object managers differ in that of the
// registration.

#pragma once

#include "companion/ProviderUpcalls.h"

namespace Vorn::Companion {

inline constexpr const char* SensorClass = "ZUMLO_NumericSensor";

// A registration and sensors that conform to it: one association for each sensor.
struct Conformance {
    const CMPIObjectPath* profile = nullptr; // never null where there are sensors
    std::vector<CMPIObjectPath*> sensors;
};

// Returns the registration with all sensors.
Conformance wholeConformance(const ProviderUpcalls& upcalls);

// Returns the registration with the sensors whose associations refer to the object: all for the
// registration itself, the object alone for a sensor that exists, none for any other object.
Conformance conformanceOf(const ProviderUpcalls& upcalls, const CMPIObjectPath* object);

// Returns the instances of all sensors when the object is the registration, none for any other
// object. The list of properties ends with a null and is null for all properties.
std::vector<CMPIInstance*> conformingSensors(
    const ProviderUpcalls& upcalls, const CMPIObjectPath* object, const char** properties);

} // namespace Vorn::Companion
