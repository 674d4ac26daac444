// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/Sinks.h"

#include "platform/logging/PipeSignal.h"
#include "platform/text/Escape.h"

#include <spdlog/pattern_formatter.h>
#include <spdlog/sinks/base_sink.h>

#include <cerrno>
#include <mutex>
#include <stdexcept>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <syslog.h>
#include <unistd.h>

namespace RynLog {

namespace {

using LockedSink = spdlog::sinks::base_sink<std::mutex>;

std::runtime_error failure(const std::string& verb, const std::string& what, int error)
{
    return std::runtime_error(
        "cannot " + verb + " " + what + ": " + std::generic_category().message(error));
}

class DescriptorSink : public LockedSink {
protected:
    explicit DescriptorSink(std::string name)
        : LockedSink(std::make_unique<spdlog::pattern_formatter>(
              "%Y-%m-%dT%H:%M:%S.%fZ %v", spdlog::pattern_time_type::utc, "\n")),
          name_(std::move(name))
    {
    }

    // Returns 0 or an error number of errno.h.
    virtual int write(std::string_view line) noexcept = 0;

    void sink_it_(const spdlog::details::log_msg& message) override
    {
        spdlog::memory_buf_t line;
        formatter_->format(message, line);
        if (const int error = write({line.data(), line.size()}))
            throw failure("write", name_, error);
    }

    void flush_() override {}

private:
    std::string name_;
};

class StandardErrorSink : public DescriptorSink {
public:
    StandardErrorSink() : DescriptorSink("the log to standard error") {}

protected:
    int write(std::string_view line) noexcept override { return writeToStandardError(line); }
};

// Writes each line to the open file at once and unbuffered, so that lines of several threads and
// processes are not interleaved.
class FileSink : public DescriptorSink {
public:
    // Owns the descriptor.
    FileSink(int descriptor, std::string name)
        : DescriptorSink(std::move(name)), descriptor_(descriptor)
    {
    }
    ~FileSink() override { ::close(descriptor_); }
    FileSink(const FileSink&) = delete;
    FileSink& operator=(const FileSink&) = delete;

protected:
    int write(std::string_view line) noexcept override { return writeWhole(descriptor_, line); }

private:
    int descriptor_;
};

// Never calls openlog or closelog: the identity belongs to the process.
class SyslogSink : public LockedSink {
protected:
    void sink_it_(const spdlog::details::log_msg& message) override
    {
        const int severity = message.level >= spdlog::level::warn ? LOG_WARNING : LOG_DEBUG;
        const std::string line(message.payload.data(), message.payload.size());
        ::syslog(LOG_DAEMON | severity, "%s", line.c_str());
    }

    void flush_() override {}
};

std::shared_ptr<spdlog::sinks::sink> openFile(const std::string& path)
{
    // Non-blocking, since a pipe without a reader must not block a request.
    constexpr int flags = O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC | O_NOCTTY | O_NONBLOCK;
    constexpr mode_t ownerWritesGroupReads = 0640;
    const int descriptor = ::open(path.c_str(), flags, ownerWritesGroupReads);
    const int error = errno;
    std::string name = "the log file ";
    Text::appendEscaped(name, path, Text::Backslash::doubled);
    if (descriptor < 0)
        throw failure("open", name, error);
    return std::make_shared<FileSink>(descriptor, std::move(name));
}

} // namespace

std::shared_ptr<spdlog::sinks::sink> makeSink(const SinkSetting& setting)
{
    switch (setting.kind) {
    case SinkSetting::Kind::syslog:
        return std::make_shared<SyslogSink>();
    case SinkSetting::Kind::standardError:
        return std::make_shared<StandardErrorSink>();
    case SinkSetting::Kind::file:
        return openFile(setting.path);
    case SinkSetting::Kind::off:
        break;
    }
    return nullptr;
}

} // namespace RynLog
