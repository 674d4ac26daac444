// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>

namespace Host {

// Limits of open enumerations. The first two bound the memory that is held between requests: a
// sensor takes four kilobytes.
struct OperationLimits {
    // Of all clients.
    std::size_t maximumOpenEnumerations = 64;
    // In the memory of all open enumerations, with the objects that were pulled already.
    std::size_t maximumHeldObjects = 100'000;
    // Of one response; MaxObjectCount above it is cut to it.
    std::uint32_t maximumObjectCount = 10'000;
    // OperationTimeout where the client gives none, and the longest it may give.
    std::chrono::seconds defaultTimeout{60};
    std::chrono::seconds maximumTimeout{600};
};

} // namespace Host
