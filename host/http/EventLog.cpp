// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/EventLog.h"

#include "platform/logging/RynLogger.h"

namespace Host::Http {

namespace {

constexpr int levelOfMessages = 6000;
constexpr int levelOfDetails = 4000;

void writeLine(const Place& place, int level, const std::string& text) noexcept
{
    try {
        RynLog::RynLogger::logLevelMessage(
            place.function, place.file, place.line, "Http", level, nullptr, 0, 0, text);
    } catch (...) {
        // No memory for the component's name: the line is lost.
        return;
    }
}

} // namespace

void report(const Place& place, const std::string& text) noexcept
{
    writeLine(place, levelOfMessages, text);
}

void mention(const Place& place, const std::string& text) noexcept
{
    if (RynLog::RynLogger::isWanted(levelOfDetails))
        writeLine(place, levelOfDetails, text);
}

std::string logProblem() noexcept
{
    return RynLog::RynLogger::logProblem();
}

} // namespace Host::Http
