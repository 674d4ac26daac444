// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/Signals.h"

#include <unistd.h>

#include <ctime>

namespace Tools {

Signals::Signals()
{
    ::sigemptyset(&signals_);
    for (const int number : {SIGTERM, SIGINT, SIGHUP})
        ::sigaddset(&signals_, number);
    ::pthread_sigmask(SIG_BLOCK, &signals_, &before_);
    struct sigaction ignoring {};
    ignoring.sa_handler = SIG_IGN;
    ::sigaction(SIGPIPE, &ignoring, &pipeBefore_);
    ::sigaction(SIGXFSZ, &ignoring, &fileBefore_);
}

Signals::~Signals()
{
    ::sigaction(SIGXFSZ, &fileBefore_, nullptr);
    ::sigaction(SIGPIPE, &pipeBefore_, nullptr);
    ::pthread_sigmask(SIG_SETMASK, &before_, nullptr);
}

int Signals::wait() const
{
    for (;;) {
        const int number = ::sigwaitinfo(&signals_, nullptr);
        if (number > 0)
            return number;
    }
}

std::optional<int> Signals::waitFor(std::chrono::milliseconds timeout) const
{
    const auto whole = std::chrono::duration_cast<std::chrono::seconds>(timeout);
    const timespec limit{whole.count(), std::chrono::nanoseconds(timeout - whole).count()};
    const int number = ::sigtimedwait(&signals_, nullptr, &limit);
    return number > 0 ? std::optional(number) : std::nullopt;
}

void endBySignal(int number)
{
    ::signal(number, SIG_DFL);
    sigset_t one{};
    ::sigemptyset(&one);
    ::sigaddset(&one, number);
    ::pthread_sigmask(SIG_UNBLOCK, &one, nullptr);
    ::raise(number);
    ::_exit(1);
}

} // namespace Tools
