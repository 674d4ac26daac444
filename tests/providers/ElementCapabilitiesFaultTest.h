// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorElementCapabilities, for a broker that injects faults.

#pragma once

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/RequestTrace.h"

#include <string>

namespace Testing::ElementCapabilities {

inline constexpr const char* Class = "ZUMLO_SensorElementCapabilities";
inline constexpr const char* provider = "SensorElementCapabilitiesProvider";

inline const RequestKinds kinds = {SensorElementCapabilitiesProvider_Create_InstanceMI,
    SensorElementCapabilitiesProvider_Create_AssociationMI};
inline const SourceMaker keylessSource = pathMaker(Class);
inline const SourceMaker sensorSource = sensorMaker("B:/2");
inline const SourceMaker capabilitiesSource =
    pathMaker(CapabilitiesClass, "InstanceID", "ZUMLO:SensorEnabledLogicalElementCap1");

inline const RequestKind nameRequest = kinds.names(keylessSource);
inline const RequestKind instanceRequest = kinds.instances(keylessSource);
inline const RequestKind oneInstance = kinds.one("oneInstance",
    pairMaker(Class, "ManagedElement", sensorSource, "Capabilities", capabilitiesSource));
inline const AssociationRequests requestsFromSensor = kinds.along("Sensor", sensorSource);
inline const AssociationRequests requestsFromCapabilities =
    kinds.along("Capabilities", capabilitiesSource);

class ElementCapabilitiesFaultTest : public AssociationFaultTest {
protected:
    ElementCapabilitiesFaultTest() : AssociationFaultTest({}) {}

    static HandlerLines handler(const std::string& function)
    {
        return {"SensorElementCapabilities", provider, function};
    }
};

} // namespace Testing::ElementCapabilities
