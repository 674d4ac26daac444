// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Lists in what OpenPegasus and sfcb differ from this product's service. "Where object managers
// differ" of docs/operations.md has what users notice of it.

#pragma once

#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/ClientRequest.h"

#include <optional>
#include <span>
#include <vector>

namespace Testing {

// Describes an answer in terms of the service: an error, or all that it returns to these requests.
struct Equivalent {
    int error = 0;
    std::vector<ClientRequest> requests = {};
};

// Maps the name of a class to its properties with their defaults.
using Declarations = std::map<std::string, Properties>;

// One of the two functions is null.
struct Difference {
    const char* what;
    // Returns what the answer is equivalent to; nothing where the request is answered alike.
    std::optional<Equivalent> (*equivalentOf)(const ClientRequest&);
    // Changes the service's answer into that of the object manager.
    void (*change)(const ClientRequest&, const Declarations&, Answer&);
};

// Return the differences in the order in which they apply: each to the requests that those before
// it lead to.
std::span<const Difference> differencesOfOpenPegasus();
std::span<const Difference> differencesOfSfcb();

} // namespace Testing
