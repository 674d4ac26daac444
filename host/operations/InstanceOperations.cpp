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

void InstanceOperations::get(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    PropertyNames properties(operation.selection.properties);
    found.add(&manager_.getInstance(request.context(), *operation.path, properties.get()));
}

void InstanceOperations::enumerate(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    PropertyNames properties(operation.selection.properties);
    addWhole(
        found, manager_.enumerateInstances(request.context(),
                   request.makePath(operation.nameSpace, operation.className), properties.get()));
}

void InstanceOperations::enumerateNames(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    addWhole(found, manager_.enumerateInstanceNames(request.context(),
                        request.makePath(operation.nameSpace, operation.className)));
}

void InstanceOperations::getProperty(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    const std::string& name = propertyOf(operation);
    PropertyNames properties(name);
    const Instance& instance =
        manager_.getInstance(request.context(), *operation.path, properties.get());
    const Value* const value = instance.property(name);
    found.add(value == nullptr ? Value() : *value);
}

const std::string& InstanceOperations::propertyOf(const Operation& operation) const
{
    const ClassDeclaration& declared =
        knownClass(classes_, operation.nameSpace, operation.className);
    const PropertyDeclaration* const property = declared.property(operation.propertyName);
    if (property == nullptr)
        throw Refusal(CMPI_RC_ERR_NO_SUCH_PROPERTY,
            "class " + declared.name + " has no property " + operation.propertyName);
    return property->name;
}

} // namespace Host
