// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The properties of CMPI's type codes.

#pragma once

#include <cmpidt.h>

#include <cstddef>

namespace Host {

constexpr bool isArrayType(CMPIType type) noexcept
{
    return (type & CMPI_ARRAY) != 0;
}

constexpr CMPIType elementType(CMPIType type) noexcept
{
    return static_cast<CMPIType>(type & ~CMPI_ARRAY);
}

constexpr CMPIType arrayOf(CMPIType type) noexcept
{
    return static_cast<CMPIType>(type | CMPI_ARRAY);
}

constexpr bool isUnsignedType(CMPIType type) noexcept
{
    return type == CMPI_uint8 || type == CMPI_uint16 || type == CMPI_uint32 || type == CMPI_uint64;
}

constexpr bool isSignedType(CMPIType type) noexcept
{
    return type == CMPI_sint8 || type == CMPI_sint16 || type == CMPI_sint32 || type == CMPI_sint64;
}

constexpr bool isTextType(CMPIType type) noexcept
{
    return type == CMPI_string || type == CMPI_chars || type == CMPI_charsptr;
}

// Returns the size in bytes of a value that is no object and no text; 0 for every other type.
constexpr std::size_t plainSize(CMPIType type) noexcept
{
    switch (type) {
    case CMPI_boolean:
    case CMPI_uint8:
    case CMPI_sint8:
        return 1;
    case CMPI_char16:
    case CMPI_uint16:
    case CMPI_sint16:
        return 2;
    case CMPI_real32:
    case CMPI_uint32:
    case CMPI_sint32:
        return 4;
    case CMPI_real64:
    case CMPI_uint64:
    case CMPI_sint64:
        return 8;
    default:
        return 0;
    }
}

// Returns whether properties and keys can be of this type, array types aside.
constexpr bool isSimpleType(CMPIType type) noexcept
{
    return plainSize(type) != 0 || isTextType(type) || type == CMPI_dateTime || type == CMPI_ref ||
           type == CMPI_instance;
}

// Returns the type in which a value is stored: texts are always CMPI_string.
constexpr CMPIType keptType(CMPIType type) noexcept
{
    if (!isTextType(elementType(type)))
        return type;
    return isArrayType(type) ? CMPI_stringA : CMPI_string;
}

} // namespace Host
