// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A library that writes to the log and is unloaded, as a provider library is.

#include "platform/logging/LogSettings.h"
#include "platform/logging/RynLogger.h"

extern "C" __attribute__((visibility("default"))) void logOneLine(const char* path)
{
    const std::string sink = std::string("file:") + path;
    RynLog::configure({6000, sink, sink});
    RynLog::RynLogger::logLevelMessage(
        "logOneLine", "LoggingModule", 1, "Test.Module", 6000, nullptr, 0, 0, "loaded");
}
