// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A class with its inherited properties and qualifiers, as a repository returns it.

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
    CMPIType type = CMPI_null;  // with CMPI_ARRAY for an array
    std::string referenceClass; // of a reference
    Constant defaultValue;      // null when none is given
    QualifierList qualifiers;
    bool isKey = false;
    const ClassDeclaration* origin = nullptr;     // the class that introduced it
    const ClassDeclaration* declaredIn = nullptr; // the class that declared it last

    bool isReference() const noexcept { return type == CMPI_ref; }
};

// Properties come in the order of their introduction, those of ancestors first; one that a
// subclass overrides keeps its place. A subclass shares the declarations that it inherits
// unchanged, unless they carry qualifiers that are not inherited.
struct ClassDeclaration {
    std::string name;
    const ClassDeclaration* superclass = nullptr; // null at the root
    std::vector<const ClassDeclaration*> subclasses;
    QualifierList qualifiers;
    std::vector<std::shared_ptr<const PropertyDeclaration>> properties;
    std::vector<std::string> keys; // in the order of the class that declares them
    bool isAssociation = false;

    // Returns null when there is none of that name.
    const PropertyDeclaration* property(std::string_view propertyName) const;

    // Returns whether the class is derived from the other one, at any distance; not from itself.
    bool isDerivedFrom(std::string_view ancestor) const;
    bool isDerivedFrom(const ClassDeclaration& ancestor) const;
};

} // namespace Host
