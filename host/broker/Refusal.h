// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The exception of the broker's own code, which the called slot converts to a CMPI status.

#pragma once

#include <cmpidt.h>

#include <stdexcept>
#include <string>

namespace Host {

class Refusal : public std::runtime_error {
public:
    Refusal(CMPIrc code, const std::string& reason) : std::runtime_error(reason), code_(code) {}

    CMPIrc code() const noexcept { return code_; }

private:
    CMPIrc code_;
};

} // namespace Host
