// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/RynLogger.h"

#include "platform/logging/Channels.h"

namespace RynLog {

namespace {

Severity severityOf(int level)
{
    return level >= messageLevel ? Severity::warning : Severity::debug;
}

void write(Channel Channels::*channel, int level, Severity severity, const Origin& origin,
    const std::string& component, const std::string& text) noexcept
try {
    if (!anyChannelWants(level))
        return;
    const auto channels = activeChannels();
    if (channels && level >= channels->level && ((*channels).*channel).isOpen())
        ((*channels).*channel).write(level, severity, origin, component, text);
} catch (...) {
    // The line is lost: diagnostics never make their caller fail.
}

} // namespace

void RynLogger::logLevelMessage(const char* function, const char* file, unsigned line,
    const std::string& component, int level, const char*, int, int,
    const std::string& text) noexcept
{
    write(&Channels::log, level, severityOf(level), {function, file, line}, component, text);
}

void RynLogger::logMessage(Severity severity, const char* function, const char* file, unsigned line,
    const std::string& component, const std::string& text) noexcept
{
    write(&Channels::log, messageLevel, severity, {function, file, line}, component, text);
}

void RynLogger::traceLevelMessage(const char* function, const char* file, unsigned line,
    const std::string& component, int level, const char*, int, int,
    const std::string& text) noexcept
{
    write(&Channels::trace, level, severityOf(level), {function, file, line}, component, text);
}

bool RynLogger::isWanted(int level) noexcept
{
    return anyChannelWants(level);
}

std::string RynLogger::logProblem() noexcept
try {
    const auto channels = activeChannels();
    return channels ? channels->log.problem() : std::string();
} catch (...) {
    return {};
}

} // namespace RynLog
