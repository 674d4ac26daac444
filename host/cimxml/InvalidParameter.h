// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Refusal.h"

#include <string>

namespace Host::CimXml {

// Throws Refusal (CMPI_RC_ERR_INVALID_PARAMETER).
[[noreturn]] inline void refuse(const std::string& reason)
{
    throw Refusal(CMPI_RC_ERR_INVALID_PARAMETER, reason);
}

} // namespace Host::CimXml
