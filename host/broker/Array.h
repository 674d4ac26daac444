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

    // All elements null. Throws Refusal: CMPI_RC_ERR_INVALID_DATA_TYPE for a type that is not
    // simple, CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED beyond the maximum size.
    static Array& make(Arena& arena, CMPIType type, CMPICount size);

    // The type of the elements; texts are CMPI_string.
    CMPIType type() const noexcept { return type_; }
    std::span<const Value> elements() const noexcept { return {elements_, size_}; }

    // Throws Refusal: CMPI_RC_ERR_TYPE_MISMATCH, or CMPI_RC_ERR_NO_SUCH_PROPERTY when the
    // position is out of range. The value must live as long as the array's request.
    void set(CMPICount position, const Value& value);

    // A new array; shares its elements until either changes when it lives in the same arena.
    Array& copiedTo(Arena& arena) const;

    static const CMPIArrayFT functions;

private:
    friend class Arena;
    Array(Arena& home, CMPIType type, Value* elements, CMPICount size);
    Value& element(CMPICount position) const;
    CMPIData getElementAt(CMPICount position) const;
    void setElementAt(CMPICount position, const CMPIValue* value, CMPIType type);

    CMPIType type_;
    mutable bool isShared_ = false;
    CMPICount size_;
    Value* elements_;
};

} // namespace Host
