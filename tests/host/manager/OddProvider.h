// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The report of the odd provider library to the test that loads it.

#pragma once

#include <cmpidt.h>

namespace Testing {

struct OddProviderReport {
    int created = 0;
    int cleanedUp = 0;
    int cleanedUpWithContext = 0;
    CMPIrc upcall = CMPI_RC_OK; // what the up-call of a factory returned
};

using OddProviderReportFunction = const OddProviderReport* (*)();

} // namespace Testing
