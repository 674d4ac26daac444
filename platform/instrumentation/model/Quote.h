// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Parts of a file in an error message: short, printable, whole characters.

#pragma once

#include <string>
#include <string_view>

namespace Vorn {

// The text, or its beginning and "..." when it is long.
std::string excerpt(std::string_view text);

// The same between quotation marks.
std::string quote(std::string_view text);

} // namespace Vorn
