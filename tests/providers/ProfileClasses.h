// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The profile's classes, and their keys, which an object manager has in its repository.

#pragma once

#include "tests/support/ClassTable.h"

namespace Testing {

inline constexpr const char* SensorClass = "ZUMLO_NumericSensor";
inline constexpr const char* SystemClass = "ZUMLO_ComputerSystem";
inline constexpr const char* CapabilitiesClass = "ZUMLO_SensorEnabledLogicalElementCapabilities";

inline const ClassTable& profileClasses()
{
    static const ClassTable classes = [] {
        ClassTable table;
        table.add(SensorClass,
            {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
        table.add(CapabilitiesClass, {"InstanceID"});
        table.add(SystemClass, {"CreationClassName", "Name"});
        table.add("ZUMLO_SensorElementCapabilities", {"ManagedElement", "Capabilities"});
        table.add("ZUMLO_SensorSystemDevice", {"GroupComponent", "PartComponent"});
        return table;
    }();
    return classes;
}

} // namespace Testing
