// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorSystemDevice, for a broker that injects faults.

#pragma once

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/RequestTrace.h"

#include <string>

namespace Testing::SystemDevice {

inline constexpr const char* Class = "ZUMLO_SensorSystemDevice";
inline constexpr const char* provider = "SensorSystemDeviceProvider";

inline const RequestKinds kinds = {
    SensorSystemDeviceProvider_Create_InstanceMI, SensorSystemDeviceProvider_Create_AssociationMI};
inline const SourceMaker keylessSource = pathMaker(Class);
inline const SourceMaker sensorSource = sensorMaker("B:/2");
inline const SourceMaker systemSource = [](const Host::Request&) -> Host::ObjectPath& {
    return ComputerSystems({}).pathTo("host");
};

inline const RequestKind nameRequest = kinds.names(keylessSource);
inline const RequestKind instanceRequest = kinds.instances(keylessSource);
inline const RequestKind oneInstance = kinds.one(
    "oneInstance", pairMaker(Class, "GroupComponent", systemSource, "PartComponent", sensorSource));
inline const AssociationRequests requestsFromSensor = kinds.along("Sensor", sensorSource);
inline const AssociationRequests requestsFromSystem = kinds.along("System", systemSource);
inline const std::string requests[] = {
    "Associators", "AssociatorNames", "References", "ReferenceNames"};

class SystemDeviceFaultTest : public AssociationFaultTest {
protected:
    SystemDeviceFaultTest() : AssociationFaultTest({"host", "guest"}) {}

    static HandlerLines handler(const std::string& request)
    {
        return {"SenosrSystemDeviceProvider", provider, "SensorSystemDevice_" + request};
    }

    static std::size_t countOf(const FaultyRequest& request)
    {
        EXPECT_EQ(request.answer.refused(), 0U);
        return request.answer.paths().size() + request.answer.instances().size();
    }
};

} // namespace Testing::SystemDevice
