// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The names of a model file's members, for its reader and its writer.

#pragma once

#include "platform/instrumentation/Source.h"

#include <array>
#include <optional>
#include <string_view>

namespace Vorn::MachineFileMember {

inline constexpr std::string_view nodes = "nodes"; // the document's only member

// Members of a node, in the order in which they are written.
inline constexpr std::string_view type = "type";
inline constexpr std::string_view path = "path";
inline constexpr std::string_view description = "description";
inline constexpr std::string_view sensorType = "sensorType";
inline constexpr std::string_view status = "status";
inline constexpr std::string_view possibleStates = "possibleStates";
inline constexpr std::string_view baseUnits = "baseUnits";

struct Number {
    std::string_view name;
    std::optional<double> NodeReading::*value;
};
inline constexpr std::array<Number, 7> numbers{{
    {"reading", &NodeReading::reading},
    {"lowerNonCritical", &NodeReading::lowerNonCritical},
    {"upperNonCritical", &NodeReading::upperNonCritical},
    {"lowerCritical", &NodeReading::lowerCritical},
    {"upperCritical", &NodeReading::upperCritical},
    {"lowerFatal", &NodeReading::lowerFatal},
    {"upperFatal", &NodeReading::upperFatal},
}};

// All members of a node.
inline constexpr std::array<std::string_view, 14> all{type, path, description, sensorType, status,
    possibleStates, baseUnits, numbers[0].name, numbers[1].name, numbers[2].name, numbers[3].name,
    numbers[4].name, numbers[5].name, numbers[6].name};

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
