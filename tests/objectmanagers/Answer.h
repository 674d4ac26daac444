// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Asks an object manager with wbemcli, and holds its answer in a form that does not depend on the
// order in which it returns objects, properties and keys.

#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

// Maps the name of a property to its value with its type; no value is NULL.
using Properties = std::map<std::string, std::optional<std::string>>;

struct Answer {
    int error = 0; // a CIM status code; where it is not 0, there are no objects
    // By path, with sorted keys and without the host. Names of objects have no properties. What
    // GetInstance and GetClass return has no path, but the name of the class in its place; what
    // GetProperty returns is the path.
    std::multimap<std::string, Properties> objects = {};

    bool operator==(const Answer&) const = default;
};

// Returns the answer in lines, of which the test framework prints those that differ.
std::string describe(const Answer& answer);

// Sends a request with wbemcli, whose arguments these are, and returns the answer. Throws
// std::runtime_error with what wbemcli printed when there is none.
Answer ask(const std::vector<std::string>& arguments);

} // namespace Testing
