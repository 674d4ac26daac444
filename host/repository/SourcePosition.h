// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <memory>
#include <string>

namespace Host {

// A place in a MOF file. Lines and columns count from 1, columns in bytes.
struct SourcePosition {
    std::shared_ptr<const std::string> file; // as it was opened; shared by all its places
    std::uint32_t line = 0;
    std::uint32_t column = 0;
};

} // namespace Host
