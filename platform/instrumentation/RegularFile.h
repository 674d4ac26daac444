// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads regular files only: reading a pipe or a device could block or have side effects.

#pragma once

#include "platform/instrumentation/FileStamp.h"

#include <cstddef>
#include <string>

namespace Vorn {

struct FileContent {
    std::string text;
    FileStamp stamp; // taken before the text was read
};

// Throw std::runtime_error with the reason, without the path: the system's text, the kind of a file
// that is not regular, or that the file exceeds the limit.
FileStamp stampOfRegularFile(const std::string& path);
FileContent readRegularFile(const std::string& path, std::size_t limit);

// Returns whether the file will get another stamp when it is written again. A file that has just
// changed might not: the kernel's file times advance in ticks of some milliseconds.
bool isSettled(const FileStamp& stamp);

} // namespace Vorn
