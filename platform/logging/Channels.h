// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The two channels as they are configured at a moment.

#pragma once

#include "platform/logging/Configuration.h"
#include "platform/logging/LineFormat.h"

#include <memory>
#include <mutex>
#include <string>
#include <string_view>

namespace spdlog {
class logger;
}

namespace RynLog {

// A named way to a sink. Thread-safe.
class Channel {
public:
    // Throws std::invalid_argument when the setting makes no sense.
    Channel(std::string name, const std::string& setting);
    ~Channel();
    Channel(const Channel&) = delete;
    Channel& operator=(const Channel&) = delete;

    bool isOpen() const noexcept { return logger_ != nullptr; }

    void write(
        int level, const Origin& origin, std::string_view component, std::string_view text) const;

    // Why the sink could not be opened, or did not take the last line; empty when all is well.
    std::string problem() const;

private:
    void setProblem(std::string problem) const;

    std::string name_;
    std::unique_ptr<spdlog::logger> logger_; // null when lines lead nowhere
    mutable std::mutex guard_;               // of what follows
    mutable std::string problem_;
    mutable bool isReported_ = false;
};

struct Channels {
    explicit Channels(const Configuration& configuration);

    int level;
    Channel log;
    Channel trace;
};

// The channels in effect, configured from the environment at the first call. Null once the
// library is being unloaded. The caller's share keeps them open while it writes.
std::shared_ptr<const Channels> activeChannels();

// Whether a line of the level has somewhere to go.
bool anyChannelWants(int level) noexcept;

} // namespace RynLog
