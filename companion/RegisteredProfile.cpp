// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/RegisteredProfile.h"

#include "companion/SingleInstance.h"

#include <array>

namespace Vorn::Companion {

namespace {

constexpr const char* instanceIdKey = "InstanceID";
constexpr const char* instanceId = "ZUMLO:DSP1009";

constexpr const char* profileName = "Sensors";
constexpr const char* profileVersion = "1.0.2"; // the one that the served classes follow

// Codes of the DMTF value maps of CIM_RegisteredProfile.
constexpr std::uint16_t dmtf = 2;          // RegisteredOrganization
constexpr std::uint16_t notAdvertised = 2; // AdvertiseTypes: clients enumerate the class

struct SensorsProfile {
    static constexpr const char* provider = "instanceSensorRegisteredProfileProvider";
    static constexpr const char* notFound = "no such registered profile";

    static constexpr auto path = makeProfilePath;
    static constexpr auto instance = makeProfileInstance;
};

} // namespace

CMPIObjectPath* makeProfilePath(const CMPIBroker* broker, const char* nameSpace)
{
    CMPIObjectPath* const path =
        newPathIn(broker, nameSpace, RegisteredProfileClass, getSystemName());
    return addKey(path, instanceIdKey, instanceId) && isUsable(path) ? path : nullptr;
}

CMPIInstance* makeProfileInstance(
    const CMPIBroker* broker, const CMPIObjectPath* path, const char** properties)
{
    CMPIInstance* const instance = CMNewInstance(broker, path, nullptr);
    if (!isUsable(instance))
        return nullptr;
    std::array<const char*, 2> keys = {instanceIdKey, nullptr};
    CMSetPropertyFilter(instance, properties, keys.data());
    if (!setText(instance, instanceIdKey, instanceId))
        return nullptr;
    setText(instance, "ElementName", profileName);
    setCode(instance, "RegisteredOrganization", dmtf);
    setText(instance, "RegisteredName", profileName);
    setText(instance, "RegisteredVersion", profileVersion);
    setCodes(broker, instance, "AdvertiseTypes", notAdvertised);
    return isUsable(instance) ? instance : nullptr;
}

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI*
SensorRegisteredProfileProvider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    return SingleInstanceProvider<SensorsProfile>::create(broker, status);
}

} // namespace Vorn::Companion
