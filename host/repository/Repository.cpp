// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Repository.h"

#include "host/broker/Names.h"
#include "host/repository/NamespaceName.h"

#include <iterator>

namespace Host {

namespace {

void appendSubclasses(const std::vector<const ClassDeclaration*>& classes, Repository::Depth depth,
    std::vector<const ClassDeclaration*>& found)
{
    for (const ClassDeclaration* const each : classes) {
        found.push_back(each);
        if (depth == Repository::Depth::deep)
            appendSubclasses(each->subclasses, depth, found);
    }
}

} // namespace

Repository::Repository(std::vector<std::unique_ptr<Namespace>> namespaces)
    : namespaces_(
          std::make_move_iterator(namespaces.begin()), std::make_move_iterator(namespaces.end()))
{
    for (const auto& nameSpace : namespaces_)
        for (const auto& declared : nameSpace->classes())
            for (const auto& property : declared->properties)
                propertyNames_.try_emplace(property->name, &property->name);
}

const Namespace* Repository::findNamespace(std::string_view nameSpace) const
{
    for (const auto& each : namespaces_)
        if (each->name() == nameSpace) // most are spelled as they are declared
            return each.get();
    const std::string name = plainNamespaceName(nameSpace);
    for (const auto& each : namespaces_)
        if (equalNames(each->name(), name))
            return each.get();
    return nullptr;
}

const std::string* Repository::findPropertyName(std::string_view name) const
{
    const auto found = propertyNames_.find(name);
    return found == propertyNames_.end() ? nullptr : found->second;
}

const ClassDeclaration* Repository::findClass(
    std::string_view nameSpace, std::string_view className) const
{
    const Namespace* const found = findNamespace(nameSpace);
    return found == nullptr ? nullptr : found->findClass(className);
}

const QualifierDeclaration* Repository::findQualifier(
    std::string_view nameSpace, std::string_view qualifierName) const
{
    const Namespace* const found = findNamespace(nameSpace);
    return found == nullptr ? nullptr : found->findQualifier(qualifierName);
}

std::vector<const ClassDeclaration*> Repository::subclasses(
    std::string_view nameSpace, std::string_view className, Depth depth) const
{
    std::vector<const ClassDeclaration*> found;
    if (className.empty()) {
        std::vector<const ClassDeclaration*> roots;
        if (const Namespace* const known = findNamespace(nameSpace))
            for (const auto& each : known->classes())
                if (each->superclass == nullptr)
                    roots.push_back(each.get());
        appendSubclasses(roots, depth, found);
    } else if (const ClassDeclaration* const top = findClass(nameSpace, className)) {
        appendSubclasses(top->subclasses, depth, found);
    }
    return found;
}

const std::vector<std::string>* Repository::keysOf(
    std::string_view nameSpace, std::string_view className) const
{
    const ClassDeclaration* const declared = findClass(nameSpace, className);
    return declared == nullptr ? nullptr : &declared->keys;
}

bool Repository::isDerivedFrom(
    std::string_view nameSpace, std::string_view className, std::string_view ancestor) const
{
    const ClassDeclaration* const declared = findClass(nameSpace, className);
    return declared != nullptr && declared->isDerivedFrom(ancestor);
}

std::vector<ReferenceProperty> Repository::referencesOf(
    std::string_view nameSpace, std::string_view className) const
{
    std::vector<ReferenceProperty> found;
    if (const ClassDeclaration* const declared = findClass(nameSpace, className))
        for (const auto& property : declared->properties)
            if (property->isReference())
                found.push_back({property->name, property->referenceClass});
    return found;
}

} // namespace Host
