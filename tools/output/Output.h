// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Standard output and standard error, with every failure noticed.

#pragma once

#include <string>
#include <string_view>

namespace Tools {

// Fills the places of standard streams that the caller left closed, so that no file opened
// later is taken for one of them. Reading and writing there fails, as it does on a closed one.
void reserveStandardStreams();

// All of it, whatever the number of calls it takes. Throws std::system_error.
void writeAll(int descriptor, std::string_view text);

// Collects what goes to a descriptor and writes it in large pieces.
class Output {
public:
    explicit Output(int descriptor) : descriptor_(descriptor) {}
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    // Throw std::runtime_error with the reason when the text cannot be written. What was not
    // flushed is not written.
    void write(std::string_view text);
    void flush();

private:
    int descriptor_;
    std::string pending_;
};

// Writes `sensorctl: <text>` as one line to standard error, unprintable characters escaped.
// That nobody listens there is no failure.
void complain(std::string_view text) noexcept;

} // namespace Tools
