// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/ObjectSearch.h"

#include "host/broker/Instance.h"
#include "tools/cim/ProviderClient.h"
#include "tools/cim/SensorView.h"

#include <algorithm>
#include <stdexcept>

namespace Tools {

namespace {

Instances named(const Instances& sensors, std::string_view name)
{
    Instances found;
    for (const Host::Instance* const sensor : sensors)
        if (SensorView(*sensor).name() == name)
            found.push_back(sensor);
    return found;
}

[[noreturn]] void refuseAmbiguous(const std::string& name, const Instances& sensors)
{
    std::string text = "several sensors are named \"" + name + "\"; give one of their DeviceIDs:";
    for (const Host::Instance* const sensor : sensors)
        text.append(" \"").append(SensorView(*sensor).deviceId()).append("\"");
    throw std::runtime_error(text);
}

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

ObjectFound findObject(ProviderClient& provider, const std::string& wanted)
{
    if (const Host::ObjectPath* const path = provider.readPath(wanted))
        return {.object = provider.instance(*path)};
    if (const Host::Instance* const sensor = provider.sensor(wanted))
        return {.object = sensor};
    const Instances sensors = provider.sensors();
    const Instances found = named(sensors, wanted);
    if (found.size() > 1)
        refuseAmbiguous(wanted, found);
    if (!found.empty())
        return {.object = found.front()};
    return {.object = capabilities(provider, wanted), .isMachineEmpty = sensors.empty()};
}

} // namespace Tools
