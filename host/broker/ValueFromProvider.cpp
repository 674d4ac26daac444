// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Converts values as providers pass them: an address, and the type of what it points to.

#include "host/broker/Array.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Types.h"
#include "host/broker/Value.h"

#include <cstring>

namespace Host {

namespace {

// Returns the pointer at an address, which need not be aligned.
template <typename Pointer>
Pointer pointerAt(const void* address) noexcept
{
    Pointer pointer = nullptr;
    std::memcpy(&pointer, address, sizeof pointer);
    return pointer;
}

// Returns a copy of the object whose handle is at the address; null when there is no handle.
template <typename Self>
Value copyOfObject(Arena& arena, const void* address, CMPIType type)
{
    const auto* const handle = pointerAt<const typename Self::Handle*>(address);
    return handle == nullptr ? Value::null(type)
                             : Value::of(required<Self>(handle)).copiedTo(arena);
}

Value copyOfArray(Arena& arena, const void* address, CMPIType type)
{
    const auto* const handle = pointerAt<const CMPIArray*>(address);
    if (handle == nullptr)
        return Value::null(type);
    const Array& array = required<Array>(handle);
    if (arrayOf(array.type()) != type)
        throw Refusal(CMPI_RC_ERR_TYPE_MISMATCH, "the array's elements are of another type");
    return Value::of(array).copiedTo(arena);
}

// Returns the text of the string object whose handle is at the address. It is shared.
Value textAt(const void* address)
{
    const auto* const handle = pointerAt<const CMPIString*>(address);
    return handle == nullptr ? Value::null(CMPI_string) : Value::of(required<String>(handle));
}

Value copyOfText(Arena& arena, const char* text)
{
    return text == nullptr ? Value::null(CMPI_string) : Value::text(arena, text);
}

Value copyOf(Arena& arena, const void* address, CMPIType type)
{
    if (isArrayType(type))
        return copyOfArray(arena, address, keptType(type));
    switch (type) {
    case CMPI_chars:
        return copyOfText(arena, static_cast<const char*>(address));
    case CMPI_charsptr:
        return copyOfText(arena, pointerAt<const char*>(address));
    case CMPI_string:
        return textAt(address);
    case CMPI_dateTime:
        return copyOfObject<DateTime>(arena, address, type);
    case CMPI_ref:
        return copyOfObject<ObjectPath>(arena, address, type);
    case CMPI_instance:
        return copyOfObject<Instance>(arena, address, type);
    default:
        return Value::plain(address, type);
    }
}

} // namespace

Value Value::from(Arena& arena, const void* value, CMPIType type)
{
    if (type == CMPI_null)
        return {};
    if (!isSimpleType(elementType(type)))
        throw Refusal(CMPI_RC_ERR_INVALID_DATA_TYPE,
            "a value cannot be of CMPI type " + std::to_string(type));
    if (value == nullptr)
        return null(keptType(type));
    return copyOf(arena, value, type);
}

} // namespace Host
