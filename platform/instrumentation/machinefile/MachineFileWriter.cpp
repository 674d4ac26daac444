// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include "platform/instrumentation/Thousandths.h"
#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <cmath>

namespace Vorn {

namespace Member = MachineFileMember;

namespace {

nlohmann::ordered_json toJson(NodeLexicon::NodeType type)
{
    for (const Member::TypeName& known : Member::typeNames)
        if (known.type == type)
            return known.name;
    return {};
}

nlohmann::ordered_json toJson(const std::string& text)
{
    return Text::toValidUtf8(text);
}

nlohmann::ordered_json toJson(unsigned code)
{
    return code;
}

// Returns null, which is not written, where there is no finite number.
nlohmann::ordered_json toJson(const std::optional<double>& number)
{
    return number && std::isfinite(*number) ? nlohmann::ordered_json(*number) : nullptr;
}

template <typename T>
nlohmann::ordered_json toJson(const std::optional<T>& optional)
{
    return optional ? nlohmann::ordered_json(*optional) : nullptr;
}

nlohmann::ordered_json toJson(MachineFileNode node)
{
    Member::changeThousandths(node, plainThousandths);
    auto json = nlohmann::ordered_json::object();
    Member::forEach(node, [&](std::string_view name, const auto& field) {
        if (auto value = toJson(field); !value.is_null())
            json[std::string(name)] = std::move(value);
    });
    return json;
}

std::string member(std::string_view name, double value)
{
    return '"' + std::string(name) + "\": " + nlohmann::ordered_json(value).dump() + ", ";
}

} // namespace

std::string writeMachineFile(const MachineFile& file)
{
    std::string text = "{ ";
    if (file.renewal)
        text +=
            member(Member::period, file.renewal->period) + member(Member::time, file.renewal->time);
    text += "\"nodes\": [";
    for (const MachineFileNode& node : file.nodes)
        text += (&node == file.nodes.data() ? "\n  " : ",\n  ") + toJson(node).dump();
    return text + "\n] }\n";
}

} // namespace Vorn
