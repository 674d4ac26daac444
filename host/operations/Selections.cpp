// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/Selections.h"

#include "host/repository/Repository.h"

#include <algorithm>

namespace Host {

using CimXml::ObjectSelection;
using CimXml::Operation;
using CimXml::OperationKind;

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

// Returns the names as the first class with such a property spells them, since providers may
// compare letter case. Names that no class has are left out, and repeated names occur once: a
// client's list may be as long as a request, and each instance is compared with it. All namespaces
// count, since associations lead from one to another.
std::vector<std::string> spelledAsDeclared(
    const Repository& classes, const std::vector<std::string>& names)
{
    std::vector<const std::string*> declared; // no more than there are different properties
    for (const std::string& name : names) {
        const std::string* const found = classes.findPropertyName(name);
        if (found != nullptr &&
            std::find(declared.begin(), declared.end(), found) == declared.end())
            declared.push_back(found);
    }
    // Providers may treat an empty list as no list and return all properties.
    if (declared.empty() && !names.empty())
        declared.push_back(&names.front());
    std::vector<std::string> spelled;
    spelled.reserve(declared.size());
    for (const std::string* const name : declared)
        spelled.push_back(*name);
    return spelled;
}

// Limits the selection to properties of the class.
void limitTo(const ClassDeclaration& declared, ObjectSelection& selection)
{
    std::vector<std::string> properties;
    for (const auto& property : declared.properties)
        if (isListed(selection, property->name))
            properties.push_back(property->name);
    selection.properties = std::move(properties);
}

} // namespace

ObjectSelection effectiveSelection(const Operation& operation, const Repository& classes)
{
    ObjectSelection selection = operation.selection;
    if (!isOfClasses(operation.kind))
        selection.localOnly = false;
    if (selection.properties) {
        selection.properties = spelledAsDeclared(classes, *selection.properties);
        selection.writesNulls = true;
    }
    if (leavesOutSubclasses(operation)) {
        const auto* const declared = classes.findClass(operation.nameSpace, operation.className);
        // Without subclasses there is nothing to leave out.
        if (declared != nullptr && !declared->subclasses.empty())
            limitTo(*declared, selection);
    }
    return selection;
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
