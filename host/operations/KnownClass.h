// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string_view>

namespace Host {

class Repository;
struct ClassDeclaration;

// Throws Refusal (CMPI_RC_ERR_INVALID_CLASS) for a class that is not known.
const ClassDeclaration& knownClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className);

// The same; null for no name.
const ClassDeclaration* findNamedClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className);

} // namespace Host
