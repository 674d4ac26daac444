// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What accompanies one request, behind a CMPIContext: invocation flags, namespace, principal and
// language.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

namespace Host {

class Context : public Encapsulated<Context, CMPIContext, Object::Kind::context> {
public:
    const NamedValues& entries() const noexcept { return entries_; }
    // Replaces an entry of the same name. The value must live as long as the request.
    void add(std::string_view name, const Value& value)
    {
        entries_.set(Arena::required(), name, value);
    }

    static const CMPIContextFT functions;

private:
    NamedValues entries_;
};

} // namespace Host
