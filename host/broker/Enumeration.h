// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A forward cursor over the paths or instances that an up-call found, behind a CMPIEnumeration.

#pragma once

#include "host/broker/Object.h"
#include "host/broker/Value.h"

#include <span>

namespace Host {

class Enumeration : public Encapsulated<Enumeration, CMPIEnumeration, Object::Kind::enumeration> {
public:
    // The elements are copied; what they refer to must live as long as the enumeration.
    static Enumeration& make(Arena& arena, std::span<const Value> elements);

    static const CMPIEnumerationFT functions;

private:
    friend class Arena;
    explicit Enumeration(std::span<const Value> elements) : rest_(elements) {}

    CMPIData getNext();
    bool hasNext() const noexcept { return !rest_.empty(); }

    std::span<const Value> rest_;
};

} // namespace Host
