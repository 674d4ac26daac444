// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CIM instances as a JSON document.

#pragma once

#include <string_view>
#include <vector>

namespace Host {
class Instance;
}

namespace Tools {

class Output;

// Writes an object with the members `namespace`, `class` and `instances`; each instance is an
// object with its `path` and its `properties` by name, in the order in which they were set.
// Date-times and references are strings; a property without a value is left out. Invalid UTF-8
// becomes U+FFFD, and unprintable characters are escaped.
void writeJson(
    Output& out, std::string_view className, const std::vector<const Host::Instance*>& instances);

} // namespace Tools
