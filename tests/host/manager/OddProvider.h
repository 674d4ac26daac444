// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the odd provider library tells the test that loads it.

#pragma once

namespace Testing {

struct OddProviderReport {
    int created = 0;
    int cleanedUp = 0;
    int cleanedUpWithContext = 0;
};

using OddProviderReportFunction = const OddProviderReport* (*)();

} // namespace Testing
