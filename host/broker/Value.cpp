// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Value.h"

#include "host/broker/Array.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "host/broker/Types.h"

#include <cstring>

namespace Host {

Value::Value(CMPIType type, const void* bits, std::size_t size) noexcept
    : type_(type), state_(CMPI_goodValue)
{
    std::memcpy(&bits_, bits, size);
}

Value Value::ofHandle(CMPIType type, const void* handle) noexcept
{
    return {type, &handle, sizeof handle};
}

template <typename Self>
const Self* Value::object(CMPIType type) const noexcept
{
    return isNull() || type_ != type ? nullptr : Self::of(get<const typename Self::Handle*>());
}

Value Value::text(Arena& arena, std::string_view text)
{
    return of(String::make(arena, text));
}

Value Value::of(const String& string) noexcept
{
    return string.characters() == nullptr ? null(CMPI_string)
                                          : ofHandle(CMPI_string, string.handle());
}

Value Value::of(const DateTime& dateTime) noexcept
{
    return ofHandle(CMPI_dateTime, dateTime.handle());
}

Value Value::of(const ObjectPath& path) noexcept
{
    return ofHandle(CMPI_ref, path.handle());
}

Value Value::of(const Instance& instance) noexcept
{
    return ofHandle(CMPI_instance, instance.handle());
}

Value Value::of(const Array& array) noexcept
{
    return ofHandle(arrayOf(array.type()), array.handle());
}

Value Value::boolean(bool value) noexcept
{
    const CMPIBoolean one = value ? 1 : 0;
    return {CMPI_boolean, &one, sizeof one};
}

Value Value::integer(CMPIType type, std::uint64_t value) noexcept
{
    switch (plainSize(type)) {
    case 1: {
        const auto cut = static_cast<std::uint8_t>(value);
        return {type, &cut, sizeof cut};
    }
    case 2: {
        const auto cut = static_cast<std::uint16_t>(value);
        return {type, &cut, sizeof cut};
    }
    case 4: {
        const auto cut = static_cast<std::uint32_t>(value);
        return {type, &cut, sizeof cut};
    }
    default:
        return {type, &value, sizeof value};
    }
}

Value Value::real(CMPIType type, double value) noexcept
{
    if (type == CMPI_real64)
        return {type, &value, sizeof value};
    const auto single = static_cast<float>(value);
    return {type, &single, sizeof single};
}

Value Value::plain(const void* value, CMPIType type) noexcept
{
    if (type == CMPI_boolean) {
        CMPIBoolean truth = 0;
        std::memcpy(&truth, value, sizeof truth);
        return boolean(truth != 0);
    }
    switch (plainSize(type)) { // a copy of a constant size is a single instruction
    case 1:
        return {type, value, 1};
    case 2:
        return {type, value, 2};
    case 4:
        return {type, value, 4};
    default:
        return {type, value, 8};
    }
}

Value Value::null(CMPIType type) noexcept
{
    Value value;
    value.type_ = type;
    return value;
}

Value Value::absent() noexcept
{
    Value value;
    value.state_ = CMPI_nullValue | CMPI_notFound;
    return value;
}

std::optional<std::string_view> Value::text() const noexcept
{
    const String* const text = string();
    return text == nullptr ? std::nullopt : text->text();
}

std::optional<bool> Value::boolean() const noexcept
{
    if (isNull() || type_ != CMPI_boolean)
        return std::nullopt;
    return get<CMPIBoolean>() != 0;
}

std::optional<double> Value::real() const noexcept
{
    if (isNull())
        return std::nullopt;
    if (type_ == CMPI_real32)
        return get<CMPIReal32>();
    if (type_ == CMPI_real64)
        return get<CMPIReal64>();
    return std::nullopt;
}

const String* Value::string() const noexcept
{
    return object<String>(CMPI_string);
}

const DateTime* Value::dateTime() const noexcept
{
    return object<DateTime>(CMPI_dateTime);
}

const ObjectPath* Value::path() const noexcept
{
    return object<ObjectPath>(CMPI_ref);
}

const Instance* Value::instance() const noexcept
{
    return object<Instance>(CMPI_instance);
}

const Array* Value::array() const noexcept
{
    return isArrayType(type_) ? object<Array>(type_) : nullptr;
}

bool Value::operator==(const Value& other) const noexcept
{
    if (type_ != other.type_ || isNull() != other.isNull())
        return false;
    return isNull() || bits_ == other.bits_ || (type_ == CMPI_string && text() == other.text());
}

Value Value::copiedTo(Arena& arena) const
{
    Value copy = *this;
    if (const ObjectPath* const reference = path())
        copy = of(reference->copiedTo(arena));
    else if (const Instance* const embedded = instance())
        copy = of(embedded->copiedTo(arena));
    else if (const Array* const elements = array())
        copy = of(elements->copiedTo(arena));
    copy.state_ = state_;
    return copy;
}

CMPIData Value::handOut() const
{
    return copiedTo(Arena::required()).data();
}

CMPIData Value::data() const noexcept
{
    CMPIData data{type_, state_, {}};
    std::memcpy(&data.value, &bits_, sizeof bits_);
    return data;
}

Value Value::asKey() const noexcept
{
    Value key = *this;
    key.state_ |= CMPI_keyValue;
    return key;
}

} // namespace Host
