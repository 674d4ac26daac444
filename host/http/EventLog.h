// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Writes the server's messages to the log. Since parts of them come from clients, bytes that are no
// UTF-8 and characters that change how others are displayed appear as numbers, such as <0xE9> and
// <U+202E>. Thread-safe.

#pragma once

#include "platform/logging/RynLogger.h"

#include <string>
#include <string_view>

namespace Host::Http {

using RynLog::Severity;

struct Place {
    const char* function;
    const char* file;
    unsigned line;
};

// Writes a message for the administrator.
void report(
    const Place& place, std::string_view text, Severity severity = Severity::warning) noexcept;

// Writes a detail about a single client or request. By default, the log level suppresses details.
void reportDetail(const Place& place, std::string_view text) noexcept;
// Returns whether details are written at the current log level.
bool areDetailsLogged() noexcept;

// Returns why the log could not write the last line; empty when it could.
std::string logProblem() noexcept;

} // namespace Host::Http
