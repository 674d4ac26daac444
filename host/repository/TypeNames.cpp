// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/TypeNames.h"

#include "host/broker/Names.h"
#include "host/broker/Types.h"

#include <array>
#include <utility>

namespace Host {

namespace {

constexpr std::array<std::pair<std::string_view, CMPIType>, 15> typeNames = {{
    {"uint8", CMPI_uint8},
    {"uint16", CMPI_uint16},
    {"uint32", CMPI_uint32},
    {"uint64", CMPI_uint64},
    {"sint8", CMPI_sint8},
    {"sint16", CMPI_sint16},
    {"sint32", CMPI_sint32},
    {"sint64", CMPI_sint64},
    {"real32", CMPI_real32},
    {"real64", CMPI_real64},
    {"boolean", CMPI_boolean},
    {"string", CMPI_string},
    {"char16", CMPI_char16},
    {"datetime", CMPI_dateTime},
    {"ref", CMPI_ref},
}};

} // namespace

CMPIType dataTypeNamed(std::string_view name)
{
    for (const auto& [known, type] : typeNames)
        if (equalNames(known, name))
            return type;
    return CMPI_null;
}

std::string nameOfType(CMPIType type)
{
    for (const auto& [name, known] : typeNames)
        if (known == elementType(type))
            return std::string(name) + (isArrayType(type) ? "[]" : "");
    return "unknown";
}

} // namespace Host
