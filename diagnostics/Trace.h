// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Trace lines: their formats, the marks around every request, and the function that writes a trace
// point to the log channel and the trace channel.
//
// Every function may be called from any thread; each thread formats lines in its own buffers.

#pragma once

#include "platform/logging/RynLogger.h"
#include "platform/logging/RynMessageBuffer.h"

#include <array>
#include <cstddef>
#include <cstdio>
#include <string>

namespace Vorn {

// Selects the format of a trace line; a value other than the last three formats as Entering.
enum MessageType : int { Entering = 0, Exiting = 1, Method = 2, Message = 3 };

// The levels of trace lines, by which the logging library filters them.
enum TraceLevel : int { markWithParametersLevel = 3000, markLevel = 4000, failureLevel = 6000 };

// A line is truncated to one character less.
inline constexpr std::size_t traceBufferSize = 512;
using TraceBuffer = std::array<char, traceBufferSize>;

namespace detail {

// Formats a line of the type; the parameter list and its label are empty in a line without one.
inline char* format(TraceBuffer& buffer, const char* text, const char* file, unsigned line,
    const char* label, const char* list, MessageType type)
{
    buffer.fill('\0');
    switch (type) {
    case Method:
        std::snprintf(buffer.data(), buffer.size(), "METHOD: %s() was invoked in %s [Line: %u]%s%s",
            text, file, line, label, list);
        break;
    case Message:
        std::snprintf(buffer.data(), buffer.size(), "MESSAGE [File: %s, Line: %u]: %s%s%s", file,
            line, text, label, list);
        break;
    case Exiting:
        std::snprintf(buffer.data(), buffer.size(), "EXITING: %s() in %s [Line: %u]%s%s", text,
            file, line, label, list);
        break;
    case Entering:
    default:
        std::snprintf(buffer.data(), buffer.size(), "ENTERING: %s() in %s [Line: %u]%s%s", text,
            file, line, label, list);
        break;
    }
    return buffer.data();
}

} // namespace detail

// Formats a line into the calling thread's trace buffer, which the next call overwrites.
// `text` is the function's name or the message, `file` the calling module's name.
inline char* trace(const char* text, const char* file, unsigned line, MessageType type)
{
    static thread_local TraceBuffer buffer;
    return detail::format(buffer, text, file, line, "", "", type);
}

// Formats a line with a parameter list into a second buffer of the thread.
inline char* tracepara(
    const char* text, const char* file, unsigned line, const char* parameters, MessageType type)
{
    static thread_local TraceBuffer buffer;
    return detail::format(
        buffer, text, file, line, ",Parameters List: ", parameters ? parameters : "(null)", type);
}

// The source location that the logging library writes with a trace point.
struct TraceLocation {
    const char* function;
    const char* file;
    unsigned line;
};

// Writes one trace point to the log channel, then to the trace channel. `line` formats the text; it
// is called once for each channel, or not at all when neither writes the level.
template <typename Line>
void emit(const TraceLocation& at, const std::string& component, int level, const Line& line)
{
    if (!RynLog::RynLogger::isWanted(level))
        return;
    RynLog::RynMessageBuffer buffer;
    buffer << line();
    RynLog::RynLogger::logLevelMessage(
        at.function, at.file, at.line, component, level, nullptr, 0, 0, buffer.str());
    buffer << line();
    RynLog::RynLogger::traceLevelMessage(
        at.function, at.file, at.line, component, level, nullptr, 0, 0, buffer.str());
}

namespace detail {

inline constexpr const char* traceFile = "Trace";

// The line numbers in the marks. Monitoring scripts match them, so they are an interface: they do
// not follow the source.
inline constexpr unsigned entrySeparatorLine = 336;
inline constexpr unsigned enteringLine = 337;
inline constexpr unsigned exitingLine = 348;
inline constexpr unsigned exitSeparatorLine = 349;

// Returns the line of 78 equals signs that separates requests.
inline const char* separator()
{
    return "==============================================================================";
}

} // namespace detail

// Marks the start of a request with a separator and the handler's entering line.
inline void markProviderEntry(
    const std::string& component, const char* function, const char* file, unsigned line)
{
    emit({"markProviderEntry", detail::traceFile, detail::entrySeparatorLine}, component, markLevel,
        detail::separator);
    emit({"markProviderEntry", detail::traceFile, detail::enteringLine}, component, markLevel,
        [&] { return trace(function, file, line, Entering); });
}

// Marks the end of a request with the handler's exiting line and a separator.
inline void markProviderExit(
    const std::string& component, const char* function, const char* file, unsigned line)
{
    emit({"markProviderExit", detail::traceFile, detail::exitingLine}, component, markLevel,
        [&] { return trace(function, file, line, Exiting); });
    emit({"markProviderExit", detail::traceFile, detail::exitSeparatorLine}, component, markLevel,
        detail::separator);
}

} // namespace Vorn
