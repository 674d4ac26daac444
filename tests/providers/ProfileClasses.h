// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The keys of the profile's classes, which an object manager has in its repository.

#pragma once

#include "tests/support/ClassTable.h"

namespace Testing {

inline const ClassTable& profileClasses()
{
    static const ClassTable classes = [] {
        ClassTable table;
        table.add("ZUMLO_NumericSensor",
            {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
        table.add("ZUMLO_SensorEnabledLogicalElementCapabilities", {"InstanceID"});
        table.add("ZUMLO_ComputerSystem", {"CreationClassName", "Name"});
        table.add("ZUMLO_SensorElementCapabilities", {"ManagedElement", "Capabilities"});
        table.add("ZUMLO_SensorSystemDevice", {"GroupComponent", "PartComponent"});
        return table;
    }();
    return classes;
}

} // namespace Testing
