// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Enumeration.h"

#include "host/broker/Array.h"
#include "host/broker/Slot.h"

namespace Host {

Enumeration& Enumeration::make(Arena& arena, CMPIType type)
{
    return arena.make<Enumeration>(arena, type);
}

void Enumeration::add(const Value& value)
{
    elements_.append(memory(), value);
}

Enumeration& Enumeration::copiedTo(Arena& arena) const
{
    Enumeration& copy = make(arena, type_);
    for (const Value& element : elements_)
        copy.elements_.append(arena, element.copiedTo(arena));
    while (copy.position_ < position_)
        copy.advance();
    return copy;
}

const Value& Enumeration::advance()
{
    if (position_++ == 0)
        next_ = elements_.begin();
    return *next_++;
}

CMPIData Enumeration::getNext()
{
    if (!hasNext())
        throw Refusal(CMPI_RC_NO_MORE_ELEMENTS, "the enumeration is at its end");
    return advance().data(); // made for the caller alone
}

Array& Enumeration::toArray() const
{
    Array& array = Array::make(memory(), type_, static_cast<CMPICount>(elements_.size()));
    CMPICount position = 0;
    for (const Value& element : elements_)
        array.set(position++, element);
    return array;
}

const CMPIEnumerationFT Enumeration::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Enumeration::release>,
    .clone = slot<&Enumeration::cloned>,
    .getNext = slot<&Enumeration::getNext>,
    .hasNext = slot<&Enumeration::hasNext>,
    .toArray = slot<&Enumeration::toArray>,
};

} // namespace Host
