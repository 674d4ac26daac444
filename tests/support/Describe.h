// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CMPI values as text, so that whole objects can be compared in one expectation.

#pragma once

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Types.h"
#include "host/broker/Value.h"

#include <string>
#include <vector>

namespace Testing {

inline std::string describe(const Host::Value& value);

inline std::string describeElements(const Host::Array& array)
{
    std::string text;
    for (const Host::Value& element : array.elements())
        text += (text.empty() ? "" : ", ") + describe(element);
    return "[" + text + "]";
}

// Returns the type and the value, such as `uint16 5`, `string "OK"` or `[uint16 0, uint16 1]`.
inline std::string describe(const Host::Value& value)
{
    if (value.isNull())
        return "null";
    if (const Host::Array* const array = value.array())
        return describeElements(*array);
    switch (value.type()) {
    case CMPI_string:
        return "string \"" + std::string(*value.text()) + "\"";
    case CMPI_boolean:
        return *value.boolean() ? "true" : "false";
    case CMPI_uint16:
        return "uint16 " + std::to_string(*value.unsignedInteger());
    case CMPI_sint32:
        return "sint32 " + std::to_string(*value.signedInteger());
    case CMPI_ref:
        return "ref " + value.path()->toText();
    default:
        return "type " + std::to_string(value.type());
    }
}

// Returns texts such as `CurrentReading = sint32 41` in the order in which the values were set.
inline std::vector<std::string> describe(const Host::NamedValues& values)
{
    std::vector<std::string> lines;
    for (const Host::NamedValue& each : values)
        lines.push_back(std::string(*each.name->text()) + " = " + describe(each.value));
    return lines;
}

inline std::vector<std::string> namesOf(const Host::NamedValues& values)
{
    std::vector<std::string> names;
    for (const Host::NamedValue& each : values)
        names.emplace_back(*each.name->text());
    return names;
}

// Returns the property's value as text; "absent" when the instance does not have it.
inline std::string property(const Host::Instance& instance, const char* name)
{
    const Host::Value* const value = instance.property(name);
    return value ? describe(*value) : "absent";
}

} // namespace Testing
