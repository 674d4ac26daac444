// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sys/stat.h>

namespace Testing {

// Sets the mask of the permissions of new files for its lifetime.
class Umask {
public:
    explicit Umask(::mode_t mask) : before_(::umask(mask)) {}
    ~Umask() { ::umask(before_); }
    Umask(const Umask&) = delete;
    Umask& operator=(const Umask&) = delete;

private:
    ::mode_t before_;
};

} // namespace Testing
