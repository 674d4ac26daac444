// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The meanings of codes by the qualifiers ValueMap and Values (DSP0004).

#pragma once

#include <cstdint>
#include <string_view>

namespace Host {
struct ClassDeclaration;
}

namespace Tools {

// Returns the text for a code that the class's property lists; empty for other codes, properties
// without these qualifiers and an unknown class, which is null.
std::string_view meaningOf(
    const Host::ClassDeclaration* declared, std::string_view property, std::uint64_t code);

} // namespace Tools
