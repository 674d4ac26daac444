// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads the text of one MOF file.

#pragma once

#include "host/repository/SyntaxTree.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// The file's pragmas and declarations in their order. Takes memory and time in proportion to
// the text, whatever it holds. May be called from any thread. Throws MofError with the place in
// `file`, what was expected there and what was found.
std::vector<Syntax::Production> parseMof(
    std::string_view text, const std::shared_ptr<const std::string>& file);

} // namespace Host
