// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The path and the instance of a computer system, made through the broker, which owns them.

#pragma once

#include "companion/ComputerSystem.h"

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn::Companion {

inline constexpr const char* ComputerSystemClass = "ZUMLO_ComputerSystem";

// Returns a path in the namespace of `ref` with this computer as host; null when the broker fails
// to make it with its keys.
CMPIObjectPath* makePath(
    const CMPIBroker* broker, const CMPIObjectPath* ref, const ComputerSystem& system);

// Returns an instance with the keys and, of the other properties, those in the list (all when it is
// null), without properties that the broker refuses. Null when the broker fails to make an instance
// with its keys.
CMPIInstance* makeInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
    const ComputerSystem& system, const char** properties);

} // namespace Vorn::Companion
