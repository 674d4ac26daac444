// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/NodeReader.h"

#include "platform/instrumentation/NodeStatus.h"
#include "platform/instrumentation/hwmon/ChannelReader.h"
#include "platform/instrumentation/hwmon/Status.h"

#include <utility>

namespace Vorn::Hwmon {

namespace {

// Returns the code of the unit in the DMTF value map CIM_NumericSensor.BaseUnits.
unsigned baseUnitsOf(NodeLexicon::NodeType type)
{
    constexpr unsigned degreesC = 2;
    constexpr unsigned volts = 5;
    constexpr unsigned revolutionsPerMinute = 19;
    if (type == NodeLexicon::NodeType::Tachometer)
        return revolutionsPerMinute;
    return type == NodeLexicon::NodeType::Voltage ? volts : degreesC;
}

} // namespace

NodeReader::NodeReader(std::shared_ptr<const Catalogue> catalogue)
    : catalogue_(std::move(catalogue))
{
}

NodeReading NodeReader::read(const Feature& feature)
{
    const Chip& chip = catalogue_->chips[feature.chip];
    const ChannelState channel = readChannel(chip, folderOf(chip), feature);
    NodeReading values;
    if (!channel.reading && folderId(chip.path) != chip.id) {
        values.status = NodeStatus::lostCommunication;
        return values;
    }
    values.status = statusOf(channel);
    // The reading of a channel with a fault, such as an open diode, is not to be trusted (the
    // kernel's sysfs-interface).
    if (!channel.hasFault)
        values.reading = channel.reading;
    values.lowerNonCritical = channel.limits.min;
    values.upperNonCritical = channel.limits.max;
    values.lowerCritical = channel.limits.lcrit;
    values.upperCritical = channel.limits.crit;
    values.upperFatal = channel.limits.emergency;
    values.baseUnits = baseUnitsOf(feature.type);
    values.possibleStates = possibleStatesOf(channel);
    return values;
}

// Returns a descriptor of the chip's folder, which stays open until the folder of another chip is
// requested.
int NodeReader::folderOf(const Chip& chip)
{
    if (chip.folder.isOpen())
        return chip.folder.number();
    if (chip_ != &chip) {
        folder_ = chip.openFolder();
        chip_ = &chip;
    }
    return folder_.number();
}

} // namespace Vorn::Hwmon
