// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Object.h"

namespace Host {

// The context that a provider gets with a call and passes to its up-calls. It has no entries, since
// no shipped provider reads any.
class Context : public Encapsulated<Context, CMPIContext, Object::Kind::context> {
public:
    static const CMPIContextFT functions;
};

} // namespace Host
