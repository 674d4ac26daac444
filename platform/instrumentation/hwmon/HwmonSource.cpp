// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/HwmonSource.h"

#include "platform/instrumentation/hwmon/ChannelReader.h"
#include "platform/instrumentation/hwmon/Chip.h"
#include "platform/instrumentation/hwmon/ChipList.h"
#include "platform/instrumentation/hwmon/Status.h"
#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <algorithm>
#include <iterator>

namespace Vorn {

using NodeLexicon::NodeType;

namespace {

sensors_feature_type featureTypeOf(NodeType type)
{
    switch (type) {
    case NodeType::Tachometer:
        return SENSORS_FEATURE_FAN;
    case NodeType::Voltage:
        return SENSORS_FEATURE_IN;
    case NodeType::Temperature:
        return SENSORS_FEATURE_TEMP;
    }
    return SENSORS_FEATURE_UNKNOWN;
}

// The kernel's units are milli-units of these, which libsensors scales; the codes are those of
// the DMTF value map CIM_NumericSensor.BaseUnits.
unsigned baseUnitsOf(sensors_feature_type type)
{
    constexpr unsigned degreesC = 2;
    constexpr unsigned volts = 5;
    constexpr unsigned revolutionsPerMinute = 19;
    if (type == SENSORS_FEATURE_FAN)
        return revolutionsPerMinute;
    return type == SENSORS_FEATURE_IN ? volts : degreesC;
}

std::string descriptionOf(const Hwmon::Feature& feature)
{
    const std::string label = Text::toValidUtf8(Text::trimmed(Hwmon::labelOf(feature)));
    return label.empty() ? feature.feature->name : label;
}

} // namespace

HwmonSource::HwmonSource() = default;

HwmonSource::~HwmonSource() = default;

std::vector<Node> HwmonSource::nodes(NodeType type)
{
    const auto lock = Hwmon::ChipList::instance().lockPresent();
    std::vector<Node> nodes;
    for (const sensors_chip_name* chip : Hwmon::detectedChips()) {
        const auto folder = Hwmon::folderOf(*chip);
        std::vector<Node> found = nodesOf(*chip, type);
        // A chip that disappeared while its features were listed is left out, since the labels,
        // which name the sensors, may be incomplete.
        if (folder && folder == Hwmon::folderOf(*chip))
            std::move(found.begin(), found.end(), std::back_inserter(nodes));
    }
    return nodes;
}

std::vector<Node> HwmonSource::nodesOf(const sensors_chip_name& chip, NodeType type)
{
    const std::string folder = "/hwmon/" + Hwmon::printedName(chip) + "/";
    std::vector<Node> nodes;
    for (const sensors_feature* entry : Hwmon::featuresOf(chip, featureTypeOf(type))) {
        const Hwmon::Feature feature{&chip, entry};
        nodes.push_back({folder + entry->name, descriptionOf(feature), static_cast<unsigned>(type),
            listed_.size()});
        listed_.push_back(Hwmon::identify(feature));
    }
    return nodes;
}

NodeReading HwmonSource::read(const Node& node)
{
    constexpr unsigned lostCommunication = 13;
    const auto lock = Hwmon::ChipList::instance().lockKnown();
    const Hwmon::Feature feature = Hwmon::find(listed_.at(node.token));
    NodeReading values;
    if (feature.feature == nullptr) {
        values.status = lostCommunication;
        return values;
    }
    const Hwmon::Channel channel = Hwmon::readChannel(feature);
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
    values.baseUnits = baseUnitsOf(feature.feature->type);
    values.possibleStates = Hwmon::possibleStatesOf(channel);
    return values;
}

} // namespace Vorn
