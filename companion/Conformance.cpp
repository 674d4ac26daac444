// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/Conformance.h"

#include "companion/BrokerObjects.h"
#include "companion/RegisteredProfile.h"
#include "platform/utilities/KeyValue.h"
#include "platform/utilities/ProviderUtilities.h"

#include <cmpimacs.h>

#include <algorithm>
#include <array>
#include <set>

namespace Vorn::Companion {

namespace {

// Object managers have the registrations of profiles, and CIM_Namespace, in one of these.
constexpr std::array interopNamespaces = {"root/interop", "root/PG_InterOp"};

// Returns null where the object manager serves no registration.
const CMPIObjectPath* registeredProfile(const ProviderUpcalls& upcalls)
{
    for (const char* const nameSpace : interopNamespaces)
        if (const auto paths = upcalls.names(nameSpace, RegisteredProfileClass); !paths.empty())
            return paths.front();
    return nullptr;
}

std::set<std::string> nameSpacesBeside(
    const ProviderUpcalls& upcalls, const CMPIObjectPath* profile)
{
    std::set<std::string> names;
    const char* const interop = nameSpaceOf(profile);
    if (interop == nullptr)
        return names;
    for (const CMPIObjectPath* const path : upcalls.names(interop, "CIM_Namespace")) {
        const KeyValue name = keyValue(CMGetKey(path, "Name", nullptr));
        if (const auto* const text = std::get_if<std::string_view>(&name))
            names.emplace(*text);
    }
    return names;
}

} // namespace

Conformance wholeConformance(const ProviderUpcalls& upcalls)
{
    Conformance whole = {registeredProfile(upcalls), {}};
    for (const std::string& nameSpace : nameSpacesBeside(upcalls, whole.profile))
        for (CMPIObjectPath* const sensor : upcalls.names(nameSpace, SensorClass))
            whole.sensors.push_back(sensor);
    return whole;
}

Conformance conformanceOf(const ProviderUpcalls& upcalls, const CMPIObjectPath* object)
{
    if (isOfClass(object, RegisteredProfileClass)) {
        Conformance whole = wholeConformance(upcalls);
        return isObjPathsEqual(whole.profile, object, false) ? whole : Conformance();
    }
    const char* const nameSpace = nameSpaceOf(object);
    if (!isOfClass(object, SensorClass) || nameSpace == nullptr)
        return {};
    Conformance one = {registeredProfile(upcalls), {}};
    if (one.profile == nullptr)
        return {};
    one.sensors = upcalls.names(nameSpace, SensorClass);
    std::erase_if(one.sensors,
        [&](const CMPIObjectPath* sensor) { return !isObjPathsEqual(sensor, object, false); });
    return one;
}

std::vector<CMPIInstance*> conformingSensors(
    const ProviderUpcalls& upcalls, const CMPIObjectPath* object, const char** properties)
{
    std::vector<CMPIInstance*> all;
    const CMPIObjectPath* const profile = registeredProfile(upcalls);
    if (!isObjPathsEqual(profile, object, false))
        return all;
    for (const std::string& nameSpace : nameSpacesBeside(upcalls, profile))
        for (CMPIInstance* const sensor : upcalls.instances(nameSpace, SensorClass, properties))
            all.push_back(sensor);
    return all;
}

} // namespace Vorn::Companion
