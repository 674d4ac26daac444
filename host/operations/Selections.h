// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The properties that an operation selects, for providers and for the response.

#pragma once

#include "host/cimxml/Operation.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {

class Repository;

// Returns the operation's selection, its properties spelled as they are declared, each once,
// without those that no class of the namespace has; if there are only such, one stays. Operations
// on instances ignore LocalOnly, as DSP0200 recommends: by its default a client would get next to
// nothing of an object whose class inherits much. Where their DeepInheritance is false, the
// properties are limited to those of the named class.
// REQUIRES: the operation's namespace is known.
CimXml::ObjectSelection effectiveSelection(
    const CimXml::Operation& operation, const Repository& classes);

// A property list as CMPI passes it to providers. The names must outlive it.
class PropertyNames {
public:
    explicit PropertyNames(const std::optional<std::vector<std::string>>& names);
    explicit PropertyNames(std::optional<std::vector<std::string>>&&) = delete;
    // A list of one property.
    explicit PropertyNames(const std::string& name) : names_{name.c_str(), nullptr} {}

    // Returns the list, which ends with a null; null for all properties.
    const char** get() { return names_.empty() ? nullptr : names_.data(); }

private:
    std::vector<const char*> names_;
};

} // namespace Host
