// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Text.h"

#include "host/broker/Array.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"

#include <array>
#include <charconv>

namespace Host {

namespace {

std::string quoted(std::string_view text)
{
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\')
            result += '\\';
        result += c;
    }
    return result += '"';
}

// Returns the shortest text that converts back to the same number.
std::string realText(const Value& value)
{
    std::array<char, 32> buffer{};
    const double number = *value.real();
    const auto end = value.type() == CMPI_real32
                         ? std::to_chars(buffer.begin(), buffer.end(), static_cast<float>(number))
                         : std::to_chars(buffer.begin(), buffer.end(), number);
    return {buffer.begin(), end.ptr};
}

} // namespace

std::string toText(const Value& value)
{
    if (const auto text = value.text())
        return quoted(*text);
    if (const auto number = value.unsignedInteger())
        return std::to_string(*number);
    if (const auto number = value.signedInteger())
        return std::to_string(*number);
    if (value.real())
        return realText(value);
    if (const auto truth = value.boolean())
        return *truth ? "TRUE" : "FALSE";
    if (const DateTime* const time = value.dateTime())
        return quoted(time->toText());
    if (const ObjectPath* const path = value.path())
        return quoted(toText(*path));
    if (const Array* const array = value.array())
        return toText(*array);
    if (const Instance* const instance = value.instance())
        return toText(*instance);
    return "NULL";
}

std::string toText(const Array& array)
{
    std::string result = "{";
    for (const Value& element : array.elements())
        result.append(result.size() == 1 ? "" : ", ").append(toText(element));
    return result += '}';
}

std::string toText(const ObjectPath& path)
{
    std::string result;
    if (!path.host().empty())
        result.append("//").append(path.host()).append("/");
    if (!path.nameSpace().empty())
        result.append(path.nameSpace()).append(":");
    result.append(path.className());
    char separator = '.';
    for (const auto& [name, value] : path.keys()) {
        result += separator;
        result.append(*name->text()).append("=").append(toText(value));
        separator = ',';
    }
    return result;
}

std::string toText(const Instance& instance)
{
    std::string result = "instance of ";
    result.append(instance.className()).append(" {");
    for (const auto& [name, value] : instance.properties())
        result.append(" ").append(*name->text()).append(" = ").append(toText(value)).append(";");
    return result += " };";
}

} // namespace Host
