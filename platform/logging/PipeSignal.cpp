// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/PipeSignal.h"

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <ctime>

#include <poll.h>
#include <unistd.h>

namespace RynLog {

PipeSignalBlocked::PipeSignalBlocked() noexcept
{
    ::sigemptyset(&pipeSignal_);
    ::sigaddset(&pipeSignal_, SIGPIPE);
    ::pthread_sigmask(SIG_BLOCK, &pipeSignal_, &before_);
    sigset_t pending{};
    wasPending_ = ::sigpending(&pending) == 0 && ::sigismember(&pending, SIGPIPE) == 1;
}

PipeSignalBlocked::~PipeSignalBlocked()
{
    ::pthread_sigmask(SIG_SETMASK, &before_, nullptr);
}

void PipeSignalBlocked::discard() const noexcept
{
    if (wasPending_)
        return;
    const timespec now{};
    while (::sigtimedwait(&pipeSignal_, nullptr, &now) < 0 && errno == EINTR) {}
}

int writeWhole(int descriptor, std::string_view bytes) noexcept
{
    const PipeSignalBlocked pipeSignal;
    int error = 0;
    while (!bytes.empty() && error == 0) {
        const ssize_t written = ::write(descriptor, bytes.data(), bytes.size());
        if (written > 0)
            bytes.remove_prefix(static_cast<std::size_t>(written));
        else if (written == 0)
            error = EIO;
        else if (errno != EINTR)
            error = errno;
    }
    if (error == EPIPE)
        pipeSignal.discard();
    return error;
}

// The descriptor stays blocking, since other processes share its open file description.
int writeToStandardError(std::string_view text) noexcept
{
    int error = 0;
    while (!text.empty() && error == 0) {
        ::pollfd state{STDERR_FILENO, POLLOUT, 0};
        if (::poll(&state, 1, 0) != 1)
            return EAGAIN;
        const std::string_view piece = text.substr(0, PIPE_BUF);
        error = writeWhole(STDERR_FILENO, piece);
        text.remove_prefix(piece.size());
    }
    return error;
}

void reportToStandardError(std::string_view text) noexcept
{
    const char* const setting = ::secure_getenv("RYNLOG_STDERR");
    if (setting == nullptr || std::string_view(setting) != "off")
        writeToStandardError(text);
}

} // namespace RynLog
