// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Executes the declarations of one MOF file.

#pragma once

#include "host/repository/ClassBuilder.h"
#include "host/repository/Compiler.h"
#include "host/repository/Literal.h"
#include "host/repository/Namespace.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {

// The parts of a declaration that the parser has read. Optional parts are moved out when they are
// used.
struct DeclarationParts {
    Word pragmaName;
    Word className;
    Word superclass;
    Word propertyName;
    Word typeName;
    Word qualifierName;
    std::string text; // of the string that is being read
    bool isReference = false;
    bool isArray = false;
    Initializer value;
    std::vector<Word> scopes;
    std::vector<Word> flavors;
};

// The parser fills in the parts, in the order of the text, and calls a function at the end of each
// construct. The functions throw tao::pegtl::parse_error for a declaration that contradicts the
// namespace.
class FileCompiler {
public:
    // Appends the classes that references name; the caller has yet to check them.
    FileCompiler(Namespace& nameSpace, std::vector<ReferencedClass>& referencedClasses)
        : nameSpace_(&nameSpace), referencedClasses_(referencedClasses)
    {
    }

    DeclarationParts parts;

    Namespace& nameSpace() const noexcept { return *nameSpace_; }
    void setNamespace(Namespace& nameSpace) noexcept { nameSpace_ = &nameSpace; }

    void endQualifierDeclaration();
    void endQualifier();
    void beginClass();
    void endProperty();
    void endClass();

private:
    CMPIType takeType();

    Namespace* nameSpace_;
    std::vector<ReferencedClass>& referencedClasses_;
    QualifierList qualifiers_; // of the element that is being read
    std::optional<ClassBuilder> class_;
};

} // namespace Host
