// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/ObjectSearch.h"

#include "host/broker/Instance.h"
#include "tools/cim/ProviderClient.h"
#include "tools/sensors/Selector.h"

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

bool isSensorOfKind(const std::vector<std::string>& kinds, const Host::Instance& object)
{
    return object.className() == sensorClass && isOfKind(kinds, Sensor(object));
}

std::string noneOfKind(const std::string& wanted)
{
    return "no sensor of that kind matches \"" + wanted + "\"";
}

} // namespace

ObjectFound ObjectSearch::find(const std::string& wanted)
{
    if (const Host::ObjectPath* const path = provider_.readPath(wanted))
        return findByPath(*path, wanted);
    ObjectFound found;
    bool isOfOtherKind = false;
    for (const Sensor& sensor : sensors()) {
        if (!selects(wanted, sensor))
            continue;
        if (!isOfKind(kinds_, sensor)) {
            isOfOtherKind = true;
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
    else if (kinds_.empty())
        found.object = capabilities(provider_, wanted);
    found.isMachineEmpty = sensors().empty();
    if (found.complaint.empty())
        found.complaint = isOfOtherKind ? noneOfKind(wanted) : nothingMatches(wanted, sensors());
    return found;
}

ObjectFound ObjectSearch::findByPath(const Host::ObjectPath& path, const std::string& wanted) const
{
    ObjectFound found;
    found.object = provider_.instance(path);
    found.complaint = "there is no object with the path \"" + wanted + "\"";
    if (found.object != nullptr && !kinds_.empty() && !isSensorOfKind(kinds_, *found.object)) {
        found.object = nullptr;
        found.complaint = noneOfKind(wanted);
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
