// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <thread>

namespace Testing {

// Waits until the condition holds; returns false when it does not hold within the timeout.
template <typename Condition>
bool waitUntil(const Condition& holds, std::chrono::seconds timeout = std::chrono::seconds(30))
{
    const auto end = std::chrono::steady_clock::now() + timeout;
    while (!holds()) {
        if (std::chrono::steady_clock::now() > end)
            return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    return true;
}

} // namespace Testing
