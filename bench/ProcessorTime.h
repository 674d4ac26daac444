// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <ctime>
#include <stdexcept>

#include <sys/types.h>

namespace Bench {

// Returns the time of a clock in milliseconds.
inline double processorTime(::clockid_t clock = CLOCK_PROCESS_CPUTIME_ID)
{
    ::timespec time{};
    ::clock_gettime(clock, &time);
    return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_nsec) / 1e6;
}

// Returns the clock of the processor time of a process. Throws std::runtime_error when it has
// ended.
inline ::clockid_t clockOf(::pid_t process)
{
    ::clockid_t clock{};
    if (::clock_getcpuclockid(process, &clock) != 0)
        throw std::runtime_error("the server has ended");
    return clock;
}

} // namespace Bench
