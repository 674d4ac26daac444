// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Enumeration.h"

#include "host/broker/Slot.h"

#include <algorithm>

namespace Host {

Enumeration& Enumeration::make(Arena& arena, std::span<const Value> elements)
{
    auto* const copy = arena.makeArray<Value>(elements.size());
    std::copy(elements.begin(), elements.end(), copy);
    return arena.make<Enumeration>(std::span<const Value>(copy, elements.size()));
}

CMPIData Enumeration::getNext()
{
    if (rest_.empty())
        throw Refusal(CMPI_RC_NO_MORE_ELEMENTS, "the enumeration is at its end");
    const Value next = rest_.front();
    rest_ = rest_.subspan(1);
    return next.data(); // the enumeration does not use it again
}

const CMPIEnumerationFT Enumeration::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getNext = slot<&Enumeration::getNext>,
    .hasNext = slot<&Enumeration::hasNext>,
    .toArray = notOffered,
};

} // namespace Host
