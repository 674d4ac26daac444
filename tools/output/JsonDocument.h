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

// One object with the members `namespace`, `class` and `instances`; each instance is an object
// with its `path` and its `properties` by name, in the order in which they were set. Numbers
// are numbers, arrays arrays; date-times and references are texts. A property without a value
// is left out. Valid whatever the texts hold: what is no UTF-8 becomes U+FFFD, and characters
// that a terminal might obey are escaped.
void writeJson(
    Output& out, std::string_view className, const std::vector<const Host::Instance*>& instances);

} // namespace Tools
