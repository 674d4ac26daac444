// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/ServedMachineFile.h"

#include "platform/instrumentation/NodeStatus.h"
#include "platform/text/Trim.h"

#include <utility>

namespace Vorn {

namespace {

// Returns whether the status says how the reading is: without one, the sensor would be published as
// reading 0.
bool isOfReadings(unsigned status)
{
    using namespace NodeStatus;
    return status == normal || (status >= warning && status <= criticalHigh);
}

// Returns a name for a sensor without a description, which would end the harvest of its type.
std::string nameOf(const std::string& path)
{
    return "Sensor " + path.substr(path.starts_with('/') ? 1 : 0);
}

} // namespace

ServedMachineFile::ServedMachineFile(MachineFile file) : renewal(file.renewal)
{
    readings.reserve(file.nodes.size());
    for (MachineFileNode& node : file.nodes) {
        if (Text::trimmed(node.description).empty())
            node.description = nameOf(node.path);
        if (!node.values.reading && isOfReadings(node.values.status))
            node.values.status = NodeStatus::lostCommunication;
        nodes[node.type].push_back(
            {std::move(node.path), std::move(node.description), node.sensorType, readings.size()});
        readings.push_back(std::move(node.values));
    }
}

} // namespace Vorn
