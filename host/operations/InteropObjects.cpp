// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/InteropObjects.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/repository/Repository.h"

namespace Host {

namespace {

constexpr const char* systemClass = "ZUMLO_ComputerSystem";
constexpr const char* objectManagerName = "sensor-profile";

// Codes of the DMTF value maps.
constexpr unsigned enabled = 2;        // CIM_EnabledLogicalElement.EnabledState
constexpr unsigned notApplicable = 12; // .RequestedState: nobody can request one here
constexpr unsigned healthy = 5;        // CIM_ManagedSystemElement.HealthState
constexpr unsigned ok = 2;             // .OperationalStatus

Value code(unsigned number)
{
    return Value::integer(CMPI_uint16, number);
}

} // namespace

InteropObjects::InteropObjects(const Repository& classes, const std::string& hostName)
    : classes_(classes)
{
    addObjectManager(hostName);
    for (const auto& each : classes.namespaces())
        addNamespace(hostName, each->name());
}

std::vector<const Instance*> InteropObjects::ofClass(std::string_view className) const
{
    std::vector<const Instance*> found;
    for (const Instance* const object : objects_)
        if (equalNames(object->className(), className))
            found.push_back(object);
    return found;
}

void InteropObjects::addObjectManager(const std::string& hostName)
{
    Instance& manager = add(objectManagerClass);
    setText(manager, "SystemCreationClassName", systemClass);
    setText(manager, "SystemName", hostName);
    setText(manager, "CreationClassName", objectManagerClass);
    setText(manager, "Name", objectManagerName);
    setText(manager, "ElementName", objectManagerName);
    setText(manager, "Caption", "Object Manager");
    setText(manager, "Description", "The object manager that comes with the sensor provider.");
    setCodes(manager, "OperationalStatus", ok);
    manager.setProperty("HealthState", code(healthy));
    manager.setProperty("EnabledState", code(enabled));
    manager.setProperty("RequestedState", code(notApplicable));
    manager.setProperty("Started", Value::boolean(true));
    manager.setProperty("GatherStatisticalData", Value::boolean(false));
}

void InteropObjects::addNamespace(const std::string& hostName, const std::string& name)
{
    Instance& nameSpace = add(namespaceClass);
    setText(nameSpace, "SystemCreationClassName", systemClass);
    setText(nameSpace, "SystemName", hostName);
    setText(nameSpace, "ObjectManagerCreationClassName", objectManagerClass);
    setText(nameSpace, "ObjectManagerName", objectManagerName);
    setText(nameSpace, "CreationClassName", namespaceClass);
    setText(nameSpace, "Name", name);
    setText(nameSpace, "ElementName", name);
}

Instance& InteropObjects::add(const char* className)
{
    const ObjectPath& path = ObjectPath::make(arena_, interopNameSpace, className);
    Instance& made = Instance::make(arena_, path, &classes_);
    objects_.push_back(&made);
    return made;
}

void InteropObjects::setText(Instance& instance, const char* name, std::string_view text)
{
    instance.setProperty(name, Value::text(arena_, text));
}

void InteropObjects::setCodes(Instance& instance, const char* name, unsigned only)
{
    Array& codes = Array::make(arena_, CMPI_uint16, 1);
    codes.set(0, code(only));
    instance.setProperty(name, Value::of(codes));
}

} // namespace Host
