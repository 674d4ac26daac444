// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/SensorProfile.h"

namespace Host {

namespace {

// Abstract classes near the root have no keys.
void addElements(ClassTable& classes)
{
    const std::vector<std::string> systemKeys = {"CreationClassName", "Name"};
    const std::vector<std::string> deviceKeys = {
        "CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"};
    classes.add("CIM_ManagedElement", {});
    classes.add("CIM_ManagedSystemElement", {}, "CIM_ManagedElement");
    classes.add("CIM_LogicalElement", {}, "CIM_ManagedSystemElement");
    classes.add("CIM_EnabledLogicalElement", {}, "CIM_LogicalElement");

    classes.add("CIM_System", systemKeys, "CIM_EnabledLogicalElement");
    classes.add("CIM_ComputerSystem", systemKeys, "CIM_System");
    classes.add("ZUMLO_ComputerSystem", systemKeys, "CIM_ComputerSystem");

    classes.add("CIM_LogicalDevice", deviceKeys, "CIM_EnabledLogicalElement");
    classes.add("CIM_Sensor", deviceKeys, "CIM_LogicalDevice");
    classes.add("CIM_NumericSensor", deviceKeys, "CIM_Sensor");
    classes.add("ZUMLO_NumericSensor", deviceKeys, "CIM_NumericSensor");
}

void addCapabilities(ClassTable& classes)
{
    classes.add("CIM_Capabilities", {"InstanceID"}, "CIM_ManagedElement");
    classes.add("CIM_EnabledLogicalElementCapabilities", {"InstanceID"}, "CIM_Capabilities");
    classes.add("ZUMLO_SensorEnabledLogicalElementCapabilities", {"InstanceID"},
        "CIM_EnabledLogicalElementCapabilities");
}

// The references of an association are its keys.
void addAssociation(ClassTable& classes, const std::string& className,
    const std::string& superclass, const ReferenceProperty& first, const ReferenceProperty& second)
{
    classes.add(className, {first.name, second.name}, superclass, {first, second});
}

void addAssociations(ClassTable& classes)
{
    addAssociation(classes, "CIM_Component", {}, {"GroupComponent", "CIM_ManagedElement"},
        {"PartComponent", "CIM_ManagedElement"});
    addAssociation(classes, "CIM_SystemComponent", "CIM_Component",
        {"GroupComponent", "CIM_System"}, {"PartComponent", "CIM_ManagedSystemElement"});
    addAssociation(classes, "CIM_SystemDevice", "CIM_SystemComponent",
        {"GroupComponent", "CIM_System"}, {"PartComponent", "CIM_LogicalDevice"});
    addAssociation(classes, "ZUMLO_SensorSystemDevice", "CIM_SystemDevice",
        {"GroupComponent", "ZUMLO_ComputerSystem"}, {"PartComponent", "ZUMLO_NumericSensor"});

    addAssociation(classes, "CIM_ElementCapabilities", {}, {"ManagedElement", "CIM_ManagedElement"},
        {"Capabilities", "CIM_Capabilities"});
    addAssociation(classes, "ZUMLO_SensorElementCapabilities", "CIM_ElementCapabilities",
        {"ManagedElement", "ZUMLO_NumericSensor"},
        {"Capabilities", "ZUMLO_SensorEnabledLogicalElementCapabilities"});
}

} // namespace

ClassTable sensorProfileClasses()
{
    ClassTable classes;
    addElements(classes);
    addCapabilities(classes);
    addAssociations(classes);
    return classes;
}

std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary)
{
    std::vector<ProviderRegistration> providers = {
        {"ZUMLO_NumericSensor", "SensorProfileProvider", sensorLibrary, true, false},
        {"ZUMLO_SensorEnabledLogicalElementCapabilities",
            "SensorEnabledLogicalElementCapabilitiesProvider", sensorLibrary, true, false},
        {"ZUMLO_SensorElementCapabilities", "SensorElementCapabilitiesProvider", sensorLibrary,
            true, true},
        {"ZUMLO_SensorSystemDevice", "SensorSystemDeviceProvider", sensorLibrary, true, true}};
    if (computerSystemLibrary)
        providers.push_back({"ZUMLO_ComputerSystem", "ComputerSystemProvider",
            *computerSystemLibrary, true, false});
    return providers;
}

} // namespace Host
