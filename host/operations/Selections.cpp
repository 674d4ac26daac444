// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/Selections.h"

#include "host/repository/Repository.h"

#include <algorithm>

namespace Host {

using CimXml::Operation;
using CimXml::OperationKind;
using CimXml::PropertySelection;

namespace {

bool isOfClasses(OperationKind kind)
{
    return kind == OperationKind::getClass || kind == OperationKind::enumerateClasses;
}

bool leavesOutSubclasses(const Operation& operation)
{
    return (operation.kind == OperationKind::enumerateInstances ||
               operation.kind == OperationKind::openEnumerateInstances) &&
           !operation.deepInheritance;
}

// As the first class has it that has such a property: not every provider knows a name that is
// spelled otherwise. What no class has stays as it is, and selects nothing.
void spellAsDeclared(const Namespace& nameSpace, std::string& name)
{
    for (const auto& declared : nameSpace.classes())
        if (const PropertyDeclaration* const property = declared->property(name)) {
            name = property->name;
            return;
        }
}

// The properties of the class that are selected.
void limitTo(const ClassDeclaration& declared, PropertySelection& selection)
{
    std::vector<std::string> properties;
    for (const auto& property : declared.properties)
        if (isListed(selection, property->name))
            properties.push_back(property->name);
    selection.properties = std::move(properties);
}

} // namespace

PropertySelection effectiveSelection(const Operation& operation, const Repository& classes)
{
    PropertySelection selection = operation.selection;
    if (!isOfClasses(operation.kind))
        selection.localOnly = false;
    if (selection.properties)
        for (std::string& name : *selection.properties)
            spellAsDeclared(*classes.findNamespace(operation.nameSpace), name);
    if (leavesOutSubclasses(operation)) {
        const auto* const declared = classes.findClass(operation.nameSpace, operation.className);
        // Without subclasses there is nothing to leave out.
        if (declared != nullptr && !declared->subclasses.empty())
            limitTo(*declared, selection);
    }
    return selection;
}

CMPIFlags flagsOf(const Operation& operation)
{
    CMPIFlags flags = 0;
    if (operation.selection.localOnly)
        flags |= CMPI_FLAG_LocalOnly;
    if (operation.deepInheritance)
        flags |= CMPI_FLAG_DeepInheritance;
    if (operation.selection.includeQualifiers)
        flags |= CMPI_FLAG_IncludeQualifiers;
    if (operation.selection.includeClassOrigin)
        flags |= CMPI_FLAG_IncludeClassOrigin;
    return flags;
}

PropertyNames::PropertyNames(const std::optional<std::vector<std::string>>& names)
{
    if (!names)
        return;
    for (const std::string& name : *names)
        names_.push_back(name.c_str());
    names_.push_back(nullptr);
}

} // namespace Host
