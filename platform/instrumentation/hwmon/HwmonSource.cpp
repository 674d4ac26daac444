// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/HwmonSource.h"

#include "platform/instrumentation/hwmon/ChannelReader.h"
#include "platform/instrumentation/hwmon/ChipList.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn {

using NodeLexicon::NodeType;

namespace {

// Returns the code of the unit in the DMTF value map CIM_NumericSensor.BaseUnits.
unsigned baseUnitsOf(NodeType type)
{
    constexpr unsigned degreesC = 2;
    constexpr unsigned volts = 5;
    constexpr unsigned revolutionsPerMinute = 19;
    if (type == NodeType::Tachometer)
        return revolutionsPerMinute;
    return type == NodeType::Voltage ? volts : degreesC;
}

} // namespace

std::vector<Node> HwmonSource::nodes(NodeType type)
{
    chip_ = nullptr;
    catalogue_ = Hwmon::ChipList::instance().present();
    std::vector<Node> nodes;
    for (const Hwmon::Feature& feature : catalogue_->features)
        if (feature.type == type)
            nodes.push_back(feature.node);
    return nodes;
}

NodeReading HwmonSource::read(const Node& node)
{
    constexpr unsigned lostCommunication = 13;
    const Hwmon::Feature& feature = catalogue_->features.at(node.token);
    const Hwmon::Chip& chip = catalogue_->chips[feature.chip];
    const Hwmon::Channel channel = Hwmon::readChannel(chip, folderOf(chip), feature);
    NodeReading values;
    if (!channel.reading && Hwmon::folderId(chip.path) != chip.id) {
        values.status = lostCommunication;
        return values;
    }
    values.status = Hwmon::statusOf(channel);
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
    values.possibleStates = Hwmon::possibleStatesOf(channel);
    return values;
}

// Returns a descriptor of the chip's folder, which stays open until the folder of another chip is
// requested.
int HwmonSource::folderOf(const Hwmon::Chip& chip)
{
    if (chip.folder.isOpen())
        return chip.folder.number();
    if (chip_ != &chip) {
        folder_ = chip.openFolder();
        chip_ = &chip;
    }
    return folder_.number();
}

} // namespace Vorn
