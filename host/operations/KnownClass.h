// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string_view>

namespace Host {

class Repository;
struct ClassDeclaration;

// Returns the class. Throws Refusal (CMPI_RC_ERR_INVALID_CLASS) when there is none of the name.
const ClassDeclaration& knownClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className);

// Returns the same; null for an empty name.
const ClassDeclaration* findNamedClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className);

} // namespace Host
