// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LogSettings.h"

#include <charconv>
#include <cstdlib>
#include <string_view>

#include <sys/stat.h>
#include <unistd.h>

namespace RynLog {

namespace {

// Returns an empty text when the variable is not set.
std::string environmentText(const char* variable)
{
    const char* value = ::secure_getenv(variable);
    return value != nullptr ? value : "";
}

std::optional<int> parseLevel(std::string_view text)
{
    int level = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), level);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return level;
}

void complain(
    std::string& problem, const char* variable, const std::string& value, const std::string& taken)
{
    if (!problem.empty())
        problem += "; ";
    problem.append(variable).append("=").append(value);
    problem.append(" makes no sense, ").append(taken).append(" is used instead");
}

void readLevel(const char* variable, LogSettings& settings)
{
    const std::string value = environmentText(variable);
    if (value.empty())
        return;
    if (const auto level = parseLevel(value))
        settings.level = *level;
    else
        complain(settings.problem, variable, value, std::to_string(settings.level));
}

void readSink(const char* variable, std::string& sink, std::string& problem)
{
    const std::string value = environmentText(variable);
    if (value.empty())
        return;
    if (parseSinkSetting(value))
        sink = value;
    else
        complain(problem, variable, value, sink);
}

} // namespace

std::optional<SinkSetting> parseSinkSetting(const std::string& text)
{
    constexpr std::string_view filePrefix = "file:";
    if (text == "off")
        return SinkSetting{SinkSetting::Kind::off};
    if (text == "syslog")
        return SinkSetting{SinkSetting::Kind::syslog};
    if (text == "stderr")
        return SinkSetting{SinkSetting::Kind::standardError};
    if (text.starts_with(filePrefix) && text.size() > filePrefix.size())
        return SinkSetting{SinkSetting::Kind::file, text.substr(filePrefix.size())};
    return std::nullopt;
}

bool isStandardErrorTheJournal()
{
    struct stat status {};
    return ::fstat(STDERR_FILENO, &status) == 0 &&
           environmentText("JOURNAL_STREAM") ==
               std::to_string(status.st_dev) + ":" + std::to_string(status.st_ino);
}

LogSettings settingsFromEnvironment()
{
    LogSettings settings;
    readLevel("RYNLOG_LEVEL", settings);
    readSink("RYNLOG_LOG", settings.log, settings.problem);
    readSink("RYNLOG_TRACE", settings.trace, settings.problem);
    return settings;
}

} // namespace RynLog
