// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Namespace.h"

namespace Host {

const ClassDeclaration* Namespace::findClass(std::string_view className) const
{
    const auto found = classesByName_.find(className);
    return found == classesByName_.end() ? nullptr : found->second;
}

const QualifierDeclaration* Namespace::findQualifier(std::string_view qualifierName) const
{
    const auto found = qualifiersByName_.find(qualifierName);
    return found == qualifiersByName_.end() ? nullptr : found->second;
}

void Namespace::add(std::unique_ptr<ClassDeclaration> declared)
{
    if (declared->superclass != nullptr)
        classesByName_.find(declared->superclass->name)
            ->second->subclasses.push_back(declared.get());
    classesByName_.emplace(declared->name, declared.get());
    classes_.push_back(std::move(declared));
}

void Namespace::add(std::unique_ptr<const QualifierDeclaration> declared)
{
    qualifiersByName_.emplace(declared->name, declared.get());
    qualifiers_.push_back(std::move(declared));
}

} // namespace Host
