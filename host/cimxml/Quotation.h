// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <string_view>

namespace Host::CimXml {

// Returns a part of a client's text between quotation marks, as printable ASCII, and cut when it
// is long.
std::string quotation(std::string_view text);

} // namespace Host::CimXml
