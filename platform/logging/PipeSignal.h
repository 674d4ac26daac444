// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <csignal>
#include <string_view>

namespace RynLog {

// Blocks SIGPIPE on this thread during its lifetime, so that a write to a broken pipe fails with
// EPIPE instead of ending the process. The process's signal handlers are not changed.
class PipeSignalBlocked {
public:
    PipeSignalBlocked() noexcept;
    ~PipeSignalBlocked();
    PipeSignalBlocked(const PipeSignalBlocked&) = delete;
    PipeSignalBlocked& operator=(const PipeSignalBlocked&) = delete;

    // Discards the pending signal of a write that failed with EPIPE.
    void discard() const noexcept;

private:
    sigset_t pipeSignal_{};
    sigset_t before_{};
    bool wasPending_ = false; // a signal that was pending before stays pending
};

// Writes as many of the bytes as can be written. Returns 0, or the errno for which the rest was not
// written.
int writeWhole(int descriptor, std::string_view bytes) noexcept;

// Does the same on the process's standard error, but does not wait for a reader: when a pipe is
// full, the rest is not written (EAGAIN). It blocks only where another process fills the pipe
// between the test and the write, and on a terminal that is suspended. A text of up to PIPE_BUF
// bytes is one write, so that lines of several threads are not interleaved.
int writeToStandardError(std::string_view text) noexcept;

// Does the same, unless RYNLOG_STDERR is `off`, as in programs that report failures themselves.
void reportToStandardError(std::string_view text) noexcept;

} // namespace RynLog
