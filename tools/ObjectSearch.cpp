// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/ObjectSearch.h"

#include "host/broker/Instance.h"
#include "tools/cim/ProviderClient.h"

#include <algorithm>

namespace Tools {

namespace {

const Host::Instance* capabilities(ProviderClient& provider, std::string_view instanceId)
{
    const Instances all = provider.instances(capabilitiesClass);
    const auto found = std::find_if(all.begin(), all.end(), [&](const Host::Instance* each) {
        const Host::Value* const id = each->property("InstanceID");
        return id != nullptr && id->text() == instanceId;
    });
    return found == all.end() ? nullptr : *found;
}

bool isAccepted(const SensorFilter& filter, const Host::Instance& object)
{
    return filter.isEmpty() ||
           (object.className() == sensorClass && filter.accepts(Sensor(object)));
}

std::string noneAccepted(const SensorFilter& filter, const std::string& wanted)
{
    return std::string("no sensor") + (filter.kinds.empty() ? "" : " of that kind") +
           (filter.onlyProblems ? " with a problem" : "") + " matches \"" + wanted + "\"";
}

} // namespace

ObjectFound ObjectSearch::find(const std::string& wanted)
{
    if (const Host::ObjectPath* const path = provider_.readPath(wanted))
        return findByPath(*path, wanted);
    ObjectFound found;
    bool isRefused = false;
    for (const Sensor& sensor : sensors()) {
        if (!selects(wanted, sensor))
            continue;
        if (!filter_.accepts(sensor)) {
            isRefused = true;
            continue;
        }
        if (sensor.deviceId == wanted) {
            found.choices = {sensor};
            break;
        }
        found.choices.push_back(sensor);
    }
    if (found.choices.size() > 1)
        found.complaint = "\"" + wanted + "\" is ambiguous; choose one of its " +
                          std::to_string(found.choices.size()) + " sensors:";
    else if (found.choices.size() == 1)
        found.object = found.choices.front().instance;
    else if (filter_.isEmpty())
        found.object = capabilities(provider_, wanted);
    found.isMachineEmpty = sensors().empty();
    if (found.object == nullptr && found.complaint.empty())
        found.complaint =
            isRefused ? noneAccepted(filter_, wanted) : nothingMatches(wanted, sensors());
    return found;
}

ObjectFound ObjectSearch::findByPath(const Host::ObjectPath& path, const std::string& wanted) const
{
    ObjectFound found;
    found.object = provider_.instance(path);
    if (found.object == nullptr) {
        found.complaint = "there is no object with the path \"" + wanted + "\"";
    } else if (!isAccepted(filter_, *found.object)) {
        found.object = nullptr;
        found.complaint = noneAccepted(filter_, wanted);
    }
    return found;
}

const Sensors& ObjectSearch::sensors()
{
    if (!sensors_)
        sensors_ = readSensors(provider_, true);
    return *sensors_;
}

} // namespace Tools
