// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>

namespace Host {

// Limits of open enumerations. The first two bound the memory that is held between requests: a
// sensor takes four kilobytes.
struct OperationLimits {
    // The number of enumerations that all clients have open.
    std::size_t maximumOpenEnumerations = 64;
    // The number of objects in the memory of all of them, with those that were pulled already.
    std::size_t maximumHeldObjects = 100'000;
    // The number of objects in one response, to which a greater MaxObjectCount is reduced.
    std::uint32_t maximumObjectCount = 10'000;
    // OperationTimeout where the client gives none, and the longest it may give.
    std::chrono::seconds defaultTimeout{60};
    std::chrono::seconds maximumTimeout{600};
};

} // namespace Host
