// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystemObjects.h"

#include "companion/BrokerObjects.h"

#include <cmpimacs.h>

#include <array>
#include <cstdint>

namespace Vorn::Companion {

namespace {

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

} // namespace

CMPIObjectPath* makePath(
    const CMPIBroker* broker, const CMPIObjectPath* ref, const ComputerSystem& system)
{
    CMPIObjectPath* const path =
        newPathIn(broker, nameSpaceOf(ref), ComputerSystemClass, system.name);
    const bool isWhole = addKey(path, creationClassNameKey, ComputerSystemClass) &&
                         addKey(path, nameKey, system.name.c_str()) && isUsable(path);
    return isWhole ? path : nullptr;
}

CMPIInstance* makeInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
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

} // namespace Vorn::Companion
