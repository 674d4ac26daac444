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

void associators(const Manager& manager, const Repository& classes, const Operation& operation,
    Request& request, FoundObjects& found)
{
    if (operation.path == nullptr)
        return addDeclarations(found, associatedClasses(classes, operation));
    PropertyNames properties(operation.selection.properties);
    addWhole(found, manager.associators(request.context(), *operation.path,
                        associationOf(operation), properties.get()));
}

void associatorNames(const Manager& manager, const Repository& classes, const Operation& operation,
    Request& request, FoundObjects& found)
{
    if (operation.path == nullptr)
        return addNames(found, associatedClasses(classes, operation));
    addWhole(found,
        manager.associatorNames(request.context(), *operation.path, associationOf(operation)));
}

void references(const Manager& manager, const Repository& classes, const Operation& operation,
    Request& request, FoundObjects& found)
{
    if (operation.path == nullptr)
        return addDeclarations(found, referringClasses(classes, operation));
    PropertyNames properties(operation.selection.properties);
    addWhole(found, manager.references(request.context(), *operation.path, associationOf(operation),
                        properties.get()));
}

void referenceNames(const Manager& manager, const Repository& classes, const Operation& operation,
    Request& request, FoundObjects& found)
{
    if (operation.path == nullptr)
        return addNames(found, referringClasses(classes, operation));
    addWhole(found,
        manager.referenceNames(request.context(), *operation.path, associationOf(operation)));
}

} // namespace Host
