// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The destinations of the two channels, and the lowest level that is written.

#pragma once

#include <optional>
#include <string>

namespace RynLog {

struct LogSettings {
    int level = 6000;           // RYNLOG_LEVEL: lowest level written
    std::string log = "syslog"; // RYNLOG_LOG: syslog, stderr, file:PATH or off
    std::string trace = "off";  // RYNLOG_TRACE: the same values
    std::string problem{};      // names invalid settings; empty without any
};

// Reads the environment with secure_getenv; an empty variable counts as not set. An invalid value
// is named in `problem`, and its default is used.
LogSettings settingsFromEnvironment();

// The parsed value of RYNLOG_LOG or RYNLOG_TRACE.
struct SinkSetting {
    enum class Kind { off, syslog, standardError, journal, file };

    Kind kind = Kind::off;
    std::string path{}; // of a file; never empty for one
};

// Parses syslog, stderr, file:PATH and off; returns nothing for any other text.
std::optional<SinkSetting> parseSinkSetting(const std::string& text);

// Returns whether systemd has connected standard error to the journal (JOURNAL_STREAM in
// systemd.exec(5)).
bool isStandardErrorTheJournal();

// Replaces the settings in effect, which are at first those of the environment. Lines that other
// threads are writing are finished with the settings they began with. A `problem` becomes the first
// line of the log channel. A file is created when missing and always appended to; it stays open
// until it is replaced, as by a rotation, until the next call or until the library is unloaded. One
// that cannot be opened or written is
// reported to syslog, once, and the lines of its channel are lost. Throws std::invalid_argument
// naming an invalid sink; nothing is replaced then.
void configure(const LogSettings& settings);

} // namespace RynLog
