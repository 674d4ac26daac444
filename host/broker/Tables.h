// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The function tables behind a CMPIBroker.

#pragma once

#include <cmpift.h>

namespace Host {

// Information about the broker, and up-calls.
extern const CMPIBrokerFT upcallFunctions;
// Object construction and trace messages.
extern const CMPIBrokerEncFT encapsulationFunctions;
// Threads, mutexes, conditions and memory blocks, none of which the broker offers. CMPI permits a
// broker to have no table of memory blocks; with a complete table, providers need no test.
extern const CMPIBrokerExtFT operatingSystemFunctions;
extern const CMPIBrokerMemFT memoryFunctions;

} // namespace Host
