// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorElementCapabilities, for a broker that injects faults.

#pragma once

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/RequestTrace.h"

#include <string>

namespace Testing::ElementCapabilities {

inline constexpr const char* Class = "ZUMLO_SensorElementCapabilities";
inline constexpr const char* Provider = "SensorElementCapabilitiesProvider";

inline const RequestKinds Kinds = {SensorElementCapabilitiesProvider_Create_InstanceMI,
    SensorElementCapabilitiesProvider_Create_AssociationMI};
inline const SourceMaker Keyless = pathMaker(Class);
inline const SourceMaker Sensor = sensorMaker("B:/2");
inline const SourceMaker Capabilities =
    pathMaker(CapabilitiesClass, "InstanceID", "ZUMLO:SensorEnabledLogicalElementCap1");

inline const RequestKind Names = Kinds.names(Keyless);
inline const RequestKind Instances = Kinds.instances(Keyless);
inline const RequestKind OneInstance = Kinds.one(
    "oneInstance", pairMaker(Class, "ManagedElement", Sensor, "Capabilities", Capabilities));
inline const AssociationRequests FromSensor = Kinds.along("Sensor", Sensor);
inline const AssociationRequests FromCapabilities = Kinds.along("Capabilities", Capabilities);

class ElementCapabilitiesFaultTest : public AssociationFaultTest {
protected:
    ElementCapabilitiesFaultTest() : AssociationFaultTest({}) {}

    static HandlerLines handler(const std::string& function)
    {
        return {"SensorElementCapabilities", Provider, function};
    }
};

} // namespace Testing::ElementCapabilities
