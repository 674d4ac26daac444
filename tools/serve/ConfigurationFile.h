// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A file of `name = value` lines that stand for options of the same names.

#pragma once

#include <string>

namespace CLI {
class App;
}

namespace Tools {

// Gives the parser's options what the file says, as if it had been typed; what was typed counts
// instead where it was. Empty lines and those that begin with # count for nothing. An option that
// may be typed several times may have several lines. Throws UsageError with file, line and reason
// for any other line that makes no sense, std::runtime_error when the file cannot be read.
void applyConfigurationFile(CLI::App& parser, const std::string& file);

} // namespace Tools
