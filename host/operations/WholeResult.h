// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Refusal.h"
#include "host/operations/FoundObjects.h"

#include <string>

namespace Host {

// Runs what delivers to a sink and adds all it has delivered. Throws Refusal (CMPI_RC_ERR_FAILED)
// when something delivered was no object: an answer that lacks it would not be true.
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
