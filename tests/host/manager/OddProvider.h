// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the odd provider library tells the test that loads it.

#pragma once

#include <cmpidt.h>

namespace Testing {

struct OddProviderReport {
    int created = 0;
    int cleanedUp = 0;
    int cleanedUpWithContext = 0;
    CMPIrc upcall = CMPI_RC_OK; // of the factory that calls up
};

using OddProviderReportFunction = const OddProviderReport* (*)();

} // namespace Testing
