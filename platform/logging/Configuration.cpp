// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/Configuration.h"

#include "platform/logging/SinkSetting.h"

#include <charconv>
#include <cstdlib>
#include <optional>
#include <string_view>

namespace RynLog {

namespace {

// Empty when the variable is not set.
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

void readLevel(const char* variable, Configuration& configuration)
{
    const std::string value = environmentText(variable);
    if (value.empty())
        return;
    if (const auto level = parseLevel(value))
        configuration.level = *level;
    else
        complain(configuration.problem, variable, value, std::to_string(configuration.level));
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

Configuration configurationFromEnvironment()
{
    Configuration configuration;
    readLevel("RYNLOG_LEVEL", configuration);
    readSink("RYNLOG_LOG", configuration.log, configuration.problem);
    readSink("RYNLOG_TRACE", configuration.trace, configuration.problem);
    return configuration;
}

} // namespace RynLog
