// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/Selections.h"

#include "host/broker/Names.h"
#include "host/repository/Repository.h"

#include <algorithm>
#include <set>
#include <string_view>

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

// An order, since a client could make names whose hashes collide.
struct NameOrder {
    bool operator()(std::string_view a, std::string_view b) const
    {
        return std::lexicographical_compare(a.begin(), a.end(), b.begin(), b.end(),
            [](char x, char y) { return foldCase(x) < foldCase(y); });
    }
};

// Returns the names as the first class with such a property spells them, since providers may
// compare letter case. Names that no class has are left out, and repeated names occur once: a
// client's list may be as long as a request, and each instance is compared with it. All namespaces
// count, since associations lead from one to another.
std::vector<std::string> spelledAsDeclared(
    const Repository& classes, const std::vector<std::string>& names)
{
    std::set<std::string_view, NameOrder> wanted(names.begin(), names.end());
    std::vector<std::string> spelled;
    for (const auto& nameSpace : classes.namespaces())
        for (const auto& declared : nameSpace->classes()) {
            if (wanted.empty())
                return spelled;
            for (const auto& property : declared->properties)
                // Inherited ones were seen already: classes come after those above them.
                if (property->declaredIn == declared.get() && wanted.erase(property->name) != 0)
                    spelled.push_back(property->name);
        }
    // Providers may treat an empty list as no list and return all properties.
    if (spelled.empty() && !names.empty())
        spelled.push_back(names.front());
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
