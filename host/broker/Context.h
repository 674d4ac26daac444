// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Object.h"

namespace Host {

// What a provider is called with and hands back in its up-calls. It has no entries: no shipped
// provider reads one.
class Context : public Encapsulated<Context, CMPIContext, Object::Kind::context> {
public:
    static const CMPIContextFT functions;
};

} // namespace Host
