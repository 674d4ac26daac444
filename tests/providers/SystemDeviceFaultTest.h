// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorSystemDevice, for a broker that injects faults.

#pragma once

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/RequestTrace.h"

#include <string>

namespace Testing::SystemDevice {

inline constexpr const char* Class = "ZUMLO_SensorSystemDevice";
inline constexpr const char* Provider = "SensorSystemDeviceProvider";

inline const RequestKinds Kinds = {
    SensorSystemDeviceProvider_Create_InstanceMI, SensorSystemDeviceProvider_Create_AssociationMI};
inline const SourceMaker Keyless = pathMaker(Class);
inline const SourceMaker Sensor = sensorMaker("B:/2");
inline const SourceMaker System = [](const Host::Request&) -> Host::ObjectPath& {
    return ComputerSystems({}).pathTo("host");
};

inline const RequestKind Names = Kinds.names(Keyless);
inline const RequestKind Instances = Kinds.instances(Keyless);
inline const RequestKind OneInstance =
    Kinds.one("oneInstance", pairMaker(Class, "GroupComponent", System, "PartComponent", Sensor));
inline const AssociationRequests FromSensor = Kinds.along("Sensor", Sensor);
inline const AssociationRequests FromSystem = Kinds.along("System", System);
inline const std::string Requests[] = {
    "Associators", "AssociatorNames", "References", "ReferenceNames"};

class SystemDeviceFaultTest : public AssociationFaultTest {
protected:
    SystemDeviceFaultTest() : AssociationFaultTest({"host", "guest"}) {}

    static HandlerLines handler(const std::string& request)
    {
        return {"SenosrSystemDeviceProvider", Provider, "SensorSystemDevice_" + request};
    }

    static std::size_t countOf(const FaultyRequest& request)
    {
        EXPECT_EQ(request.answer.refused(), 0U);
        return request.answer.paths().size() + request.answer.instances().size();
    }
};

} // namespace Testing::SystemDevice
