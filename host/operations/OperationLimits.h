// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>

namespace Host {

// What clients that open enumerations may take of the object manager. Together the first two
// bound what is kept between requests: a sensor takes four kilobytes.
struct OperationLimits {
    // At one time, of all clients together.
    std::size_t maximumOpenEnumerations = 64;
    // In the memory of open enumerations, all together, with those that were pulled already.
    std::size_t maximumHeldObjects = 100'000;
    // Of one answer. A client that asks for more gets as many and pulls again.
    std::uint32_t maximumObjectCount = 10'000;
    // How long an enumeration stays open when nobody pulls: where the client does not say, and
    // the longest it may say.
    std::chrono::seconds defaultTimeout{60};
    std::chrono::seconds maximumTimeout{600};
};

} // namespace Host
