// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A class with all it inherits, as a repository answers it.

#pragma once

#include "host/repository/Qualifier.h"

#include <cmpidt.h>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

struct ClassDeclaration;

// A property, or a reference when its type is CMPI_ref.
struct PropertyDeclaration {
    std::string name;
    CMPIType type = CMPI_null; // with CMPI_ARRAY for an array
    std::optional<std::uint32_t> arraySize;
    std::string referenceClass;                   // of a reference
    std::shared_ptr<const Constant> defaultValue; // never null; a null constant when none is given
    QualifierList qualifiers;
    bool isKey = false;
    const ClassDeclaration* origin = nullptr;     // the class that introduced it
    const ClassDeclaration* declaredIn = nullptr; // the class that declared it last
    SourcePosition position;

    bool isReference() const noexcept { return type == CMPI_ref; }
};

struct ParameterDeclaration {
    std::string name;
    CMPIType type = CMPI_null;
    std::optional<std::uint32_t> arraySize;
    std::string referenceClass; // of a reference or an array of references
    QualifierList qualifiers;
};

struct MethodDeclaration {
    std::string name;
    CMPIType type = CMPI_null; // of what it returns
    std::string referenceClass;
    std::vector<ParameterDeclaration> parameters;
    QualifierList qualifiers;
    const ClassDeclaration* origin = nullptr;
    const ClassDeclaration* declaredIn = nullptr;
    SourcePosition position;
};

// Properties and methods come in the order of their introduction, those of ancestors first; one
// that a subclass declares anew keeps its place. Declarations that a subclass takes over
// unchanged are the same objects there, unless they carry qualifiers that end with their class.
struct ClassDeclaration {
    std::string name;
    const ClassDeclaration* superclass = nullptr; // null at the root
    std::vector<const ClassDeclaration*> subclasses;
    QualifierList qualifiers;
    std::vector<std::shared_ptr<const PropertyDeclaration>> properties;
    std::vector<std::shared_ptr<const MethodDeclaration>> methods;
    // The names of the key properties, in the order of the class that declares them. Never
    // null; shared by the subclasses.
    std::shared_ptr<const std::vector<std::string>> keys;
    bool isAssociation = false;
    bool isIndication = false;
    bool isAbstract = false;
    SourcePosition position;

    // Null when there is none of that name.
    const PropertyDeclaration* property(std::string_view propertyName) const;
    const MethodDeclaration* method(std::string_view methodName) const;

    // Whether the class is derived from the other one, at any distance; not from itself.
    bool isDerivedFrom(std::string_view ancestor) const;
    bool isDerivedFrom(const ClassDeclaration& ancestor) const;
};

} // namespace Host
