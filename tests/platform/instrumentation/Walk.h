// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The nodes of a machine, as a cursor shows them.

#pragma once

#include "platform/instrumentation/Instrumentation.h"
#include "platform/instrumentation/Source.h"
#include "tests/support/ErrorOf.h"

#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

struct SeenNode {
    Vorn::NodeLexicon::NodeType type{};
    std::string path;
    std::string description;
    unsigned sensorType = 0;
    Vorn::NodeReading values;

    bool operator==(const SeenNode&) const = default;
};

inline void seeNumber(Vorn::Instrumentation& cursor, Vorn::NodeLexicon::Properties property,
    std::optional<double>& seen)
{
    if (double value = 0.0; cursor.getProperty(property, value))
        seen = value;
}

inline SeenNode seeNode(Vorn::Instrumentation& cursor, Vorn::NodeLexicon::NodeType type)
{
    using Vorn::NodeLexicon::Properties;
    SeenNode seen{
        type, cursor.getPathToNode(), cursor.getNodeDescription(), cursor.getSensorType(), {}};
    seen.values.status = cursor.getNodeStatus();
    seeNumber(cursor, Properties::Reading, seen.values.reading);
    seeNumber(cursor, Properties::LowerNonCritical, seen.values.lowerNonCritical);
    seeNumber(cursor, Properties::UpperNonCritical, seen.values.upperNonCritical);
    seeNumber(cursor, Properties::LowerCritical, seen.values.lowerCritical);
    seeNumber(cursor, Properties::UpperCritical, seen.values.upperCritical);
    seeNumber(cursor, Properties::LowerFatal, seen.values.lowerFatal);
    seeNumber(cursor, Properties::UpperFatal, seen.values.upperFatal);
    if (unsigned units = 0; cursor.getProperty(Properties::BaseUnits, units))
        seen.values.baseUnits = units;
    if (std::vector<unsigned> states; cursor.getProperty(Properties::PossibleStates, states))
        seen.values.possibleStates = states;
    return seen;
}

// Returns the temperatures, voltages and tachometers, each type read with a cursor of its own.
inline std::vector<SeenNode> walk()
{
    using Vorn::NodeLexicon::NodeType;
    std::vector<SeenNode> nodes;
    for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer}) {
        Vorn::Instrumentation cursor;
        for (cursor.selectNode(type); cursor; ++cursor)
            nodes.push_back(seeNode(cursor, type));
    }
    return nodes;
}

inline const SeenNode& nodeAt(const std::vector<SeenNode>& nodes, const std::string& path)
{
    for (const SeenNode& node : nodes)
        if (node.path == path)
            return node;
    throw std::out_of_range("no node " + path);
}

} // namespace Testing
