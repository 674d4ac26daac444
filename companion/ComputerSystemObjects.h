// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The path and the instance of a computer system, made through the broker. What a broker fails
// to deliver is never used; what is made belongs to the broker.

#pragma once

#include "companion/ComputerSystem.h"

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn::Companion {

inline constexpr const char* ComputerSystemClass = "ZUMLO_ComputerSystem";

// Neither null nor without a handle.
template <typename Object>
bool isUsable(const Object* object)
{
    return object != nullptr && object->hdl != nullptr;
}

// In the namespace of `ref`, with this computer as host. Null when it cannot be made whole.
CMPIObjectPath* makePath(
    const CMPIBroker* broker, const CMPIObjectPath* ref, const ComputerSystem& system);

// With the keys and, of the other properties, those in the list (all when it is null). A
// property that the broker refuses is not there. Null when there is no instance with its keys.
CMPIInstance* makeInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
    const ComputerSystem& system, const char** properties);

} // namespace Vorn::Companion
