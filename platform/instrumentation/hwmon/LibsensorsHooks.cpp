// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/LibsensorsHooks.h"

#include <sensors/error.h>

#include <atomic>
#include <cstdio>
#include <new>

// The private copy of libsensors has these names for the standard streams and for exit(), which its
// lexer calls, past the hook for fatal errors, when memory is exhausted.
extern "C" {
FILE* sensorsStdin = stdin;
FILE* sensorsStdout = stdout;
FILE* sensorsStderr = stderr;

[[noreturn]] void sensorsExit(int)
{
    throw std::bad_alloc();
}
}

namespace Vorn::Hwmon {

namespace {

// The bound keeps an endless configuration from filling the memory or the log.
constexpr std::size_t maximumParseErrors = 20;

std::atomic<std::vector<LibsensorsHooks::ParseError>*> collected{nullptr};

void collectParseError(const char* error, const char*, int line)
{
    if (auto* list = collected.load(); list != nullptr && list->size() < maximumParseErrors)
        list->push_back({error, line});
}

[[noreturn]] void throwFatalError(const char*, const char*)
{
    throw std::bad_alloc();
}

} // namespace

LibsensorsHooks::LibsensorsHooks()
    : parseError_(sensors_parse_error_wfn), fatalError_(sensors_fatal_error)
{
    sensors_parse_error_wfn = collectParseError;
    sensors_fatal_error = throwFatalError;
}

LibsensorsHooks::~LibsensorsHooks()
{
    // Hooks that other code of the process has set meanwhile are kept.
    if (sensors_parse_error_wfn == collectParseError)
        sensors_parse_error_wfn = parseError_;
    if (sensors_fatal_error == throwFatalError)
        sensors_fatal_error = fatalError_;
}

LibsensorsHooks::ParseErrors::ParseErrors()
{
    collected = &list_;
}

LibsensorsHooks::ParseErrors::~ParseErrors()
{
    collected = nullptr;
}

} // namespace Vorn::Hwmon
