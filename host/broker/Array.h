// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A sequence of values of one simple type behind a CMPIArray. Its size never changes.

#pragma once

#include "host/broker/Object.h"
#include "host/broker/Value.h"

#include <span>

namespace Host {

class Array : public Encapsulated<Array, CMPIArray, Object::Kind::array> {
public:
    static constexpr CMPICount maximumSize = 1U << 20;

    // Makes an array of null elements. Throws Refusal: CMPI_RC_ERR_INVALID_DATA_TYPE for a type
    // that is not simple, CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED beyond the maximum size.
    static Array& make(Arena& arena, CMPIType type, CMPICount size);

    // The type of the elements; texts are CMPI_string.
    CMPIType type() const noexcept { return type_; }
    std::span<const Value> elements() const noexcept { return elements_; }

    // Throws Refusal: CMPI_RC_ERR_TYPE_MISMATCH, or CMPI_RC_ERR_NO_SUCH_PROPERTY when the
    // position is out of range. The value must live as long as the array.
    void set(CMPICount position, const Value& value);

    // Returns a new array, equal to this one.
    Array& copiedTo(Arena& arena) const;

    static const CMPIArrayFT functions;

private:
    friend class Arena;
    Array(CMPIType type, std::span<Value> elements) : type_(type), elements_(elements) {}
    void setElementAt(CMPICount position, const CMPIValue* value, CMPIType type);

    CMPIType type_;
    std::span<Value> elements_;
};

} // namespace Host
