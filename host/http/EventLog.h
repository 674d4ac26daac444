// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the server says to the log. Parts of it are what clients say: bytes that are no UTF-8 and
// characters that change how others are shown appear as their numbers, such as <0xE9> and <U+202E>.

#pragma once

#include <string>

namespace Host::Http {

struct Place {
    const char* function;
    const char* file;
    unsigned line;
};

// For the administrator. Any thread.
void report(const Place& place, const std::string& text) noexcept;

// For those who look for the reason of trouble with one client, or for what clients do; as a rule
// not written.
void mention(const Place& place, const std::string& text) noexcept;
// Whether a text for that need be composed.
bool isMentionWanted() noexcept;

// Why the log does not take what is said, in words; empty when it took the last line.
std::string logProblem() noexcept;

} // namespace Host::Http
