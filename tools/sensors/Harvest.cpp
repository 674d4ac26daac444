// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Harvest.h"

#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "platform/instrumentation/OpenSource.h"
#include "platform/instrumentation/hwmon/ChipList.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"

#include <algorithm>
#include <exception>
#include <map>
#include <string_view>
#include <unordered_set>

namespace Tools {

namespace {

using Vorn::NodeLexicon::NodeType;

// Otherwise the tool's list of chips would replace the provider's while that uses it.
constexpr bool isLibsensorsPrivate = SENSOR_PROFILE_PRIVATE_LIBSENSORS;

Sensors readSensors(const Host::Manager& manager)
{
    Host::Request request(manager.broker());
    std::vector<const char*> properties = propertiesOfSensors();
    try {
        Sensors sensors =
            sensorsOf(manager
                          .enumerateInstances(request.context(),
                              request.makePath(nameSpace, sensorClass), properties.data())
                          .instances());
        for (Sensor& sensor : sensors)
            sensor.instance = nullptr;
        return sensors;
    } catch (const Host::Refusal&) {
        return {}; // the states of the sources show it
    }
}

using Identifiers = std::unordered_set<std::string_view>;

// Returns whether the source can be listed and the harvest has all its sensors. The provider
// returns no error where a source cannot be read or breaks off.
bool isUp(const Vorn::SourceEntry& entry, const Identifiers& harvested)
{
    const auto isHarvested = [&](const Vorn::Node& node) {
        return harvested.contains(deviceIdOf(node.description, node.path));
    };
    try {
        const auto source = Vorn::openSource(entry);
        if (entry.scheme == "hwmon" && !isLibsensorsPrivate) {
            Vorn::Hwmon::presentMachine(); // throws where the chips cannot be listed
            return true;
        }
        if (entry.scheme == "hwmon") { // the list of all types at once
            const auto catalogue = Vorn::Hwmon::ChipList::instance().present();
            return std::all_of(catalogue->features.begin(), catalogue->features.end(),
                [&](const auto& feature) { return isHarvested(feature.node); });
        }
        for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer})
            for (const Vorn::Node& node : source->nodes(type))
                if (!isHarvested(node))
                    return false;
        return true;
    } catch (const std::exception&) {
        return false; // the provider has logged the reason
    }
}

std::map<std::string, bool> statesOfSources(const Sensors& sensors)
{
    Identifiers harvested;
    for (const Sensor& sensor : sensors)
        harvested.insert(sensor.deviceId);
    std::map<std::string, bool> isUpByName;
    for (const Vorn::SourceEntry& entry : SourceOptions::sources()) {
        const std::string& name = entry.scheme == "hwmon" ? entry.scheme : entry.text;
        bool& areAllUp = isUpByName.try_emplace(name, true).first->second;
        areAllUp = areAllUp && isUp(entry, harvested);
    }
    return isUpByName;
}

} // namespace

std::vector<std::string> Harvest::lostSources() const
{
    std::vector<std::string> names;
    for (const auto& [name, isSourceUp] : sources)
        if (!isSourceUp)
            names.push_back(name);
    return names;
}

Harvest readHarvest(const Host::Manager& manager, ChipDevices& devices)
{
    const auto begin = std::chrono::steady_clock::now();
    Harvest harvest{readSensors(manager), {}};
    if (SourceOptions::readsHwmon())
        devices.nameIn(harvest.sensors);
    harvest.sources = statesOfSources(harvest.sensors);
    harvest.duration = std::chrono::steady_clock::now() - begin;
    return harvest;
}

} // namespace Tools
