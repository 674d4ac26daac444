// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Writing to a pipe whose reader may be gone.

#pragma once

#include <csignal>
#include <string_view>

namespace RynLog {

// While it lives, a write of this thread to a broken pipe fails with EPIPE instead of ending
// the process. The process's signal handling stays as it is.
class PipeSignalBlocked {
public:
    PipeSignalBlocked() noexcept;
    ~PipeSignalBlocked();
    PipeSignalBlocked(const PipeSignalBlocked&) = delete;
    PipeSignalBlocked& operator=(const PipeSignalBlocked&) = delete;

    // Takes back the signal of a write that failed with EPIPE.
    void discard() const noexcept;

private:
    sigset_t pipeSignal_{};
    sigset_t before_{};
    bool wasPending_ = false; // a signal that is somebody else's business
};

// Writes the bytes, as many as can be written, whoever reads them or has gone. Returns what
// kept the rest from being written, an errno, or 0.
int writeWhole(int descriptor, std::string_view bytes) noexcept;

// One write to the process's standard error, so that lines of several threads stay whole.
void writeToStandardError(std::string_view text) noexcept;

} // namespace RynLog
