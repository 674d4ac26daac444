// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The named arguments of a method call, behind a CMPIArgs.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

namespace Host {

class Arguments : public Encapsulated<Arguments, CMPIArgs, Object::Kind::arguments> {
public:
    static Arguments& make(Arena& arena);

    const NamedValues& values() const noexcept { return values_; }
    // Replaces an argument of the same name. The value must live as long as the request.
    void add(std::string_view name, const Value& value);

    Arguments& copiedTo(Arena& arena) const;

    static const CMPIArgsFT functions;

private:
    friend class Arena;
    explicit Arguments(Arena& home) : Encapsulated(&home) {}

    void addArg(const char* name, const CMPIValue* value, CMPIType type);
    CMPIData getArg(const char* name) const;
    CMPIData getArgAt(CMPICount position, CMPIString** name) const;

    NamedValues values_;
};

} // namespace Host
