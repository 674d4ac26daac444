// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes and qualifier declarations of a host, as the compiler has made them.

#pragma once

#include "host/broker/ClassInformation.h"
#include "host/repository/Namespace.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// Names of namespaces, classes and qualifiers are looked up without regard to letter case;
// answers spell them as they are declared. Never changes: any thread may ask at any time,
// without locks, and what it is given lives as long as the repository.
class Repository : public ClassInformation {
public:
    explicit Repository(std::vector<std::unique_ptr<Namespace>> namespaces);

    // In the order in which the compiler first met them.
    const std::vector<std::unique_ptr<const Namespace>>& namespaces() const noexcept
    {
        return namespaces_;
    }

    // Null when the namespace is not known or has nothing of that name.
    const Namespace* findNamespace(std::string_view nameSpace) const;
    const ClassDeclaration* findClass(std::string_view nameSpace, std::string_view className) const;
    const QualifierDeclaration* findQualifier(
        std::string_view nameSpace, std::string_view qualifierName) const;

    enum class Depth { direct, deep };

    // The classes below one, in the order of their declaration within each class; deep, each
    // class stands before its own subclasses. For an empty class name, those from the roots
    // on. Empty when the namespace or the class is not known.
    std::vector<const ClassDeclaration*> subclasses(
        std::string_view nameSpace, std::string_view className, Depth depth) const;

    // The superclass first, the root last.
    std::vector<const ClassDeclaration*> ancestors(
        std::string_view nameSpace, std::string_view className) const;

    bool isAssociation(std::string_view nameSpace, std::string_view className) const;

    const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const override;
    bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const override;
    std::vector<ReferenceProperty> referencesOf(
        std::string_view nameSpace, std::string_view className) const override;

private:
    std::vector<std::unique_ptr<const Namespace>> namespaces_;
};

} // namespace Host
