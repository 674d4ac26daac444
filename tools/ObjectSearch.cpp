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

} // namespace

ObjectFound ObjectSearch::find(const std::string& wanted)
{
    ObjectFound found;
    if (const Host::ObjectPath* const path = provider_.readPath(wanted)) {
        found.object = provider_.instance(*path);
        found.complaint = "there is no object with the path \"" + wanted + "\"";
        return found;
    }
    for (const Sensor& sensor : sensors()) {
        if (sensor.deviceId == wanted) {
            found.choices = {sensor};
            break;
        }
        if (selects(wanted, sensor))
            found.choices.push_back(sensor);
    }
    if (found.choices.size() > 1)
        found.complaint = "\"" + wanted + "\" is ambiguous; choose one of its " +
                          std::to_string(found.choices.size()) + " sensors:";
    else if (found.choices.size() == 1)
        found.object = found.choices.front().instance;
    else
        found.object = capabilities(provider_, wanted);
    found.isMachineEmpty = sensors().empty();
    if (found.complaint.empty())
        found.complaint = nothingMatches(wanted, sensors());
    return found;
}

const Sensors& ObjectSearch::sensors()
{
    if (!sensors_)
        sensors_ = readSensors(provider_, true);
    return *sensors_;
}

} // namespace Tools
