// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/SensorList.h"

#include "platform/instrumentation/NodeStatus.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "tools/cim/ProviderClient.h"
#include "tools/sensors/NaturalOrder.h"

#include <algorithm>
#include <map>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace Tools {

namespace {

// Returns the places of the chips in a list, by their names. Names that have no order, such as
// those that differ in letter case only, have the same place.
std::unordered_map<std::string_view, std::size_t> placesOfChips(const Sensors& sensors)
{
    std::unordered_map<std::string_view, std::size_t> places;
    for (const Sensor& sensor : sensors)
        places.try_emplace(sensor.chip);
    std::vector<std::string_view> names;
    names.reserve(places.size());
    for (const auto& [name, place] : places)
        names.push_back(name);
    std::sort(names.begin(), names.end(),
        [](auto first, auto second) { return compareNaturally(first, second) < 0; });
    for (std::size_t i = 1; i < names.size(); ++i)
        places[names[i]] = places[names[i - 1]] + (compareNaturally(names[i - 1], names[i]) < 0);
    return places;
}

// Sorts pointers, since a sensor is large, and compares the names of two chips once.
template <typename Each, typename All>
std::vector<Each*> listOrderOf(All& sensors)
{
    const auto places = placesOfChips(sensors);
    std::vector<std::pair<std::size_t, Each*>> placed;
    placed.reserve(sensors.size());
    for (Each& sensor : sensors)
        placed.emplace_back(places.at(sensor.chip), &sensor);
    std::sort(placed.begin(), placed.end(), [](const auto& first, const auto& second) {
        return first.first != second.first ? first.first < second.first
                                           : isListedBefore(*first.second, *second.second);
    });
    std::vector<Each*> order;
    order.reserve(placed.size());
    for (const auto& [place, sensor] : placed)
        order.push_back(sensor);
    return order;
}

void sort(Sensors& sensors)
{
    const auto order = listOrderOf<Sensor>(sensors);
    Sensors sorted;
    sorted.reserve(order.size());
    for (Sensor* const sensor : order)
        sorted.push_back(std::move(*sensor));
    sensors = std::move(sorted);
}

} // namespace

std::vector<const char*> propertiesOfSensors()
{
    std::vector<const char*> names = {"ElementName", "DeviceID", "SensorType", "BaseUnits",
        "UnitModifier", "CurrentReading", "CurrentState", "PossibleStates", "OperationalStatus",
        "EnabledState", "HealthState"};
    for (const LimitKind& limit : limitKinds)
        names.push_back(limit.property);
    names.push_back(nullptr);
    return names;
}

Sensors sensorsOf(const Instances& instances)
{
    Sensors sensors;
    sensors.reserve(instances.size());
    for (const Host::Instance* const each : instances)
        sensors.emplace_back(*each);
    return sensors;
}

bool isListedBefore(const Sensor& first, const Sensor& second)
{
    for (const auto& [left, right] : {std::pair(&first.chip, &second.chip),
             {&first.label, &second.label}, {&first.path, &second.path}})
        if (*left != *right) // most comparisons are of one chip's sensors
            if (const auto comparison = compareNaturally(*left, *right); comparison != 0)
                return comparison < 0;
    return first.deviceId < second.deviceId;
}

std::vector<const Sensor*> inListOrder(const Sensors& sensors)
{
    return listOrderOf<const Sensor>(sensors);
}

Sensors readSensors(ProviderClient& provider, bool isWhole)
{
    std::vector<const char*> properties = propertiesOfSensors();
    Sensors sensors =
        sensorsOf(provider.instances(sensorClass, isWhole ? nullptr : properties.data()));
    sort(sensors);
    return sensors;
}

Sensors sensorsInFile(const std::string& file)
{
    using Vorn::NodeLexicon::NodeType;
    Vorn::MachineFileSource source(file);
    Sensors sensors;
    for (const auto& [type, kind] : {std::pair(NodeType::Temperature, sensorKinds[0]),
             {NodeType::Voltage, sensorKinds[1]}, {NodeType::Tachometer, sensorKinds[2]}})
        for (const auto& node : source.nodes(type)) {
            Sensor& sensor = sensors.emplace_back();
            sensor.setNames(node.description, node.path);
            sensor.kind = kind;
            if (source.read(node).status == Vorn::NodeStatus::noContact)
                sensor.state = noContactState;
        }
    sort(sensors);
    return sensors;
}

std::string summaryOf(const Sensors& sensors)
{
    std::map<Urgency, std::size_t> counts;
    for (const Sensor& sensor : sensors)
        ++counts[sensor.state.urgency];
    std::string text =
        std::to_string(sensors.size()) + (sensors.size() == 1 ? " sensor" : " sensors");
    const char* separator = ": ";
    for (const Urgency urgency : {Urgency::normal, Urgency::warning, Urgency::critical,
             Urgency::lost, Urgency::inactive, Urgency::unknown}) {
        const auto count = counts.find(urgency);
        if (count == counts.end())
            continue;
        text.append(separator).append(std::to_string(count->second)).append(" ");
        text.append(wordOf(urgency));
        separator = ", ";
    }
    return text + ".";
}

} // namespace Tools
