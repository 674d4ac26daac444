// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes and qualifiers that are declared in one namespace.

#pragma once

#include "host/repository/ClassDeclaration.h"
#include "host/repository/NameTable.h"
#include "host/repository/Qualifier.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

class Namespace {
public:
    explicit Namespace(std::string name) : name_(std::move(name)) {}

    const std::string& name() const noexcept { return name_; }

    // Return null when there is none of that name.
    const ClassDeclaration* findClass(std::string_view className) const;
    const QualifierDeclaration* findQualifier(std::string_view qualifierName) const;

    // Returns the classes in the order of their declaration.
    const std::vector<std::unique_ptr<ClassDeclaration>>& classes() const { return classes_; }
    const std::vector<std::unique_ptr<const QualifierDeclaration>>& qualifiers() const
    {
        return qualifiers_;
    }

    // REQUIRES: the name is not declared yet; the superclass is of this namespace. The address of
    // an added object does not change.
    void add(std::unique_ptr<ClassDeclaration> declared);
    void add(std::unique_ptr<const QualifierDeclaration> declared);

private:
    std::string name_;
    std::vector<std::unique_ptr<ClassDeclaration>> classes_;
    std::vector<std::unique_ptr<const QualifierDeclaration>> qualifiers_;
    NameTable<ClassDeclaration*> classesByName_;
    NameTable<const QualifierDeclaration*> qualifiersByName_;
};

} // namespace Host
