// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Harvest.h"

#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "model/SensorHarvest.h"
#include "model/SensorIndex.h"
#include "platform/instrumentation/OpenSource.h"
#include "platform/instrumentation/hwmon/ChipList.h"
#include "tools/cim/ProviderClient.h"
#include "tools/sensors/Sources.h"

#include <algorithm>
#include <exception>
#include <map>
#include <memory>
#include <string_view>
#include <unordered_set>
#include <utility>

namespace Tools {

namespace {

using Vorn::NodeLexicon::NodeType;

Sensors readInstances(const Host::Manager& manager)
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

Sensors readRecords()
{
    std::vector<ProviderRecord> records;
    if (getSensorInstances(records))
        return {}; // the provider has no instances then
    const Vorn::SensorProfileProvider::SensorIndex index(records);
    Sensors sensors;
    sensors.reserve(index.size());
    ProviderRecord copy; // keeps its memory from record to record
    for (const ProviderRecord* const record : index.inOrder()) {
        copy = *record;
        sensors.emplace_back(copy);
    }
    return sensors;
}

// Otherwise the tool's list of chips would replace the provider's while that uses it.
constexpr bool isLibsensorsPrivate = SENSOR_PROFILE_PRIVATE_LIBSENSORS;

constexpr auto anyAge = Vorn::Hwmon::ChipList::Clock::duration::max();

using Chips = std::shared_ptr<const Vorn::Hwmon::Catalogue>;

// Returns the present chips, without their features where libsensors is shared; null where they
// cannot be listed.
Chips listChips(Vorn::Hwmon::ChipList::Clock::duration ageOfAttributes)
{
    try {
        if (isLibsensorsPrivate)
            return Vorn::Hwmon::ChipList::instance().present(ageOfAttributes);
        Vorn::Hwmon::Catalogue chips;
        chips.machine = Vorn::Hwmon::presentMachine();
        return std::make_shared<const Vorn::Hwmon::Catalogue>(std::move(chips));
    } catch (const std::exception&) {
        return nullptr; // the reason is logged
    }
}

using Identifiers = std::unordered_set<std::string_view>;

// Returns whether the source can be listed and the harvest has all its sensors.
bool isUp(const Vorn::SourceEntry& entry, const Vorn::Hwmon::Catalogue* chips,
    const Identifiers& harvested)
{
    const auto isHarvested = [&](const Vorn::Node& node) {
        return harvested.contains(deviceIdOf(node.description, node.path));
    };
    try {
        const auto source = Vorn::openSource(entry);
        if (entry.scheme == "hwmon") // the list of all types at once
            return chips != nullptr &&
                   std::all_of(chips->features.begin(), chips->features.end(),
                       [&](const auto& feature) { return isHarvested(feature.node); });
        for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer})
            for (const Vorn::Node& node : source->nodes(type))
                if (!isHarvested(node))
                    return false;
        return true;
    } catch (const std::exception&) {
        return false; // the reason is logged
    }
}

} // namespace

std::map<std::string, bool> statesOfSources(
    const Sensors& sensors, const Vorn::Hwmon::Catalogue* chips)
{
    Identifiers harvested;
    for (const Sensor& sensor : sensors)
        harvested.insert(sensor.deviceId);
    std::map<std::string, bool> isUpByName;
    for (const Vorn::SourceEntry& entry : configuredSources()) {
        const std::string& name = entry.scheme == "hwmon" ? entry.scheme : entry.text;
        bool& areAllUp = isUpByName.try_emplace(name, true).first->second;
        areAllUp = areAllUp && isUp(entry, chips, harvested);
    }
    return isUpByName;
}

std::vector<std::string> Harvest::lostSources() const
{
    std::vector<std::string> names;
    for (const auto& [name, isSourceUp] : sources)
        if (!isSourceUp)
            names.push_back(name);
    return names;
}

bool canReadRecords()
{
    return isLibsensorsPrivate;
}

namespace {

template <typename Read>
Harvest harvestOf(const Read& read, ChipDevices& devices)
{
    const auto begin = std::chrono::steady_clock::now();
    Harvest harvest{read(), {}};
    const Chips chips = readsHwmon() ? listChips(anyAge) : nullptr;
    if (chips)
        devices.nameIn(harvest.sensors, chips->machine);
    // The sources are listed once more, since neither records nor instances have an error where one
    // cannot be read or breaks off.
    harvest.sources = statesOfSources(harvest.sensors, chips.get());
    // An attribute that is gone may still be in this list of the chips.
    if (chips && !harvest.sources.at("hwmon"))
        harvest.sources =
            statesOfSources(harvest.sensors, listChips(std::chrono::seconds(0)).get());
    harvest.duration = std::chrono::steady_clock::now() - begin;
    return harvest;
}

} // namespace

Harvest readHarvest(const Host::Manager& manager, ChipDevices& devices)
{
    return harvestOf([&] { return readInstances(manager); }, devices);
}

Harvest readHarvestOfRecords(ChipDevices& devices)
{
    return harvestOf(readRecords, devices);
}

} // namespace Tools
