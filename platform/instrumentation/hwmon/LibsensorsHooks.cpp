// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/LibsensorsHooks.h"

#include <sensors/error.h>
#include <sys/stat.h>

#include <atomic>
#include <cstdio>
#include <new>
#include <string_view>

// The private copy of libsensors has these names for the standard streams, for exit(), which its
// lexer calls, past the hook for fatal errors, when memory is exhausted, and for stat().
extern "C" {
FILE* sensorsStdin = stdin;
FILE* sensorsStdout = stdout;
FILE* sensorsStderr = stderr;

[[noreturn]] void sensorsExit(int)
{
    throw std::bad_alloc();
}

// Takes all attributes of chips for readable. libsensors asks for the mode of each when it lists
// them, so that it need not try to read those that nobody may read. The kernel refuses to open such
// an attribute, even for root, and asking takes half as long as reading all the attributes.
int sensorsStat(const char* path, struct stat* status)
{
    if (!std::string_view(path).starts_with("/sys/class/hwmon/"))
        return ::stat(path, status);
    *status = {};
    status->st_mode = S_IFREG | S_IRUSR;
    return 0;
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
