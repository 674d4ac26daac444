// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/Channels.h"

#include "platform/logging/Sinks.h"

#include <spdlog/logger.h>

#include <atomic>
#include <limits>
#include <mutex>
#include <stdexcept>
#include <utility>

#include <syslog.h>

namespace RynLog {

namespace {

std::unique_ptr<spdlog::logger> makeLogger(const SinkSetting& setting)
{
    auto sink = makeSink(setting);
    if (!sink)
        return nullptr;
    // The logger is not registered, since spdlog's registry belongs to the process. Its error
    // handler replaces spdlog's, which writes to standard error.
    auto logger = std::make_unique<spdlog::logger>(std::string(), std::move(sink));
    logger->set_level(spdlog::level::trace);
    logger->set_error_handler([](const std::string& reason) { throw std::runtime_error(reason); });
    return logger;
}

// These lie outside the range of levels, so that comparing levels covers closed channels, too.
constexpr long long nothingWanted = std::numeric_limits<long long>::max();
constexpr long long notConfigured = std::numeric_limits<long long>::min();

// These stay usable while the library is unloaded or the process ends: threads may still log.
constinit std::atomic<long long> wantedLevel{notConfigured};
constinit std::mutex guard; // for the variables that follow
constinit bool unloading = false;

struct Current {
    std::shared_ptr<const Channels> channels;

    ~Current()
    {
        const std::lock_guard lock(guard);
        unloading = true;
        wantedLevel.store(nothingWanted, std::memory_order_relaxed);
    }
};
constinit Current current;

void reportProblem(const Channels& channels, const std::string& problem)
{
    const Origin origin{"reportProblem", "Channels", __LINE__};
    if (!problem.empty() && channels.log.isOpen() && channels.level <= messageLevel)
        channels.log.write(messageLevel, Severity::warning, origin, "RynLog", problem);
}

// REQUIRES: the guard is held.
void install(std::shared_ptr<const Channels> channels)
{
    const bool leadsSomewhere = channels->log.isOpen() || channels->trace.isOpen();
    wantedLevel.store(leadsSomewhere ? channels->level : nothingWanted, std::memory_order_relaxed);
    current.channels.swap(channels);
}

// REQUIRES: the guard is held.
void configureAtFirstUse()
{
    const LogSettings settings = settingsFromEnvironment();
    auto channels = std::make_shared<const Channels>(settings);
    reportProblem(*channels, settings.problem);
    install(std::move(channels));
}

spdlog::level::level_enum spdlogLevel(Severity severity)
{
    switch (severity) {
    case Severity::error:
        return spdlog::level::err;
    case Severity::warning:
        return spdlog::level::warn;
    case Severity::information:
        return spdlog::level::info;
    case Severity::debug:
        break;
    }
    return spdlog::level::debug;
}

} // namespace

Channel::Channel(std::string name, const std::string& setting, bool isBrief)
    : name_(std::move(name))
{
    auto parsed = parseSinkSetting(setting);
    if (!parsed)
        throw std::invalid_argument("no such log sink: " + setting);
    if (parsed->kind == SinkSetting::Kind::standardError && isStandardErrorTheJournal())
        parsed->kind = SinkSetting::Kind::journal;
    isBrief_ = isBrief && parsed->kind == SinkSetting::Kind::journal;
    try {
        logger_ = makeLogger(*parsed);
    } catch (const std::runtime_error& error) {
        setProblem(error.what());
    }
}

Channel::~Channel() = default;

void Channel::write(int level, Severity severity, const Origin& origin, std::string_view component,
    std::string_view text) const
{
    const std::string line =
        isBrief_ ? escaped(text) : formatLine(name_, level, origin, component, text);
    std::string problem;
    try {
        logger_->log(spdlogLevel(severity), spdlog::string_view_t(line));
    } catch (const std::runtime_error& error) {
        problem = error.what();
    }
    setProblem(std::move(problem));
}

std::string Channel::problem() const
{
    const std::lock_guard lock(guard_);
    return problem_;
}

// Reports to syslog once: a sink that fails intermittently would fill the system's log.
void Channel::setProblem(std::string problem) const
{
    const std::lock_guard lock(guard_);
    problem_ = std::move(problem);
    if (problem_.empty() || std::exchange(isReported_, true))
        return;
    ::syslog(LOG_DAEMON | LOG_WARNING, "%s; its lines are lost", problem_.c_str());
}

Channels::Channels(const LogSettings& settings)
    : level(settings.level), log("log", settings.log, settings.level >= messageLevel),
      trace("trace", settings.trace, false)
{
}

std::shared_ptr<const Channels> activeChannels()
{
    const std::lock_guard lock(guard);
    if (unloading)
        return nullptr;
    if (!current.channels)
        configureAtFirstUse();
    return current.channels;
}

bool anyChannelWants(int level) noexcept
try {
    if (wantedLevel.load(std::memory_order_relaxed) == notConfigured)
        activeChannels();
    return level >= wantedLevel.load(std::memory_order_relaxed);
} catch (...) {
    return false;
}

void configure(const LogSettings& settings)
{
    auto channels = std::make_shared<const Channels>(settings);
    reportProblem(*channels, settings.problem);
    const std::lock_guard lock(guard);
    if (!unloading)
        install(std::move(channels));
}

} // namespace RynLog
