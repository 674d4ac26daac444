// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A provider's log and trace messages on the system's log and trace channels.

#pragma once

#include <cmpidt.h>

namespace Host {

class Broker;

// To the log channel. CMPI severities become levels: error 8000, warning 7000, information
// 6000, debug 3000. The id, if any, stands before the text. Of text and string either may be
// null.
void logMessage(const Broker& broker, CMPISeverity severity, const char* id, const char* text,
    const CMPIString* string);

// To the trace channel and to the broker's observer. CMPI levels become levels: warning
// 6000, information 4000, verbose 3000. Of component, text and string each may be null.
void traceMessage(const Broker& broker, CMPILevel level, const char* component, const char* text,
    const CMPIString* string);

} // namespace Host
