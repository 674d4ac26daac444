// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Model files: descriptions of a machine's sensors that stand in for the machine.

#pragma once

#include <string>

namespace Vorn {

// Returns when the file can be served as a source. Throws std::runtime_error naming the file,
// the place in it (a JSON pointer, or line and column where it is no JSON) and the reason.
void checkModelFile(const std::string& path);

// The entry that makes VORN_INSTRUMENTATION serve the file, whatever characters its name holds.
std::string modelFileEntry(const std::string& path);

} // namespace Vorn
