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

#include <array>
#include <charconv>
#include <cmath>
#include <string>

namespace Tools {

namespace {

// The beginnings of lines, by the depth of what they hold.
constexpr const char* lineOfInstance = "\n    ";
constexpr const char* lineOfMember = "\n      ";
constexpr const char* lineOfProperty = "\n        ";
constexpr const char* lineOfElement = "\n          ";

void appendReal(std::string& json, double number)
{
    std::array<char, 32> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), number).ptr;
    json.append(text.data(), end);
}

void appendValue(std::string& json, const Host::Value& value);

void appendArray(std::string& json, const Host::Array& array)
{
    json += '[';
    const char* separator = "";
    for (const Host::Value& element : array.elements()) {
        json.append(separator).append(lineOfElement);
        appendValue(json, element);
        separator = ",";
    }
    json.append(array.elements().empty() ? "" : lineOfProperty).append("]");
}

// Appends null for a null and for a number that is not finite, which JSON has not.
void appendValue(std::string& json, const Host::Value& value)
{
    if (const auto text = value.text())
        appendString(json, *text);
    else if (const auto boolean = value.boolean())
        json += *boolean ? "true" : "false";
    else if (const auto natural = value.unsignedInteger())
        json += std::to_string(*natural);
    else if (const auto integer = value.signedInteger())
        json += std::to_string(*integer);
    else if (const auto real = value.real(); real && std::isfinite(*real))
        appendReal(json, *real);
    else if (const Host::Array* const array = value.array())
        appendArray(json, *array);
    else if (const Host::DateTime* const dateTime = value.dateTime())
        appendString(json, dateTime->toText());
    else if (const Host::ObjectPath* const path = value.path())
        appendString(json, path->toText());
    else if (const Host::Instance* const instance = value.instance())
        appendString(json, Host::toText(*instance));
    else
        json += "null";
}

bool hasValue(const Host::Value& value)
{
    const auto real = value.real();
    return !value.isNull() && (!real || std::isfinite(*real));
}

void appendInstance(std::string& json, const Host::Instance& instance)
{
    json.append("{").append(lineOfMember).append("\"path\": ");
    appendString(json, instance.objectPath().toText());
    json.append(",").append(lineOfMember).append("\"properties\": {");
    const char* separator = "";
    for (const Host::NamedValue& property : instance.properties()) {
        if (!hasValue(property.value))
            continue;
        json.append(separator).append(lineOfProperty);
        appendString(json, *property.name->text());
        json += ": ";
        appendValue(json, property.value);
        separator = ",";
    }
    json.append(*separator == '\0' ? "" : lineOfMember)
        .append("}")
        .append(lineOfInstance)
        .append("}");
}

} // namespace

void writeJson(
    Output& out, std::string_view className, const std::vector<const Host::Instance*>& instances)
{
    std::string json = "{\n  \"namespace\": ";
    appendString(json, nameSpace);
    json += ",\n  \"class\": ";
    appendString(json, className);
    json += ",\n  \"instances\": [";
    const char* separator = "";
    for (const Host::Instance* const instance : instances) {
        json.append(separator).append(lineOfInstance);
        appendInstance(json, *instance);
        out.write(json);
        json.clear();
        separator = ",";
    }
    out.write(json + (instances.empty() ? "]\n}\n" : "\n  ]\n}\n"));
}

} // namespace Tools
