// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Refusal.h"
#include "host/operations/FoundObjects.h"

#include <string>

namespace Host {

// Runs an operation that delivers to a sink and adds what it has delivered. Throws Refusal
// (CMPI_RC_ERR_FAILED) when it could not deliver an object, which the response would lack.
template <typename Operation>
void addWhole(FoundObjects& found, const Operation& operation)
{
    CollectedResult result;
    operation(result);
    if (result.refused() != 0)
        throw Refusal(CMPI_RC_ERR_FAILED,
            "the provider could not build " + std::to_string(result.refused()) + " of the objects");
    found.add(result);
}

} // namespace Host
