// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/ModelWriter.h"

#include "platform/instrumentation/model/ModelMembers.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <cmath>

namespace Vorn {

namespace Member = ModelMember;

namespace {

using Json = nlohmann::ordered_json;

std::string_view nameOf(NodeLexicon::NodeType type)
{
    for (const Member::TypeName& known : Member::typeNames)
        if (known.type == type)
            return known.name;
    return {};
}

Json toJson(const ModelNode& node)
{
    Json json;
    const auto set = [&](std::string_view name, Json value) {
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

std::string writeModel(const std::vector<ModelNode>& nodes)
{
    std::string text = "{ \"nodes\": [";
    for (const ModelNode& node : nodes)
        text += (&node == nodes.data() ? "\n  " : ",\n  ") + toJson(node).dump();
    return text + "\n] }\n";
}

} // namespace Vorn
