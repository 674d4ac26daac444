// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Array.h"

#include "host/broker/Slot.h"
#include "host/broker/Types.h"

#include <algorithm>

namespace Host {

Array::Array(Arena& home, CMPIType type, Value* elements, CMPICount size)
    : Encapsulated(&home), type_(type), size_(size), elements_(elements)
{
}

Array& Array::make(Arena& arena, CMPIType type, CMPICount size)
{
    if (!isSimpleType(type))
        throw Refusal(CMPI_RC_ERR_INVALID_DATA_TYPE,
            "an array cannot hold CMPI type " + std::to_string(type));
    if (size > maximumSize)
        throw Refusal(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED, "an array of " + std::to_string(size) +
                                                              " elements, the limit is " +
                                                              std::to_string(maximumSize));
    Value* const elements = arena.makeArray<Value>(size);
    std::fill_n(elements, size, Value::null(keptType(type)));
    return arena.make<Array>(arena, keptType(type), elements, size);
}

void Array::set(CMPICount position, const Value& value)
{
    if (value.type() != type_)
        throw Refusal(CMPI_RC_ERR_TYPE_MISMATCH, "CMPI type " + std::to_string(value.type()) +
                                                     " in an array of " + std::to_string(type_));
    element(position); // in range, before anything is copied
    if (isShared_) {
        Value* const own = memory().makeArray<Value>(size_);
        std::copy_n(elements_, size_, own);
        elements_ = own;
        isShared_ = false;
    }
    element(position) = value;
}

Array& Array::copiedTo(Arena& arena) const
{
    if (home_ == &arena) {
        Array& copy = arena.make<Array>(arena, type_, elements_, size_);
        copy.isShared_ = isShared_ = true;
        return copy;
    }
    Array& copy = make(arena, type_, size_);
    std::transform(elements_, elements_ + size_, copy.elements_,
        [&arena](const Value& value) { return value.copiedTo(arena); });
    return copy;
}

Value& Array::element(CMPICount position) const
{
    if (position >= size_)
        throw Refusal(CMPI_RC_ERR_NO_SUCH_PROPERTY,
            "element " + std::to_string(position) + " of " + std::to_string(size_));
    return elements_[position];
}

CMPIData Array::getElementAt(CMPICount position) const
{
    return element(position).handOut();
}

void Array::setElementAt(CMPICount position, const CMPIValue* value, CMPIType type)
{
    // A null is welcome in any array, whatever type it claims.
    const Value given = Value::from(memory(), value, type);
    set(position, given.type() == CMPI_null ? Value::null(type_) : given);
}

const CMPIArrayFT Array::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Array::release>,
    .clone = slot<&Array::cloned>,
    .getSize = slot<+[](const Array& array) { return array.size_; }>,
    .getSimpleType = slot<&Array::type>,
    .getElementAt = slot<&Array::getElementAt>,
    .setElementAt = slot<&Array::setElementAt>,
};

} // namespace Host
