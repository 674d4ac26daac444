// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/ClientRequest.h"
#include "tests/support/Texts.h"

#include <utility>

namespace Testing {

namespace {

using Texts = std::vector<std::string>;

const Texts instanceClasses = {
    "ZUMLO_NumericSensor", "ZUMLO_ComputerSystem", "ZUMLO_SensorEnabledLogicalElementCapabilities"};
const std::string profile = "ZUMLO_SensorRegisteredProfile";
const Texts associationClasses = {"ZUMLO_SensorSystemDevice", "ZUMLO_SensorElementCapabilities"};
const Texts enumeratedClasses = {"CIM_NumericSensor", "CIM_Sensor",
    "CIM_EnabledLogicalElementCapabilities", "CIM_SystemDevice", "CIM_ElementCapabilities",
    "zumlo_numericsensor", "zumlo_SENSORsystemdevice", "ZUMLO_SensorElementConformsToProfile",
    "CIM_ElementConformsToProfile", "No_Class"};

// Each is asked for alone or with others, in its own spelling or another one.
const Texts propertyLists = {"Caption", "caption", "Status", "HealthState,Status",
    "Name,ElementName,HealthState", "InstallDate", "EnabledDefault",
    "UpperThresholdFatal,CurrentReading", "No_Property", "CreationClassName,DeviceID"};
const Texts endLists = {"GroupComponent", "groupcomponent", "GroupComponent,PartComponent",
    "ManagedElement", "capabilities", "Capabilities,ManagedElement", "Characteristics",
    "No_Property"};

const Texts associations = {"", "ZUMLO_SensorSystemDevice", "ZUMLO_SensorElementCapabilities",
    "ZUMLO_SensorElementConformsToProfile", "CIM_SystemDevice", "CIM_ElementCapabilities",
    "CIM_ElementConformsToProfile", "CIM_Component", "zumlo_sensorsystemdevice", "No_Class"};
const Texts resultClasses = {"", "ZUMLO_NumericSensor", "ZUMLO_ComputerSystem",
    "ZUMLO_SensorEnabledLogicalElementCapabilities", "CIM_System", "CIM_Sensor",
    "CIM_ManagedElement", "zumlo_computersystem", "No_Class"};
const std::vector<std::pair<std::string, std::string>> roles = {{"PartComponent", ""},
    {"GroupComponent", ""}, {"", "PartComponent"}, {"", "Capabilities"},
    {"managedelement", "Capabilities"}, {"PartComponent", "groupcomponent"}};

// Each object manager refuses them, and answers what follows as if they had not been sent.
// Before it modifies an instance, wbemcli looks for the property in it.
void addRefused(std::vector<ClientRequest>& requests, const std::string& path,
    const std::string& assignment = "Caption=x")
{
    for (const std::string operation : {"ci", "mi", "sp"})
        requests.push_back({.operation = operation, .object = path, .properties = assignment});
    requests.push_back({"di", path});
}

void addSingleProperties(std::vector<ClientRequest>& requests, const std::string& path)
{
    for (const std::string property : {"CurrentReading", "PossibleStates", "DeviceID", "caption",
             "Status", "EnabledDefault", "No_Property"})
        requests.push_back({.operation = "gp", .object = path, .properties = property});
}

void addEmptyLists(
    std::vector<ClientRequest>& requests, const std::string& className, const std::string& path)
{
    requests.push_back({.operation = "ei", .object = className, .hasEmptyList = true});
    requests.push_back({.operation = "gi", .object = path, .hasEmptyList = true});
}

void addEnumerations(std::vector<ClientRequest>& requests)
{
    for (const Texts& classes : {instanceClasses, {profile}, associationClasses, enumeratedClasses})
        for (const std::string& name : classes)
            for (const std::string operation : {"ein", "ei"})
                requests.push_back({operation, name});
    for (const auto& [classes, lists] : {std::pair(instanceClasses, propertyLists),
             {{profile}, propertyLists}, {associationClasses, endLists}})
        for (const std::string& name : classes)
            for (const std::string& list : lists)
                requests.push_back({.operation = "ei", .object = name, .properties = list});
}

void addObjects(std::vector<ClientRequest>& requests, const PathsOf& pathsOf)
{
    for (const auto& [classes, lists] : {std::pair(instanceClasses, propertyLists),
             {{profile}, propertyLists}, {associationClasses, endLists}})
        for (const std::string& name : classes) {
            const Texts paths = pathsOf(name);
            for (const std::string& path : paths)
                requests.push_back({"gi", path});
            for (const std::string& list : lists)
                requests.push_back({.operation = "gi", .object = paths.at(0), .properties = list});
        }
}

// Paths that differ in one thing from that of a sensor.
void addOtherPaths(std::vector<ClientRequest>& requests, const std::string& path)
{
    for (const auto& [from, to] : {std::pair("DeviceID=\"", "DeviceID=\"no such "),
             {"SystemName=\"", "SystemName=\"no-such-"}, {"DeviceID=", "deviceid="},
             {"ZUMLO_NumericSensor.", "zumlo_numericsensor."},
             {"ZUMLO_NumericSensor.", "CIM_NumericSensor."}, {"ZUMLO_NumericSensor.", "No_Class."}})
        for (const std::string operation : {"gi", "ai", "ain", "ri", "rin"})
            requests.push_back({operation, replaced(path, from, to)});
}

// No class offers a method.
void addMethods(std::vector<ClientRequest>& requests, const std::string& path)
{
    for (const std::string method : {"RequestStateChange", "No_Method"})
        requests.push_back({.operation = "cm", .object = path, .properties = method});
}

void addFiltered(std::vector<ClientRequest>& requests, const std::string& path)
{
    for (const std::string& association : associations) {
        for (const std::string operation : {"ai", "ain"}) {
            for (const std::string& resultClass : resultClasses)
                requests.push_back({operation, path, association, resultClass});
            for (const auto& [role, resultRole] : roles)
                requests.push_back({operation, path, association, "", role, resultRole});
        }
        for (const std::string operation : {"ri", "rin"})
            for (const std::string role : {"", "PartComponent", "capabilities", "No_Role"})
                requests.push_back({operation, path, association, "", role});
    }
    for (const std::string& list : propertyLists)
        requests.push_back({.operation = "ai", .object = path, .properties = list});
    for (const std::string& list : endLists)
        requests.push_back({.operation = "ri", .object = path, .properties = list});
}

// Adds what leads from the profile to its sensors. Object managers ask many providers where no
// association is named, and not all of them have the same ones.
void addConformance(std::vector<ClientRequest>& requests, const std::string& path)
{
    const std::string association = "ZUMLO_SensorElementConformsToProfile";
    for (const std::string operation : {"ai", "ain", "ri", "rin"})
        for (const std::string role : {"", "ConformantStandard", "ManagedElement", "No_Role"})
            requests.push_back({operation, path, association, "", role});
}

} // namespace

std::vector<std::string> ClientRequest::arguments(const std::string& url) const
{
    std::vector<std::string> words = {operation};
    // References have no result class but the association.
    for (const auto& [option, value] : {std::pair(isReferences() ? "-arc" : "-ac", association),
             {"-arc", resultClass}, {"-ar", role}, {"-arr", resultRole}})
        if (!value.empty())
            words.insert(words.end(), {option, value});
    words.push_back(url);
    if (!properties.empty() || hasEmptyList)
        words.push_back(properties);
    return words;
}

std::ostream& operator<<(std::ostream& stream, const ClientRequest& request)
{
    for (const std::string& word : request.arguments(request.object))
        stream << word << ' ';
    return stream;
}

std::vector<ClientRequest> allRequests(const PathsOf& pathsOf)
{
    std::vector<ClientRequest> requests;
    const std::string sensor = pathsOf("ZUMLO_NumericSensor").at(0);
    const std::string noSensor = replaced(sensor, "DeviceID=\"", "DeviceID=\"no such ");
    const std::string ofNoClass = "No_Class.Key=\"1\"";
    for (const std::string& path : {sensor, noSensor, ofNoClass}) {
        addRefused(requests, path);
        addSingleProperties(requests, path);
    }
    addEnumerations(requests);
    addObjects(requests, pathsOf);
    addMethods(requests, ofNoClass);
    addOtherPaths(requests, sensor);
    addRefused(requests, pathsOf(profile).at(0), "ElementName=x");
    addEmptyLists(requests, profile, pathsOf(profile).at(0));
    addConformance(requests, pathsOf(profile).at(0));
    for (const std::string& name : instanceClasses) {
        const Texts paths = pathsOf(name);
        addRefused(requests, paths.at(0),
            name.ends_with("Capabilities") ? "ElementNameEditSupported=true" : "Caption=x");
        addEmptyLists(requests, name, paths.at(0));
        for (const std::string operation : {"ai", "ri"})
            requests.push_back(
                {.operation = operation, .object = paths.at(0), .hasEmptyList = true});
        addMethods(requests, paths.at(0));
        addFiltered(requests, paths.at(0));
        for (const std::string& path : paths)
            for (const std::string operation : {"ai", "ain", "ri", "rin"})
                requests.push_back({operation, path});
    }
    return requests;
}

} // namespace Testing
