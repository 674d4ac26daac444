// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The log channel and the trace channel with the settings in effect.

#pragma once

#include "platform/logging/LineFormat.h"
#include "platform/logging/LogSettings.h"
#include "platform/logging/RynLogger.h"

#include <memory>
#include <mutex>
#include <string>
#include <string_view>

namespace spdlog {
class logger;
}

namespace RynLog {

// The level of messages, the least important ones that are written by default.
inline constexpr int messageLevel = 6000;

// Writes lines under its name to a sink. Thread-safe.
class Channel {
public:
    // In the journal, a brief channel writes messages without their origin. Throws
    // std::invalid_argument when the setting is invalid.
    Channel(std::string name, const std::string& setting, bool isBrief);
    ~Channel();
    Channel(const Channel&) = delete;
    Channel& operator=(const Channel&) = delete;

    bool isOpen() const noexcept { return logger_ != nullptr; }

    void write(int level, Severity severity, const Origin& origin, std::string_view component,
        std::string_view text) const;

    // Returns why the sink could not be opened or the last line not be written; empty without an
    // error.
    std::string problem() const;

private:
    void setProblem(std::string problem) const;

    std::string name_;
    bool isBrief_;
    std::unique_ptr<spdlog::logger> logger_; // null when the channel is off
    mutable std::mutex guard_;               // for the members that follow
    mutable std::string problem_;
    mutable bool isReported_ = false;
};

struct Channels {
    explicit Channels(const LogSettings& settings);

    int level;
    Channel log;
    Channel trace;
};

// Returns the channels in effect, set up from the environment at the first call; null once the
// library is being unloaded. The caller's share keeps them open while it writes.
std::shared_ptr<const Channels> activeChannels();

// Returns whether any open channel writes lines of the level.
bool anyChannelWants(int level) noexcept;

} // namespace RynLog
