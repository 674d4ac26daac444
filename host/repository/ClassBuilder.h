// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Builds a class from its declaration and its superclass.

#pragma once

#include "host/repository/ClassDeclaration.h"
#include "host/repository/Literal.h"

#include <memory>

namespace Host {

class ClassBuilder {
public:
    // The superclass is null for a class at the root.
    ClassBuilder(std::string name, const ClassDeclaration* superclass, QualifierList qualifiers);

    // Adds a property with the qualifiers that its declaration carries, or overrides the inherited
    // one. Throws tao::pegtl::parse_error with that position when the class has declared it
    // already, and unless it carries Override exactly when it is inherited.
    void add(PropertyDeclaration property, const SourcePosition& position);

    // Moves the class to the caller. The builder can only be destroyed afterwards.
    std::unique_ptr<ClassDeclaration> finish();

private:
    std::unique_ptr<ClassDeclaration> class_;
    std::vector<std::string> ownKeys_;
};

} // namespace Host
