// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The words of MOF that stand for a type, a scope or a flavor, without regard to letter case.

#pragma once

#include "host/repository/Flavor.h"

#include <cmpidt.h>

#include <string>
#include <string_view>

namespace Host {

// REQUIRES: it is such a word.
CMPIType dataTypeNamed(std::string_view word);
Scope scopeNamed(std::string_view word);
FlavorChange flavorNamed(std::string_view word);

// As MOF writes it: `uint16[]`; references as `ref`.
std::string nameOfType(CMPIType type);

// The word of one scope.
std::string_view nameOfScope(Scope scope);

} // namespace Host
