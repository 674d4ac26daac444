// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Refusal.h"
#include "host/operations/FoundObjects.h"

#include <string>

namespace Host {

// Adds all that providers delivered. Throws Refusal (CMPI_RC_ERR_FAILED) when a part of it was no
// object, which the response would lack.
inline void addWhole(FoundObjects& found, const CollectedResult& result)
{
    if (result.refused() != 0)
        throw Refusal(CMPI_RC_ERR_FAILED,
            "the provider could not build " + std::to_string(result.refused()) + " of the objects");
    found.add(result);
}

} // namespace Host
