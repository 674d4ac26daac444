// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileSource.h"

#include "platform/instrumentation/NodeStatus.h"
#include "platform/instrumentation/machinefile/MachineFileCache.h"
#include "platform/text/Trim.h"

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

MachineFileSource::MachineFileSource(const std::string& path)
    : file_(MachineFileCache::instance().load(path))
{
}

std::vector<Node> MachineFileSource::nodes(NodeLexicon::NodeType type)
{
    std::vector<Node> found;
    for (std::size_t index = 0; index < file_->nodes.size(); ++index) {
        const MachineFileNode& node = file_->nodes[index];
        if (node.type != type)
            continue;
        const bool isNameless = Text::trimmed(node.description).empty();
        found.push_back(
            {node.path, isNameless ? nameOf(node.path) : node.description, node.sensorType, index});
    }
    return found;
}

NodeReading MachineFileSource::read(const Node& node)
{
    NodeReading reading = file_->nodes.at(node.token).values;
    if (!reading.reading && isOfReadings(reading.status))
        reading.status = NodeStatus::lostCommunication;
    return reading;
}

void checkMachineFile(const std::string& path)
{
    MachineFileCache::instance().load(path);
}

} // namespace Vorn
