// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/AssociationOperations.h"

#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "host/operations/ClassAssociations.h"
#include "host/operations/Selections.h"
#include "host/operations/WholeResult.h"
#include "host/repository/ClassDeclaration.h"

namespace Host {

using CimXml::Operation;

namespace {

const char* orNull(const std::string& text)
{
    return text.empty() ? nullptr : text.c_str();
}

// The operation must outlive it.
Manager::Association associationOf(const Operation& operation)
{
    return {orNull(operation.associationClass), orNull(operation.resultClass),
        orNull(operation.role), orNull(operation.resultRole)};
}

void addDeclarations(FoundObjects& found, const std::vector<const ClassDeclaration*>& classes)
{
    for (const ClassDeclaration* const declared : classes)
        found.add(declared);
}

void addNames(FoundObjects& found, const std::vector<const ClassDeclaration*>& classes)
{
    for (const ClassDeclaration* const declared : classes)
        found.add(ClassName{declared->name});
}

} // namespace

void AssociationOperations::associators(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    if (operation.path == nullptr)
        return addDeclarations(found, associatedClasses(classes_, operation));
    PropertyNames properties(operation.selection.properties);
    addWhole(found, manager_.associators(request.context(), *operation.path,
                        associationOf(operation), properties.get()));
}

void AssociationOperations::associatorNames(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    if (operation.path == nullptr)
        return addNames(found, associatedClasses(classes_, operation));
    addWhole(found,
        manager_.associatorNames(request.context(), *operation.path, associationOf(operation)));
}

void AssociationOperations::references(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    if (operation.path == nullptr)
        return addDeclarations(found, referringClasses(classes_, operation));
    PropertyNames properties(operation.selection.properties);
    addWhole(found, manager_.references(request.context(), *operation.path,
                        associationOf(operation), properties.get()));
}

void AssociationOperations::referenceNames(
    const Operation& operation, Request& request, FoundObjects& found) const
{
    if (operation.path == nullptr)
        return addNames(found, referringClasses(classes_, operation));
    addWhole(found,
        manager_.referenceNames(request.context(), *operation.path, associationOf(operation)));
}

} // namespace Host
