// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reading a compiled message catalog (.mo, as GNU gettext defines it) with suspicion.

#pragma once

#include <string>
#include <vector>

namespace Vorn {

// The bytes of a message catalog; empty when there is no such file, when it is not a regular
// file or larger than any catalog of ours could be, and when it is damaged.
std::vector<char> readMessageFile(const std::string& path);

// Whether every offset and length of a catalog lies within it, every text ends with a zero
// character, and its header names UTF-8 and stays short. The parser behind it trusts all that.
bool isSoundMessageFile(const std::vector<char>& bytes);

} // namespace Vorn
