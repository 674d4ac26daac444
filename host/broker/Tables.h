// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The function tables behind a CMPIBroker.

#pragma once

#include <cmpift.h>

namespace Host {

// Up-calls and threads. Each broker has a copy with its own name and capabilities.
extern const CMPIBrokerFT upcallFunctions;
// Making objects, messages, logging and tracing.
extern const CMPIBrokerEncFT encapsulationFunctions;
// Threads, mutexes and conditions of the operating system.
extern const CMPIBrokerExtFT operatingSystemFunctions;
// Memory that lasts as long as a request.
extern const CMPIBrokerMemFT memoryFunctions;

} // namespace Host
