// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A forward cursor over paths or instances, the answer of an up-call, behind a
// CMPIEnumeration.

#pragma once

#include "host/broker/ArenaList.h"
#include "host/broker/Object.h"
#include "host/broker/Value.h"

namespace Host {

class Array;

class Enumeration : public Encapsulated<Enumeration, CMPIEnumeration, Object::Kind::enumeration> {
public:
    // Empty, of CMPI_ref or CMPI_instance.
    static Enumeration& make(Arena& arena, CMPIType type);

    // The value must live as long as the enumeration's request. It comes last, also when all
    // others have been read.
    void add(const Value& value);

    std::size_t size() const noexcept { return elements_.size(); }

    // A copy begins where the original stands.
    Enumeration& copiedTo(Arena& arena) const;

    static const CMPIEnumerationFT functions;

private:
    friend class Arena;
    Enumeration(Arena& home, CMPIType type) : Encapsulated(&home), type_(type) {}

    const Value& advance(); // REQUIRES: hasNext()
    CMPIData getNext();
    bool hasNext() const noexcept { return position_ < elements_.size(); }
    Array& toArray() const;

    CMPIType type_;
    ArenaList<Value> elements_;
    ArenaList<Value>::Iterator next_;
    std::size_t position_ = 0;
};

} // namespace Host
