// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

namespace Host {

class Broker;

// Writes a provider's trace message to the trace channel. CMPI levels become levels of the
// channel: warning 6000, information 4000, verbose 3000. Of component, text and string each may be
// null.
void traceMessage(const Broker& broker, CMPILevel level, const char* component, const char* text,
    const CMPIString* string);

} // namespace Host
