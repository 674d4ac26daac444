// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/PipeSignal.h"

#include <cerrno>
#include <ctime>

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

} // namespace RynLog
