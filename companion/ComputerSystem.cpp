// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystem.h"

#include "companion/SingleInstance.h"

#include <systemd/sd-id128.h>

#include <array>
#include <cstdint>

namespace Vorn::Companion {

namespace {

// Identifies this provider in the hash. It never changes, or every machine would get a new
// identifier.
constexpr sd_id128_t application = {{0xb3, 0xdf, 0xdc, 0xbb, 0x7a, 0x28, 0x45, 0xc0, 0xb6, 0x17,
    0x6d, 0xa2, 0x1f, 0x2a, 0x76, 0x2d}};

// Returns the machine's identifier for this provider as the text of a UUID: by machine-id(5), the
// identifier itself is confidential. There is none before a first boot is complete.
std::optional<std::string> machineId()
{
    sd_id128_t identifier{};
    if (::sd_id128_get_machine_app_specific(application, &identifier) < 0)
        return std::nullopt;
    std::array<char, SD_ID128_UUID_STRING_MAX> text{};
    return ::sd_id128_to_uuid_string(identifier, text.data());
}

constexpr const char* creationClassNameKey = "CreationClassName";
constexpr const char* nameKey = "Name";

// Codes of the DMTF value maps.
constexpr std::uint16_t enabled = 2;        // CIM_EnabledLogicalElement.EnabledState
constexpr std::uint16_t notApplicable = 12; // .RequestedState: nobody can request one here
constexpr std::uint16_t healthy = 5;        // CIM_ManagedSystemElement.HealthState
constexpr std::uint16_t ok = 2;             // .OperationalStatus
constexpr std::uint16_t notDedicated = 0;   // CIM_ComputerSystem.Dedicated

// The kernel's host name is none of the kinds of names that the value map of NameFormat lists.
constexpr const char* hostNameFormat = "Other";

void setIdentity(
    const CMPIBroker* broker, const CMPIInstance* instance, const ComputerSystem& system)
{
    setText(instance, "NameFormat", hostNameFormat);
    setText(instance, "ElementName", system.name.c_str());
    setText(instance, "Caption", "Computer System");
    setText(instance, "Description", "The computer that the sensors of this system belong to.");
    if (!system.machineId)
        return;
    setTexts(broker, instance, "OtherIdentifyingInfo", system.machineId->c_str());
    setTexts(
        broker, instance, "IdentifyingDescriptions", "Hash of the operating system's machine ID");
}

void setState(const CMPIBroker* broker, const CMPIInstance* instance)
{
    setCodes(broker, instance, "Dedicated", notDedicated);
    setCode(instance, "EnabledState", enabled);
    setCode(instance, "RequestedState", notApplicable);
    setCode(instance, "HealthState", healthy);
    setCodes(broker, instance, "OperationalStatus", ok);
}

struct ThisComputer {
    static constexpr const char* provider = "instanceComputerSystemProvider";
    static constexpr const char* notFound = "no such computer system";

    CMPIObjectPath* path(const CMPIBroker* broker, const char* nameSpace) const
    {
        return makeSystemPath(broker, nameSpace, system);
    }

    CMPIInstance* instance(
        const CMPIBroker* broker, const CMPIObjectPath* path, const char** properties) const
    {
        return makeSystemInstance(broker, path, system, properties);
    }

    ComputerSystem system = thisComputerSystem();
};

} // namespace

ComputerSystem thisComputerSystem()
{
    return {getSystemName(), machineId()};
}

CMPIObjectPath* makeSystemPath(
    const CMPIBroker* broker, const char* nameSpace, const ComputerSystem& system)
{
    CMPIObjectPath* const path = newPathIn(broker, nameSpace, ComputerSystemClass, system.name);
    const bool isWhole = addKey(path, creationClassNameKey, ComputerSystemClass) &&
                         addKey(path, nameKey, system.name.c_str()) && isUsable(path);
    return isWhole ? path : nullptr;
}

CMPIInstance* makeSystemInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
    const ComputerSystem& system, const char** properties)
{
    CMPIInstance* const instance = CMNewInstance(broker, path, nullptr);
    if (!isUsable(instance))
        return nullptr;
    std::array<const char*, 3> keys = {creationClassNameKey, nameKey, nullptr};
    CMSetPropertyFilter(instance, properties, keys.data());
    if (!setText(instance, creationClassNameKey, ComputerSystemClass) ||
        !setText(instance, nameKey, system.name.c_str()))
        return nullptr;
    setIdentity(broker, instance, system);
    setState(broker, instance);
    return isUsable(instance) ? instance : nullptr;
}

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI* ComputerSystemProvider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    return SingleInstanceProvider<ThisComputer>::create(broker, status);
}

} // namespace Vorn::Companion
