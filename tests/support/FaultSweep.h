// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs a request once for each broker call that it makes and each manner in which that call can
// fail.

#pragma once

#include "tests/support/FaultyBroker.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <string>

namespace Testing {

// `request` runs one whole request with the given broker, in a scope of its own, and checks what
// holds whatever fails.
inline void sweepFaults(
    const Host::Broker& broker, const std::function<void(FaultyBroker&)>& request)
{
    std::map<BrokerCall, unsigned> reached;
    {
        FaultyBroker counting(broker);
        request(counting);
        for (const BrokerCall call : allBrokerCalls())
            reached[call] = counting.count(call);
    }
    unsigned runs = 0;
    for (const auto& [call, times] : reached)
        for (unsigned nth = 1; nth <= times; ++nth)
            for (const FaultManner manner : mannersOf(call))
                for (const CMPIrc code : {CMPI_RC_OK, CMPI_RC_ERR_FAILED}) {
                    SCOPED_TRACE(nameOf(call) + " number " + std::to_string(nth) + ": " +
                                 nameOf(manner) + ", code " + std::to_string(code));
                    FaultyBroker faulty(broker);
                    faulty.plan({call, nth, manner, code});
                    request(faulty);
                    EXPECT_EQ(faulty.fired(), 1U);
                    ++runs;
                }
    EXPECT_GT(runs, 0U);
}

} // namespace Testing
