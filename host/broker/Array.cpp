// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Array.h"

#include "host/broker/Slot.h"
#include "host/broker/Types.h"

#include <algorithm>

namespace Host {

Array& Array::make(Arena& arena, CMPIType type, CMPICount size)
{
    if (!isSimpleType(type))
        throw Refusal(CMPI_RC_ERR_INVALID_DATA_TYPE,
            "an array cannot hold CMPI type " + std::to_string(type));
    if (size > maximumSize)
        throw Refusal(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED, "an array of " + std::to_string(size) +
                                                              " elements, the limit is " +
                                                              std::to_string(maximumSize));
    const std::span elements(arena.makeArray<Value>(size), size);
    std::fill(elements.begin(), elements.end(), Value::null(keptType(type)));
    return arena.make<Array>(keptType(type), elements);
}

void Array::set(CMPICount position, const Value& value)
{
    if (value.type() != type_)
        throw Refusal(CMPI_RC_ERR_TYPE_MISMATCH, "CMPI type " + std::to_string(value.type()) +
                                                     " in an array of " + std::to_string(type_));
    if (position >= elements_.size())
        throw Refusal(CMPI_RC_ERR_NO_SUCH_PROPERTY,
            "element " + std::to_string(position) + " of " + std::to_string(elements_.size()));
    elements_[position] = value;
}

Array& Array::copiedTo(Arena& arena) const
{
    const std::span copies(arena.makeArray<Value>(elements_.size()), elements_.size());
    std::copy(elements_.begin(), elements_.end(), copies.begin());
    if (type_ == CMPI_ref || type_ == CMPI_instance)
        for (Value& element : copies)
            element = element.copiedTo(arena);
    return arena.make<Array>(type_, copies);
}

void Array::setElementAt(CMPICount position, const CMPIValue* value, CMPIType type)
{
    // A null is accepted with any type.
    const Value given = Value::from(Arena::required(), value, type);
    set(position, given.type() == CMPI_null ? Value::null(type_) : given);
}

const CMPIArrayFT Array::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getSize = notOffered,
    .getSimpleType = notOffered,
    .getElementAt = notOffered,
    .setElementAt = slot<&Array::setElementAt>,
};

} // namespace Host
