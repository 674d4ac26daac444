// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The registration of the sensors profile (DSP1009), as the profile registration profile (DSP1033)
// describes it.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn::Companion {

inline constexpr const char* RegisteredProfileClass = "ZUMLO_SensorRegisteredProfile";

// Returns the path of the registration; null when the broker fails to make it with its key.
CMPIObjectPath* makeProfilePath(const CMPIBroker* broker, const char* nameSpace);

// Returns an instance with the key and, of the other properties, those in the list (all when it is
// null). Null when the broker fails to make an instance with its key.
CMPIInstance* makeProfileInstance(
    const CMPIBroker* broker, const CMPIObjectPath* path, const char** properties);

} // namespace Vorn::Companion
