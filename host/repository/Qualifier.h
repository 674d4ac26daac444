// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Qualifiers (DSP0004, 5.6): their declarations, and those in effect on an element.

#pragma once

#include "host/repository/Constant.h"

#include <cmpidt.h>

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// The kinds of elements that a qualifier may apply to.
enum class Scope : std::uint8_t {
    classes = 1,
    association = 2,
    indication = 4,
    property = 8,
    reference = 16,
    method = 32,
    parameter = 64,
    any = 127,
};

class ScopeSet {
public:
    constexpr void add(Scope scope)
    {
        bits_ = static_cast<std::uint8_t>(bits_ | static_cast<std::uint8_t>(scope));
    }
    constexpr bool has(Scope scope) const
    {
        return (bits_ & static_cast<std::uint8_t>(scope)) != 0;
    }

private:
    std::uint8_t bits_ = 0;
};

// The defaults are those of DSP0004 for a qualifier declared without flavors.
struct Flavor {
    bool isOverridable = true; // EnableOverride: a subclass may give it another value
    bool isInherited = true;   // ToSubclass, else Restricted
    bool isTranslatable = false;

    bool operator==(const Flavor&) const = default;
};

struct QualifierDeclaration {
    std::string name;
    CMPIType type = CMPI_null;
    Constant defaultValue; // of elements without the qualifier
    ScopeSet scopes;
    Flavor flavor;
};

// A qualifier in effect on a class or property.
struct Qualifier {
    const QualifierDeclaration* declaration = nullptr; // owned by the namespace; never null
    Constant value;
    bool isPropagated = false; // inherited from the superclass's element

    const std::string& name() const noexcept { return declaration->name; }
    const Flavor& flavor() const noexcept { return declaration->flavor; }
};

// The qualifiers that an element specifies itself precede the inherited ones.
using QualifierList = std::vector<Qualifier>;

// Returns null when there is none of that name.
const Qualifier* findQualifier(const QualifierList& qualifiers, std::string_view name);

// Returns the value of a boolean qualifier; false when it is absent.
bool isQualified(const QualifierList& qualifiers, std::string_view name);

// Returns the value of a string qualifier; empty when it is absent or null.
std::string_view qualifierText(const QualifierList& qualifiers, std::string_view name);

} // namespace Host
