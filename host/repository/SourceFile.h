// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The texts of MOF files.

#pragma once

#include <cstddef>
#include <filesystem>
#include <functional>
#include <string>

namespace Host {

inline constexpr std::size_t maximumSourceSize = std::size_t{4} << 20U;

// Gives the text of a file; throws std::runtime_error with the reason alone when it cannot.
using SourceReader = std::function<std::string(const std::filesystem::path& file)>;

// Reads a regular file of the maximum size or less, and nothing else: a pipe or a device could
// block.
std::string readSourceFile(const std::filesystem::path& file);

} // namespace Host
