// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The files that are installed with sensorctl, or built with it. They are found relative to the
// executable, so that an installation may be moved.

#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace Tools {

// Returns the folder that has `lib` and `share`.
std::filesystem::path installationPrefix();

// Executes a program that belongs to sensorctl in place of this process. The first word is the name
// that the program sees as its own. Throws std::system_error naming the file when it cannot be
// executed. REQUIRES: this process is sensorctl.
[[noreturn]] void executeProgram(const char* name, std::vector<std::string> words);

} // namespace Tools
