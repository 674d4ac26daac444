// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/logging/SyslogCapture.h"

#include <array>
#include <cstdarg>
#include <cstdio>
#include <mutex>
#include <utility>

namespace {

std::mutex guard;
std::vector<Testing::SyslogLine> lines;
int settingsChanged = 0;

__attribute__((format(printf, 2, 0))) void keep(
    int priority, const char* format, std::va_list arguments)
{
    std::array<char, 4096> text{};
    std::vsnprintf(text.data(), text.size(), format, arguments);
    const std::lock_guard lock(guard);
    lines.push_back({priority, text.data()});
}

void countChange()
{
    const std::lock_guard lock(guard);
    ++settingsChanged;
}

} // namespace

// <syslog.h> is not included, as a fortified build defines syslog in it.
extern "C" {

void syslog(int priority, const char* format, ...);
void __syslog_chk(int priority, int flag, const char* format, ...);
void openlog(const char* ident, int option, int facility);
void closelog();
int setlogmask(int mask);

__attribute__((format(printf, 2, 3))) void syslog(int priority, const char* format, ...)
{
    std::va_list arguments;
    va_start(arguments, format);
    keep(priority, format, arguments);
    va_end(arguments);
}

__attribute__((format(printf, 3, 4))) void __syslog_chk(int priority, int, const char* format, ...)
{
    std::va_list arguments;
    va_start(arguments, format);
    keep(priority, format, arguments);
    va_end(arguments);
}

void openlog(const char*, int, int)
{
    countChange();
}

void closelog()
{
    countChange();
}

int setlogmask(int)
{
    countChange();
    return 0;
}
}

namespace Testing {

std::vector<SyslogLine> takeSyslogLines()
{
    const std::lock_guard lock(guard);
    return std::exchange(lines, {});
}

int syslogSettingsChanged()
{
    const std::lock_guard lock(guard);
    return settingsChanged;
}

} // namespace Testing
