// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystemObjects.h"

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

const char* nameSpaceOf(const CMPIObjectPath* ref)
{
    const CMPIString* const nameSpace = isUsable(ref) ? CMGetNameSpace(ref, nullptr) : nullptr;
    // The slot itself: header sets differ in the convenience function's arguments.
    return isUsable(nameSpace) ? nameSpace->ft->getCharPtr(nameSpace, nullptr) : nullptr;
}

// Any call of the broker may return an unusable object: each is tested before each use. An object
// manager may copy a whole CMPIValue from the address it is passed, whatever the type: all but
// texts are such values.

bool addKey(const CMPIObjectPath* path, const char* name, const char* text)
{
    return isUsable(path) && CMAddKey(path, name, text, CMPI_chars).rc == CMPI_RC_OK;
}

bool setText(const CMPIInstance* instance, const char* name, const char* text)
{
    return isUsable(instance) && CMSetProperty(instance, name, text, CMPI_chars).rc == CMPI_RC_OK;
}

void setCode(const CMPIInstance* instance, const char* name, std::uint16_t code)
{
    const CMPIValue value = {.uint16 = code};
    if (isUsable(instance))
        CMSetProperty(instance, name, &value, CMPI_uint16);
}

// Sets an array of one element; the property is left out when the broker fails to make the array.
void setList(const CMPIBroker* broker, const CMPIInstance* instance, const char* name,
    const CMPIValue& element, CMPIType type)
{
    CMPIArray* const array = CMNewArray(broker, 1, type, nullptr);
    if (!isUsable(array))
        return;
    const CMPIStatus set = CMSetArrayElementAt(array, 0, &element, type);
    const CMPIValue value = {.array = array};
    if (set.rc == CMPI_RC_OK && isUsable(array) && isUsable(instance))
        CMSetProperty(instance, name, &value, static_cast<CMPIType>(type | CMPI_ARRAY));
}

void setCodes(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, std::uint16_t code)
{
    setList(broker, instance, name, {.uint16 = code}, CMPI_uint16);
}

void setTexts(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, const char* text)
{
    CMPIString* const string = CMNewString(broker, text, nullptr);
    if (isUsable(string))
        setList(broker, instance, name, {.string = string}, CMPI_string);
}

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
    const char* const nameSpace = nameSpaceOf(ref);
    if (nameSpace == nullptr)
        return nullptr;
    CMPIObjectPath* const path = CMNewObjectPath(broker, nameSpace, ComputerSystemClass, nullptr);
    if (!isUsable(path))
        return nullptr;
    CMSetHostname(path, system.name.c_str());
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
