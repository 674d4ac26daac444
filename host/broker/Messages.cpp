// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Messages.h"

#include "host/broker/Broker.h"
#include "host/broker/String.h"
#include "platform/logging/RynLogger.h"

#include <string>
#include <string_view>

namespace Host {

namespace {

constexpr const char* file = "Messages";

std::string_view textOf(const char* text)
{
    return text == nullptr ? std::string_view{} : text;
}

// Empty also for a handle without an object: a message is not refused for it.
std::string_view textOf(const CMPIString* string)
{
    const String* const object = String::of(string);
    return object == nullptr ? std::string_view{} : object->text().value_or("");
}

// The texts that are there, a blank between them.
std::string joined(std::string_view first, std::string_view second)
{
    std::string result(first);
    if (!first.empty() && !second.empty())
        result += ' ';
    return result.append(second);
}

int levelOf(CMPISeverity severity)
{
    switch (severity) {
    case CMPI_SEV_ERROR:
        return 8000;
    case CMPI_SEV_WARNING:
        return 7000;
    case CMPI_DEV_DEBUG:
        return 3000;
    default:
        return 6000;
    }
}

int levelOf(CMPILevel level)
{
    switch (level) {
    case CMPI_LEV_INFO:
        return 4000;
    case CMPI_LEV_VERBOSE:
        return 3000;
    default:
        return 6000;
    }
}

} // namespace

void logMessage(const Broker&, CMPISeverity severity, const char* id, const char* text,
    const CMPIString* string)
{
    RynLog::RynLogger::logLevelMessage("logMessage", file, __LINE__, "Broker", levelOf(severity),
        nullptr, 0, 0, joined(textOf(id), joined(textOf(text), textOf(string))));
}

void traceMessage(const Broker& broker, CMPILevel level, const char* component, const char* text,
    const CMPIString* string)
{
    const TraceMessage message{level, textOf(component), textOf(text), textOf(string)};
    if (RynLog::RynLogger::isWanted(levelOf(level)))
        RynLog::RynLogger::traceLevelMessage("trace", file, __LINE__,
            std::string(message.component), levelOf(level), nullptr, 0, 0,
            joined(message.text, message.string));
    if (broker.traceObserver())
        broker.traceObserver()(message);
}

} // namespace Host
