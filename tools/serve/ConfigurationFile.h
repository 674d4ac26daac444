// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace CLI {
class App;
}

namespace Tools {

// Sets the parser's options from a file of `name = value` lines, except those that the command line
// set. Ignores empty lines and those that begin with #. An option that may be repeated may have
// several lines. Throws UsageError with file, line and reason for any other line that sets no
// option, and std::runtime_error when the file cannot be read.
void applyConfigurationFile(CLI::App& parser, const std::string& file);

} // namespace Tools
