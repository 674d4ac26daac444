// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/InstanceOperations.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "host/operations/KnownClass.h"
#include "host/operations/Selections.h"
#include "host/operations/WholeResult.h"
#include "host/repository/Repository.h"

namespace Host {

using CimXml::Operation;

namespace {

// Returns the name of the property as it is declared.
const std::string& propertyOf(const Repository& classes, const Operation& operation)
{
    const ClassDeclaration& declared =
        knownClass(classes, operation.nameSpace, operation.className);
    const PropertyDeclaration* const property = declared.property(operation.propertyName);
    if (property == nullptr)
        throw Refusal(CMPI_RC_ERR_NO_SUCH_PROPERTY,
            "class " + declared.name + " has no property " + operation.propertyName);
    return property->name;
}

} // namespace

void getInstance(
    const Manager& manager, const Operation& operation, Request& request, FoundObjects& found)
{
    PropertyNames properties(operation.selection.properties);
    found.add(&manager.getInstance(request.context(), *operation.path, properties.get()));
}

void enumerateInstances(
    const Manager& manager, const Operation& operation, Request& request, FoundObjects& found)
{
    PropertyNames properties(operation.selection.properties);
    addWhole(
        found, manager.enumerateInstances(request.context(),
                   request.makePath(operation.nameSpace, operation.className), properties.get()));
}

void enumerateInstanceNames(
    const Manager& manager, const Operation& operation, Request& request, FoundObjects& found)
{
    addWhole(found, manager.enumerateInstanceNames(request.context(),
                        request.makePath(operation.nameSpace, operation.className)));
}

void getProperty(const Manager& manager, const Repository& classes, const Operation& operation,
    Request& request, FoundObjects& found)
{
    const std::string& name = propertyOf(classes, operation);
    PropertyNames properties(name);
    const Instance& instance =
        manager.getInstance(request.context(), *operation.path, properties.get());
    const Value* const value = instance.property(name);
    found.add(value == nullptr ? Value() : *value);
}

} // namespace Host
