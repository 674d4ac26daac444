// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One value as the broker keeps it: a type, a state and the value itself.

#pragma once

#include <cmpidt.h>

#include <cstdint>
#include <cstring>
#include <optional>
#include <string_view>

namespace Host {

class Arena;
class Array;
class DateTime;
class Instance;
class ObjectPath;
class String;

// Cheap to copy. A text, date-time, path, instance or array that it refers to belongs to the arena
// in which it was made and is never changed through the value.
class Value {
public:
    // The number of levels to which clients may nest paths in keys: each level doubles the
    // backslashes of the levels inside it.
    static constexpr unsigned maximumNesting = 8;

    // Constructs a null value without a type.
    constexpr Value() noexcept = default;

    // Copies the value at an address that a provider passed; of CMPI_chars, the text that the
    // address itself is. A null address, text or object is a null value; CMPI_chars becomes
    // CMPI_string. Throws Refusal: CMPI_RC_ERR_INVALID_DATA_TYPE for a type that a value
    // cannot have, CMPI_RC_ERR_TYPE_MISMATCH for an array of another type,
    // CMPI_RC_ERR_INVALID_HANDLE for a handle without an object.
    static Value from(Arena& arena, const void* value, CMPIType type);

    static Value text(Arena& arena, std::string_view text);
    static Value of(const String& string) noexcept;
    static Value of(const DateTime& dateTime) noexcept;
    static Value of(const ObjectPath& path) noexcept;
    static Value of(const Instance& instance) noexcept;
    static Value of(const Array& array) noexcept;
    static Value boolean(bool value) noexcept;
    // Returns a value of any CMPI integer type (and CMPI_char16), truncated to its width.
    static Value integer(CMPIType type, std::uint64_t value) noexcept;
    static Value real(CMPIType type, double value) noexcept;
    // Returns a value of any type that is no object and no text. Reads no more bytes than the type
    // has.
    static Value plain(const void* value, CMPIType type) noexcept;
    static Value null(CMPIType type) noexcept;
    // Returns the value that some object managers pass for a key that a client left out.
    static Value absent() noexcept;

    CMPIType type() const noexcept { return type_; }
    CMPIValueState state() const noexcept { return state_; }
    bool isNull() const noexcept { return (state_ & CMPI_nullValue) != 0; }

    // Each returns nothing when the value is null or of another type.
    std::optional<std::string_view> text() const noexcept;
    std::optional<bool> boolean() const noexcept;
    std::optional<std::uint64_t> unsignedInteger() const noexcept; // also CMPI_char16
    std::optional<std::int64_t> signedInteger() const noexcept;
    std::optional<double> real() const noexcept;
    const String* string() const noexcept;
    const DateTime* dateTime() const noexcept;
    const ObjectPath* path() const noexcept;
    const Instance* instance() const noexcept;
    const Array* array() const noexcept;

    // Returns whether both are of the same type and null, equal texts, numbers or truth values, or
    // the same object.
    bool operator==(const Value& other) const noexcept;

    // Returns the value with copies of the path, instance or array that it refers to.
    Value copiedTo(Arena& arena) const;

    // Returns the value for a provider, which may change the objects in it without changing this
    // value. Throws Refusal when no request is active.
    CMPIData handOut() const;
    // Returns the value with the same objects, not copies of them.
    CMPIData data() const noexcept;

    // Returns the same value, marked as that of a key.
    Value asKey() const noexcept;

private:
    Value(CMPIType type, const void* bits, std::size_t size) noexcept;
    static Value ofHandle(CMPIType type, const void* handle) noexcept;
    template <typename T>
    T get() const noexcept
    {
        T result;
        std::memcpy(&result, &bits_, sizeof result);
        return result;
    }
    template <typename Self>
    const Self* object(CMPIType type) const noexcept;

    CMPIType type_ = CMPI_null;
    CMPIValueState state_ = CMPI_nullValue;
    std::uint64_t bits_ = 0; // the first bytes of a CMPIValue
};

inline std::optional<std::uint64_t> Value::unsignedInteger() const noexcept
{
    if (isNull())
        return std::nullopt;
    switch (type_) {
    case CMPI_uint8:
        return get<CMPIUint8>();
    case CMPI_uint16:
    case CMPI_char16:
        return get<CMPIUint16>();
    case CMPI_uint32:
        return get<CMPIUint32>();
    case CMPI_uint64:
        return get<CMPIUint64>();
    default:
        return std::nullopt;
    }
}

inline std::optional<std::int64_t> Value::signedInteger() const noexcept
{
    if (isNull())
        return std::nullopt;
    switch (type_) {
    case CMPI_sint8:
        return get<CMPISint8>();
    case CMPI_sint16:
        return get<CMPISint16>();
    case CMPI_sint32:
        return get<CMPISint32>();
    case CMPI_sint64:
        return get<CMPISint64>();
    default:
        return std::nullopt;
    }
}

} // namespace Host
