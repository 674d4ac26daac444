// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <cmath>

namespace Vorn {

namespace Member = MachineFileMember;

namespace {

std::string_view nameOf(NodeLexicon::NodeType type)
{
    for (const Member::TypeName& known : Member::typeNames)
        if (known.type == type)
            return known.name;
    return {};
}

nlohmann::ordered_json toJson(const MachineFileNode& node)
{
    nlohmann::ordered_json json;
    const auto set = [&](std::string_view name, nlohmann::ordered_json value) {
        json[std::string(name)] = std::move(value);
    };
    set(Member::type, nameOf(node.type));
    set(Member::path, Text::toValidUtf8(node.path));
    set(Member::description, Text::toValidUtf8(node.description));
    set(Member::sensorType, node.sensorType);
    set(Member::status, node.values.status);
    if (node.values.possibleStates)
        set(Member::possibleStates, *node.values.possibleStates);
    if (node.values.baseUnits)
        set(Member::baseUnits, *node.values.baseUnits);
    for (const Member::Number& number : Member::numbers)
        if (const auto value = node.values.*number.value; value && std::isfinite(*value))
            set(number.name, *value);
    return json;
}

} // namespace

std::string writeMachineFile(const std::vector<MachineFileNode>& nodes)
{
    std::string text = "{ \"nodes\": [";
    for (const MachineFileNode& node : nodes)
        text += (&node == nodes.data() ? "\n  " : ",\n  ") + toJson(node).dump();
    return text + "\n] }\n";
}

} // namespace Vorn
