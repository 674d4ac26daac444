// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which properties an operation is about, for providers and for the answer.

#pragma once

#include "host/cimxml/Operation.h"

#include <cmpidt.h>

#include <optional>
#include <string>
#include <vector>

namespace Host {

class Repository;

// The operation's own, its properties spelled as they are declared, each once, without those that
// no class of the namespace has; were all of them such, one stays. There are two differences for
// operations on instances. LocalOnly is put aside, as the standard recommends: a client that
// leaves the flag to its default would get next to nothing of an object whose class inherits
// much. And where DeepInheritance is false, the list is no longer than the named class.
// REQUIRES: the operation's namespace is known.
CimXml::ObjectSelection effectiveSelection(
    const CimXml::Operation& operation, const Repository& classes);

// The CMPI_FLAG_ bits that stand for it.
CMPIFlags flagsOf(const CimXml::Operation& operation);

// A list of properties as providers get it. The names must outlive it.
class PropertyNames {
public:
    explicit PropertyNames(const std::optional<std::vector<std::string>>& names);
    explicit PropertyNames(std::optional<std::vector<std::string>>&&) = delete;
    // Of one property.
    explicit PropertyNames(const std::string& name) : names_{name.c_str(), nullptr} {}

    // Ends with a null; null for all properties.
    const char** get() { return names_.empty() ? nullptr : names_.data(); }

private:
    std::vector<const char*> names_;
};

} // namespace Host
