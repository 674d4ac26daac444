// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/Differences.h"

#include "tests/objectmanagers/ClientRequestKinds.h"
#include "tests/support/Texts.h"

#include <array>
#include <set>
#include <sstream>

namespace Testing {

namespace {

using Result = std::optional<Equivalent>;

// ---- Both

// Returns a request for each association of a sensor: `ours` by ZUMLO_SensorSystemDevice, which is
// the first, and by ZUMLO_SensorElementCapabilities, `conforming` by that with the profile.
Equivalent byEachAssociation(ClientRequest ours, ClientRequest conforming)
{
    ClientRequest one = ours;
    one.association = systemDevice;
    ours.association = elementCapabilities;
    conforming.association = conformance;
    return {.requests = {one, ours, conforming}};
}

Result withoutRoles(const ClientRequest& request)
{
    if ((request.role.empty() && request.resultRole.empty()) || isConformance(request))
        return std::nullopt;
    ClientRequest other = request;
    other.role = other.resultRole = "";
    if (!request.association.empty() || !isFromSensor(request))
        return Equivalent{.requests = {other}};
    return byEachAssociation(other, request);
}

bool hasKnownResultClass(const ClientRequest& request)
{
    return !request.resultClass.empty() && request.resultClass != "No_Class";
}

Result askingEach(const ClientRequest& request)
{
    if (!request.isAssociators() || !request.association.empty() || !hasKnownResultClass(request))
        return std::nullopt;
    return byEachAssociation(request, request);
}

Result withoutResultClass(const ClientRequest& request)
{
    if (!isElementCapabilities(request) || !hasKnownResultClass(request))
        return std::nullopt;
    ClientRequest other = request;
    other.resultClass = "";
    return Equivalent{.requests = {other}};
}

Result withExactResultClass(const ClientRequest& request)
{
    if (!isSystemDevice(request) || !hasKnownResultClass(request) ||
        isOneOf(request.resultClass, {"ZUMLO_NumericSensor", "ZUMLO_ComputerSystem"}))
        return std::nullopt;
    return Equivalent{};
}

std::string classOf(const std::string& path)
{
    const std::string whole = path.substr(0, path.find('.'));
    return whole.substr(whole.rfind(':') + 1);
}

std::vector<std::string> namesIn(const std::string& list)
{
    std::vector<std::string> names;
    std::istringstream stream(list);
    for (std::string name; std::getline(stream, name, ',');)
        names.push_back(name);
    return names;
}

bool isWanted(const ClientRequest& request, const std::string& property)
{
    const std::vector<std::string> names = namesIn(request.properties);
    if (names.empty())
        return !request.hasEmptyList;
    return std::any_of(names.begin(), names.end(),
        [&](const std::string& name) { return isSame(name, property); });
}

void addUnset(const ClientRequest& request, const Declarations& declarations, Answer& answer)
{
    if (request.operation.ends_with('n') || answer.error != 0)
        return;
    if (request.operation == "gp") {
        const Properties& declared = declarations.at(classOf(request.object));
        const auto found = declared.find(request.properties);
        if (answer.objects.empty() && found != declared.end() && found->second)
            answer.objects.emplace(
                found->second->substr(found->second->find(' ') + 1), Properties());
        return;
    }
    for (auto& [path, properties] : answer.objects)
        for (const auto& [name, value] : declarations.at(classOf(path)))
            if (isWanted(request, name) && !properties[name])
                properties[name] = value;
}

// The sensors' provider compares names as they are written.
void dropOtherSpellings(
    const ClientRequest& request, const Declarations& declarations, Answer& answer)
{
    const std::vector<std::string> names = namesIn(request.properties);
    if (request.operation == "gp" && isFromSensor(request) &&
        !declarations.at("ZUMLO_NumericSensor").contains(request.properties))
        answer.objects.clear();
    for (auto& [path, properties] : answer.objects)
        if (classOf(path) == "ZUMLO_NumericSensor" && !names.empty())
            for (auto& [name, value] : properties)
                if (std::find(names.begin(), names.end(), name) == names.end())
                    value.reset();
}

Result notDeletingFromUnknownClasses(const ClientRequest& request)
{
    if (request.operation != "di" || !isFrom(request, "No_Class"))
        return std::nullopt;
    return Equivalent{.error = 5};
}

// ---- OpenPegasus

Result withoutValueOfUnknownSensors(const ClientRequest& request)
{
    if (request.operation != "gp" || request.object.find("no such ") == std::string::npos)
        return std::nullopt;
    return Equivalent{};
}

Result refusingUnknownClasses(const ClientRequest& request)
{
    if (isOnAssociations(request) &&
        (request.association == "No_Class" || isFrom(request, "No_Class")))
        return Equivalent{.error = 4};
    return std::nullopt;
}

void renameInterop(const ClientRequest&, const Declarations&, Answer& answer)
{
    const auto renamed = [](const std::string& text) {
        return replaced(text, "root/interop:", "root/PG_InterOp:");
    };
    Answer changed;
    for (auto& [path, properties] : answer.objects) {
        for (auto& [name, value] : properties)
            if (value)
                value = renamed(*value);
        changed.objects.emplace(renamed(path), properties);
    }
    answer.objects = changed.objects;
}

// ---- sfcb

Result withoutSingleProperties(const ClientRequest& request)
{
    if ((request.operation != "gp" && request.operation != "sp") || isFrom(request, "No_Class"))
        return std::nullopt;
    return Equivalent{.error = 1};
}

Result withoutEmptyList(const ClientRequest& request)
{
    if (!request.hasEmptyList)
        return std::nullopt;
    ClientRequest other = request;
    other.hasEmptyList = false;
    return Equivalent{.requests = {other}};
}

Result notFindingAssociations(const ClientRequest& request)
{
    if (request.association == "No_Class")
        return Equivalent{.error = 6};
    return std::nullopt;
}

Result withoutMethods(const ClientRequest& request)
{
    if (request.operation != "cm" || isFrom(request, "No_Class"))
        return std::nullopt;
    return Equivalent{.error = 1};
}

Result withAnyResultClass(const ClientRequest& request)
{
    if (request.resultClass != "No_Class")
        return std::nullopt;
    ClientRequest other = request;
    other.resultClass = systemDevice;
    return Equivalent{.requests = {other}};
}

Result withoutPropertyList(const ClientRequest& request)
{
    if (!request.isReferences() || request.properties.empty() || isConformance(request))
        return std::nullopt;
    ClientRequest other = request;
    other.properties = "";
    if (!request.association.empty() || !isFromSensor(request))
        return Equivalent{.requests = {other}};
    return byEachAssociation(other, request);
}

Result withWholeSystems(const ClientRequest& request)
{
    if (!request.isAssociators() || !isFromSensor(request) || !request.association.empty() ||
        request.properties.empty())
        return std::nullopt;
    Equivalent each = byEachAssociation(request, request);
    each.requests.front().properties = "";
    return each;
}

Result needingTheAssociation(const ClientRequest& request)
{
    const bool isKnown =
        isFromSensor(request) || (isFromCapabilities(request) && request.isAssociators());
    if (!isOnAssociations(request) || !request.association.empty() || isKnown)
        return std::nullopt;
    return Equivalent{.error = 1};
}

Result needingTheExactAssociation(const ClientRequest& request)
{
    if (!request.isAssociators() || request.association.empty() ||
        request.association == systemDevice || request.association == elementCapabilities ||
        isConformance(request))
        return std::nullopt;
    return Equivalent{.error = isSystemDevice(request) ? 0 : 1};
}

Result refusingOtherSources(const ClientRequest& request)
{
    if ((isElementCapabilities(request) && isFromSystem(request)) ||
        (isSystemDevice(request) && request.isReferences() && isFromCapabilities(request)))
        return Equivalent{.error = 1};
    return std::nullopt;
}

Result notFindingPartialAssociations(const ClientRequest& request)
{
    if (request.operation != "gi" || !isFrom(request, elementCapabilities) ||
        request.properties.empty() ||
        (isWanted(request, "Capabilities") && isWanted(request, "ManagedElement")))
        return std::nullopt;
    return Equivalent{.error = 6};
}

void spellAsTheClient(const ClientRequest& request, const Declarations&, Answer& answer)
{
    if (!request.isReferences() || request.object.find("deviceid=") == std::string::npos)
        return;
    Answer changed;
    for (const auto& [path, properties] : answer.objects) {
        if (classOf(path) == conformance) {
            changed.objects.emplace(path, properties);
            continue;
        }
        Properties ends = properties;
        for (auto& [name, end] : ends)
            if (end)
                end = replaced(*end, "DeviceID=", "deviceid=");
        changed.objects.emplace(replaced(path, "DeviceID=", "deviceid="), ends);
    }
    answer = changed;
}

void dropUnwantedKeys(const ClientRequest& request, const Declarations&, Answer& answer)
{
    if (request.operation != "ei" || request.properties.empty() ||
        request.object != elementCapabilities)
        return;
    Answer changed;
    for (const auto& [path, properties] : answer.objects) {
        std::string keys;
        const std::size_t second = path.find(",ManagedElement=");
        if (isWanted(request, "Capabilities"))
            keys += path.substr(path.find('.'), second - path.find('.'));
        if (isWanted(request, "ManagedElement"))
            keys += (keys.empty() ? "." : ",") + path.substr(second + 1);
        changed.objects.emplace(elementCapabilities + keys, properties);
    }
    answer = changed;
}

constexpr std::array ofOpenPegasus = {
    Difference{"code 4 for an unknown class of the association or of the source",
        refusingUnknownClasses, nullptr},
    Difference{"code 5 for deleting an instance of an unknown class", notDeletingFromUnknownClasses,
        nullptr},
    Difference{"a property of a sensor that does not exist is NULL", withoutValueOfUnknownSensors,
        nullptr},
    Difference{"registered profiles are in root/PG_InterOp", nullptr, renameInterop},
    Difference{"sensors' associations do not apply roles", withoutRoles, nullptr},
    Difference{"without association class, each association is asked", askingEach, nullptr},
    Difference{"ZUMLO_SensorElementCapabilities does not apply a result class", withoutResultClass,
        nullptr},
    Difference{"ZUMLO_SensorSystemDevice applies a result class by its exact name",
        withExactResultClass, nullptr},
    Difference{"property names of sensors count as they are spelt", nullptr, dropOtherSpellings},
    Difference{"what is not set is NULL, or has the default of its class", nullptr, addUnset},
};

constexpr std::array ofSfcb = {
    Difference{"code 6 for an unknown class of the association", notFindingAssociations, nullptr},
    Difference{"sensors' associations do not apply roles", withoutRoles, nullptr},
    Difference{"code 1 for methods", withoutMethods, nullptr},
    Difference{"code 1 for a single property", withoutSingleProperties, nullptr},
    Difference{"code 5 for deleting an instance of an unknown class", notDeletingFromUnknownClasses,
        nullptr},
    Difference{"an empty property list counts as none", withoutEmptyList, nullptr},
    Difference{
        "an unknown result class is as good as one of other objects", withAnyResultClass, nullptr},
    Difference{"references by sensors' associations do not apply a property list",
        withoutPropertyList, nullptr},
    Difference{
        "systems that associators lead to do not apply a property list", withWholeSystems, nullptr},
    Difference{"without association class, code 1 from systems and capabilities",
        needingTheAssociation, nullptr},
    Difference{"without association class, each association is asked", askingEach, nullptr},
    Difference{"associators take no superclass and no other spelling of the association",
        needingTheExactAssociation, nullptr},
    Difference{"code 1 from a source to which the association does not refer", refusingOtherSources,
        nullptr},
    Difference{"ZUMLO_SensorElementCapabilities does not apply a result class", withoutResultClass,
        nullptr},
    Difference{"ZUMLO_SensorSystemDevice applies a result class by its exact name",
        withExactResultClass, nullptr},
    Difference{"ZUMLO_SensorElementCapabilities is not found by a list without both its ends",
        notFindingPartialAssociations, nullptr},
    Difference{
        "references spell the keys of the source as the client does", nullptr, spellAsTheClient},
    Difference{"ZUMLO_SensorElementCapabilities has no keys but those in the list", nullptr,
        dropUnwantedKeys},
    Difference{"property names of sensors count as they are spelt", nullptr, dropOtherSpellings},
    Difference{"what is not set is NULL, or has the default of its class", nullptr, addUnset},
};

} // namespace

std::span<const Difference> differencesOfOpenPegasus()
{
    return ofOpenPegasus;
}

std::span<const Difference> differencesOfSfcb()
{
    return ofSfcb;
}

} // namespace Testing
