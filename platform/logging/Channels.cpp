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

constexpr int messageLevel = 6000;

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
        channels.log.write(messageLevel, origin, "RynLog", problem);
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

} // namespace

Channel::Channel(std::string name, const std::string& setting) : name_(std::move(name))
{
    const auto parsed = parseSinkSetting(setting);
    if (!parsed)
        throw std::invalid_argument("no such log sink: " + setting);
    try {
        logger_ = makeLogger(*parsed);
    } catch (const std::runtime_error& error) {
        setProblem(error.what());
    }
}

Channel::~Channel() = default;

void Channel::write(
    int level, const Origin& origin, std::string_view component, std::string_view text) const
{
    const std::string line = formatLine(name_, level, origin, component, text);
    const auto severity = level >= messageLevel ? spdlog::level::warn : spdlog::level::debug;
    std::string problem;
    try {
        logger_->log(severity, spdlog::string_view_t(line));
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
    : level(settings.level), log("log", settings.log), trace("trace", settings.trace)
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
