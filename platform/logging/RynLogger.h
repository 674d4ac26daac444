// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The two channels a library writes its lines to: the log channel and the trace channel.

#pragma once

#include <string>

namespace RynLog {

// How important a line is to syslog and the journal, numbered as in RFC 5424.
enum class Severity { error = 3, warning = 4, information = 6, debug = 7 };

// Levels in use: 3000 marks with parameters, 4000 marks without, 6000 messages; a higher
// number is more important. Lines below the wanted level are dropped.
//
// A line in a file or on standard error has the UTC time, the channel, the level, the component,
// the function with file and line, and the text:
//
//     2026-11-21T01:02:03.000004Z log 6000 Nimbrel.Sensor setVector(Sensor:740) text
//
// In a file it is written by one system call, on standard error in pieces of PIPE_BUF bytes. In
// every text of a line a newline appears as \n, another control character as \xNN and a backslash
// as \\, so that no text can look like a second line. In syslog the line begins with the channel
// (syslog has a clock of its own); facility daemon, severity warning from level 6000 up, debug
// below. The identity under which the process writes to syslog is left as the process set it.
//
// Where standard error is the systemd journal, the line begins with its severity (sd-daemon(3)) and
// has no time; messages of the log channel are the text alone, unless lower levels are written,
// too.
//
// Every function may be called from any thread and never throws: a line that cannot be
// written is lost. A null text is written as (null).
class RynLogger {
public:
    // Writes one line to the log channel. `function`, `file` and `line` say where it comes
    // from. The three arguments after the level are reserved: pass nullptr, 0, 0.
    static void logLevelMessage(const char* function, const char* file, unsigned line,
        const std::string& component, int level, const char* reservedText, int reservedFirst,
        int reservedSecond, const std::string& text) noexcept;

    // Writes a message (level 6000) of another severity than a warning to the log channel.
    static void logMessage(Severity severity, const char* function, const char* file, unsigned line,
        const std::string& component, const std::string& text) noexcept;

    // Writes one line to the trace channel, with the same arguments as logLevelMessage().
    static void traceLevelMessage(const char* function, const char* file, unsigned line,
        const std::string& component, int level, const char* reservedText, int reservedFirst,
        int reservedSecond, const std::string& text) noexcept;

    // Whether a line of the level would be written to either channel. Costs one relaxed atomic
    // load, so that callers can avoid formatting lines that are not written.
    static bool isWanted(int level) noexcept;

    // Returns why the log channel's file could not be opened or its last line not be written; empty
    // without an error.
    static std::string logProblem() noexcept;
};

} // namespace RynLog
