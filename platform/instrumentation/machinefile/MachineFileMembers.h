// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The members of a model file and of its nodes, for the file's reader and its writer.

#pragma once

#include "platform/instrumentation/machinefile/MachineFileNode.h"

#include <array>
#include <optional>
#include <string_view>
#include <type_traits>

namespace Vorn::MachineFileMember {

inline constexpr std::string_view nodes = "nodes"; // required in the document

// The members of a document that is renewed.
inline constexpr std::string_view period = "period";
inline constexpr std::string_view time = "time";

// The members that every node has.
inline constexpr std::string_view type = "type";
inline constexpr std::string_view path = "path";
inline constexpr std::string_view description = "description";

// Has a default, the number of the node's type.
inline constexpr std::string_view sensorType = "sensorType";

// Calls visit(name, field) for each member of a node, in the order in which they are written.
template <typename Node, typename Visit>
void forEach(Node& node, Visit visit)
{
    visit(type, node.type);
    visit(path, node.path);
    visit(description, node.description);
    visit(sensorType, node.sensorType);
    visit("status", node.values.status);
    visit("possibleStates", node.values.possibleStates);
    visit("baseUnits", node.values.baseUnits);
    visit("reading", node.values.reading);
    visit("lowerNonCritical", node.values.lowerNonCritical);
    visit("upperNonCritical", node.values.upperNonCritical);
    visit("lowerCritical", node.values.lowerCritical);
    visit("upperCritical", node.values.upperCritical);
    visit("lowerFatal", node.values.lowerFatal);
    visit("upperFatal", node.values.upperFatal);
}

// Changes the reading and the limits of a node where records publish whole thousandths of them: in
// volts.
template <typename Change>
void changeThousandths(MachineFileNode& node, Change change)
{
    if (node.sensorType != static_cast<unsigned>(NodeLexicon::NodeType::Voltage))
        return;
    forEach(node, [&](std::string_view /*name*/, auto& field) {
        if constexpr (std::is_same_v<decltype(field), std::optional<double>&>)
            if (field)
                field = change(*field);
    });
}

struct TypeName {
    std::string_view name;
    NodeLexicon::NodeType type;
};
inline constexpr std::array<TypeName, 3> typeNames{{
    {"temperature", NodeLexicon::NodeType::Temperature},
    {"voltage", NodeLexicon::NodeType::Voltage},
    {"tachometer", NodeLexicon::NodeType::Tachometer},
}};

} // namespace Vorn::MachineFileMember
