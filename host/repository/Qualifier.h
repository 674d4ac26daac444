// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/repository/Constant.h"
#include "host/repository/Flavor.h"
#include "host/repository/SourcePosition.h"

#include <cmpidt.h>

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// What a namespace says of all qualifiers of a name.
struct QualifierDeclaration {
    std::string name;
    CMPIType type = CMPI_null;
    std::optional<std::uint32_t> arraySize;
    Constant defaultValue; // of elements without the qualifier
    ScopeSet scopes;
    Flavor flavor;
    SourcePosition position;
};

// A qualifier in effect on a class, property, method or parameter.
struct Qualifier {
    const QualifierDeclaration* declaration = nullptr; // never null in a repository
    std::shared_ptr<const Constant> value;             // likewise; shared by those who inherit it
    Flavor flavor;
    bool isPropagated = false; // inherited from the superclass's element
    SourcePosition position;

    const std::string& name() const noexcept { return declaration->name; }
};

// Those an element carries itself come first, then the inherited ones.
using QualifierList = std::vector<Qualifier>;

// Null when there is none of that name.
const Qualifier* findQualifier(const QualifierList& qualifiers, std::string_view name);

// Of a boolean qualifier; false when it is not there.
bool isQualified(const QualifierList& qualifiers, std::string_view name);

// Of a string qualifier; empty when it is not there or null.
std::string_view qualifierText(const QualifierList& qualifiers, std::string_view name);

} // namespace Host
