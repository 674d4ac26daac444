// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/broker/Refusal.h"

#include <string>

namespace Host::CimXml {

// What a call's parameter says cannot be: the operation is answered with an error.
[[noreturn]] inline void refuse(const std::string& reason)
{
    throw Refusal(CMPI_RC_ERR_INVALID_PARAMETER, reason);
}

} // namespace Host::CimXml
