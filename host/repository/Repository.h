// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes and qualifiers of all namespaces, as the compiler declared them.

#pragma once

#include "host/broker/ClassInformation.h"
#include "host/repository/NameTable.h"
#include "host/repository/Namespace.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// Finds namespaces, classes and qualifiers by name in any letter case. A repository is immutable:
// any thread may call it at any time, and the returned objects live as long as the repository.
class Repository : public ClassInformation {
public:
    explicit Repository(std::vector<std::unique_ptr<Namespace>> namespaces);

    // Returns the namespaces in the order of their first use.
    const std::vector<std::unique_ptr<const Namespace>>& namespaces() const noexcept
    {
        return namespaces_;
    }

    // Return null when the namespace is not known or has nothing of that name.
    const Namespace* findNamespace(std::string_view nameSpace) const;
    const ClassDeclaration* findClass(std::string_view nameSpace, std::string_view className) const;
    const QualifierDeclaration* findQualifier(
        std::string_view nameSpace, std::string_view qualifierName) const;

    // Returns the name of a property as the first class that has one of this name spells it.
    // Returns null when no class of any namespace has one.
    const std::string* findPropertyName(std::string_view name) const;

    enum class Depth { direct, deep };

    // Returns the subclasses of a class in the order of their declaration; with Depth::deep, each
    // is followed by its own subclasses. For an empty class name, returns those below a superclass
    // of all roots. Returns nothing when the namespace or the class is not known.
    std::vector<const ClassDeclaration*> subclasses(
        std::string_view nameSpace, std::string_view className, Depth depth) const;

    const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const override;
    bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const override;
    std::vector<ReferenceProperty> referencesOf(
        std::string_view nameSpace, std::string_view className) const override;

private:
    std::vector<std::unique_ptr<const Namespace>> namespaces_;
    NameTable<const std::string*> propertyNames_;
};

} // namespace Host
