// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What accompanies one request, behind a CMPIContext: invocation flags, principal, role and
// whatever else the host or the provider adds.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

namespace Host {

class Context : public Encapsulated<Context, CMPIContext, Object::Kind::context> {
public:
    explicit Context(Arena& home) : Encapsulated(&home) {}

    const NamedValues& entries() const noexcept { return entries_; }
    // Replaces an entry of the same name. The value must live as long as the request.
    void add(std::string_view name, const Value& value);

    Context& copiedTo(Arena& arena) const;

    static const CMPIContextFT functions;

private:
    CMPIData getEntry(const char* name) const;
    CMPIData getEntryAt(CMPICount position, CMPIString** name) const;
    void addEntry(const char* name, const CMPIValue* value, CMPIType type);

    NamedValues entries_;
};

} // namespace Host
