// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Standard output and standard error, with every failure reported.

#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Tools {

// Opens descriptors 0 to 2 where they are closed, so that no file opened later gets one of these
// numbers. Reading and writing them fails, as with a closed one.
void reserveStandardStreams();

// Writes the whole text. Throws std::system_error.
void writeAll(int descriptor, std::string_view text);

// A buffered writer to a descriptor.
class Output {
public:
    explicit Output(int descriptor) : descriptor_(descriptor) {}
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    // Both throw std::runtime_error with the reason when the text cannot be written. The
    // destructor does not flush.
    void write(std::string_view text);
    void flush();

private:
    int descriptor_;
    std::string pending_;
};

// Writes `sensorctl: <text>` and the further lines, which are indented, to standard error, with
// unprintable characters escaped, and to the journal as an error. Ignores failures.
void complain(std::string_view text, const std::vector<std::string>& lines = {}) noexcept;

// Writes `sensorctl: <text>` to standard error, with unprintable characters escaped, and to the
// journal as information. Ignores failures.
void inform(std::string_view text) noexcept;

} // namespace Tools
