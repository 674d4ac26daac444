// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Messages.h"

#include "host/broker/String.h"
#include "platform/logging/RynLogger.h"

#include <string>
#include <string_view>

namespace Host {

namespace {

std::string_view textOf(const char* text)
{
    return text == nullptr ? std::string_view{} : text;
}

// Returns an empty text for a handle without an object, too: the rest of the message is still of
// use.
std::string_view textOf(const CMPIString* string)
{
    const String* const object = String::of(string);
    return object == nullptr ? std::string_view{} : object->text().value_or("");
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

void traceMessage(const Broker&, CMPILevel level, const char* component, const char* text,
    const CMPIString* string)
{
    if (!RynLog::RynLogger::isWanted(levelOf(level)))
        return;
    std::string message(textOf(text));
    if (const std::string_view more = textOf(string); !more.empty())
        message.append(message.empty() ? "" : " ").append(more);
    RynLog::RynLogger::traceLevelMessage("trace", "Messages", __LINE__,
        std::string(textOf(component)), levelOf(level), nullptr, 0, 0, message);
}

} // namespace Host
