// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/JsonDocument.h"

#include "host/broker/Array.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"
#include "tools/cim/ProviderClient.h"
#include "tools/output/JsonText.h"
#include "tools/output/Output.h"

#include <nlohmann/json.hpp>

#include <cmath>
#include <cstddef>
#include <string>

namespace Tools {

namespace {

using Json = nlohmann::ordered_json;

constexpr int indentation = 2;

Json arrayOf(const Host::Array& array);

// Returns JSON's null for a null and for a number that is not finite.
Json jsonOf(const Host::Value& value)
{
    if (const auto text = value.text())
        return *text;
    if (const auto boolean = value.boolean())
        return *boolean;
    if (const auto number = value.unsignedInteger())
        return *number;
    if (const auto number = value.signedInteger())
        return *number;
    if (const auto number = value.real())
        return std::isfinite(*number) ? Json(*number) : Json();
    if (const Host::Array* const array = value.array())
        return arrayOf(*array);
    if (const Host::DateTime* const dateTime = value.dateTime())
        return dateTime->toText();
    if (const Host::ObjectPath* const path = value.path())
        return path->toText();
    if (const Host::Instance* const instance = value.instance())
        return Host::toText(*instance);
    return nullptr;
}

Json arrayOf(const Host::Array& array)
{
    Json json = Json::array();
    for (const Host::Value& element : array.elements())
        json.push_back(jsonOf(element));
    return json;
}

Json jsonOf(const Host::Instance& instance)
{
    Json properties = Json::object();
    for (const Host::NamedValue& property : instance.properties())
        if (Json value = jsonOf(property.value); !value.is_null())
            properties[std::string(*property.name->text())] = std::move(value);
    return {{"path", instance.objectPath().toText()}, {"properties", std::move(properties)}};
}

// Serializes the value with its lines indented by the depth. No string contains a line feed.
std::string serialized(const Json& json, std::size_t depth)
{
    const std::string text =
        escapeUnprintable(json.dump(indentation, ' ', false, Json::error_handler_t::replace));
    std::string result;
    for (const char c : text) {
        result += c;
        if (c == '\n')
            result.append(depth * indentation, ' ');
    }
    return result;
}

} // namespace

// Writes instance by instance, so that the document of a large machine is never in memory as a
// whole.
void writeJson(
    Output& out, std::string_view className, const std::vector<const Host::Instance*>& instances)
{
    out.write("{\n  \"namespace\": " + serialized(nameSpace, 0) +
              ",\n  \"class\": " + serialized(className, 0) + ",\n  \"instances\": [");
    const char* separator = "\n    ";
    for (const Host::Instance* const instance : instances) {
        out.write(separator + serialized(jsonOf(*instance), 2));
        separator = ",\n    ";
    }
    out.write(instances.empty() ? "]\n}\n" : "\n  ]\n}\n");
}

} // namespace Tools
