// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a MOF file says, before anything of it is checked against what else is declared.

#pragma once

#include "host/repository/Flavor.h"
#include "host/repository/SourcePosition.h"

#include <cmpidt.h>

#include <cstdint>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace Host::Syntax {

struct Name {
    std::string text;
    SourcePosition position;
};

struct Integer {
    bool isNegative = false;
    std::uint64_t magnitude = 0;
};

struct Character {
    char16_t unit = 0;
};

struct Literal {
    std::variant<std::monostate, bool, Integer, double, Character, std::string> value; // null first
    SourcePosition position;
};

struct Initializer {
    bool isArray = false;
    std::vector<Literal> elements; // exactly one unless it is an array
    SourcePosition position;
};

struct Type {
    CMPIType code = CMPI_null; // CMPI_ref for a reference; with CMPI_ARRAY for an array
    std::string referenceClass;
    std::optional<std::uint32_t> arraySize; // of an array of fixed size
    SourcePosition position;
};

struct FlavorWord {
    FlavorChange change;
    SourcePosition position;
};

struct Qualifier {
    Name name;
    std::optional<Initializer> value;
    std::vector<FlavorWord> flavors;
};

struct QualifierType {
    Name name;
    Type type;
    std::optional<Initializer> value;
    ScopeSet scopes;
    std::vector<FlavorWord> flavors;
};

struct Property {
    std::vector<Qualifier> qualifiers;
    Type type;
    Name name;
    std::optional<Initializer> value;
};

struct Parameter {
    std::vector<Qualifier> qualifiers;
    Type type;
    Name name;
};

struct Method {
    std::vector<Qualifier> qualifiers;
    Type type;
    Name name;
    std::vector<Parameter> parameters;
};

struct Class {
    std::vector<Qualifier> qualifiers;
    Name name;
    std::optional<Name> superclass;
    std::vector<Property> properties;
    std::vector<Method> methods;
};

struct Pragma {
    Name name;
    std::string argument;
    SourcePosition argumentPosition;
};

using Production = std::variant<Pragma, QualifierType, Class>;

} // namespace Host::Syntax
