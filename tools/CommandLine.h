// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The tool as a function that main() calls.

#pragma once

namespace Tools {

// Parses and executes the command line, and returns the exit code of the process. Messages go to
// standard error, results to standard output.
int runTool(int argc, const char* const* argv);

} // namespace Tools
