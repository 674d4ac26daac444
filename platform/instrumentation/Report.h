// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/logging/RynLogger.h"

#include <string>

namespace Vorn {

constexpr int messageLevel = 6000;

// Writes a line to the log channel. `module` is the name of the calling file without folder and
// extension. The defaults are the function and line of the call.
inline void report(const char* module, const std::string& text,
    const char* function = __builtin_FUNCTION(),
    unsigned line = static_cast<unsigned>(__builtin_LINE())) noexcept
{
    RynLog::RynLogger::logLevelMessage(
        function, module, line, "Nimbrel.Instrumentation", messageLevel, nullptr, 0, 0, text);
}

} // namespace Vorn
