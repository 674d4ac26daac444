// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The whole tool behind main().

#pragma once

namespace Tools {

// Reads the command line, does what it says and returns the exit code of the process. Messages
// go to standard error, what was asked for to standard output.
int runTool(int argc, const char* const* argv);

} // namespace Tools
