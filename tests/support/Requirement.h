// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace Testing {

// Ends a test that cannot run here: `return cannotRun(...)`, also in SetUp. The test is skipped; in
// CI, which runs all tests, it fails.
inline void cannotRun(const std::string& reason)
{
    if (std::getenv("CI") != nullptr)
        FAIL() << reason << "; CI must not skip";
    GTEST_SKIP() << reason;
}

} // namespace Testing
