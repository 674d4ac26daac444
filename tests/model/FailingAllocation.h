// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Replaces the global allocation functions of the executable that it is linked into.

#pragma once

#include <cstddef>

namespace Testing {

// Makes allocations of exactly this size fail on this thread during its lifetime.
class FailingAllocation {
public:
    explicit FailingAllocation(std::size_t size);
    ~FailingAllocation();
    FailingAllocation(const FailingAllocation&) = delete;
    FailingAllocation& operator=(const FailingAllocation&) = delete;
};

} // namespace Testing
