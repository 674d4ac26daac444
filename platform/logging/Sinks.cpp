// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/Sinks.h"

#include "platform/logging/PipeSignal.h"
#include "platform/text/Escape.h"

#include <spdlog/pattern_formatter.h>
#include <spdlog/sinks/base_sink.h>

#include <cerrno>
#include <filesystem>
#include <mutex>
#include <stdexcept>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
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

int syslogSeverity(spdlog::level::level_enum level)
{
    switch (level) {
    case spdlog::level::err:
        return LOG_ERR;
    case spdlog::level::warn:
        return LOG_WARNING;
    case spdlog::level::info:
        return LOG_INFO;
    default:
        return LOG_DEBUG;
    }
}

class StandardErrorSink : public DescriptorSink {
public:
    StandardErrorSink() : DescriptorSink("the log to standard error") {}

protected:
    int write(std::string_view line) noexcept override { return writeToStandardError(line); }
};

// Writes lines as sd-daemon(3) describes. The journal has a clock of its own.
class JournalSink : public LockedSink {
protected:
    void sink_it_(const spdlog::details::log_msg& message) override
    {
        std::string line = "<" + std::to_string(syslogSeverity(message.level)) + ">";
        line.append(message.payload.data(), message.payload.size()).append("\n");
        if (const int error = writeToStandardError(line))
            throw failure("write", "the log to standard error", error);
    }

    void flush_() override {}
};

// Opens a log file. Returns the descriptor, or -1 with errno set. Non-blocking, since a pipe
// without a reader must not block a request.
int openToAppend(const std::string& path) noexcept
{
    constexpr int flags = O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC | O_NOCTTY | O_NONBLOCK;
    constexpr mode_t ownerWritesGroupReads = 0640;
    return ::open(path.c_str(), flags, ownerWritesGroupReads);
}

// Writes each line to the open file at once and unbuffered, so that lines of several threads and
// processes are not interleaved. Opens a file anew that was renamed or removed.
class FileSink : public DescriptorSink {
public:
    // Owns the descriptor of the file at the absolute path.
    FileSink(int descriptor, std::string path, std::string name)
        : DescriptorSink(std::move(name)), descriptor_(descriptor), path_(std::move(path))
    {
    }
    ~FileSink() override { ::close(descriptor_); }
    FileSink(const FileSink&) = delete;
    FileSink& operator=(const FileSink&) = delete;

protected:
    int write(std::string_view line) noexcept override
    {
        if (isReplaced())
            openAgain();
        return writeWhole(descriptor_, line);
    }

private:
    bool isReplaced() const noexcept
    {
        struct stat opened {};
        struct stat named {};
        if (::fstat(descriptor_, &opened) != 0 || !S_ISREG(opened.st_mode))
            return false;
        if (::stat(path_.c_str(), &named) != 0)
            return errno == ENOENT;
        return opened.st_dev != named.st_dev || opened.st_ino != named.st_ino;
    }

    // The former file stays in use where the new one cannot be opened.
    void openAgain() noexcept
    {
        const int descriptor = openToAppend(path_);
        if (descriptor < 0)
            return;
        ::close(descriptor_);
        descriptor_ = descriptor;
    }

    int descriptor_;
    std::string path_;
};

// Never calls openlog or closelog: the identity belongs to the process.
class SyslogSink : public LockedSink {
protected:
    void sink_it_(const spdlog::details::log_msg& message) override
    {
        const std::string line(message.payload.data(), message.payload.size());
        ::syslog(LOG_DAEMON | syslogSeverity(message.level), "%s", line.c_str());
    }

    void flush_() override {}
};

std::shared_ptr<spdlog::sinks::sink> openFile(const std::string& path)
{
    const int descriptor = openToAppend(path);
    const int error = errno;
    std::string name = "the log file ";
    Text::appendEscaped(name, path, Text::Backslash::doubled);
    if (descriptor < 0)
        throw failure("open", name, error);
    return std::make_shared<FileSink>(
        descriptor, std::filesystem::absolute(path).string(), std::move(name));
}

} // namespace

std::shared_ptr<spdlog::sinks::sink> makeSink(const SinkSetting& setting)
{
    switch (setting.kind) {
    case SinkSetting::Kind::syslog:
        return std::make_shared<SyslogSink>();
    case SinkSetting::Kind::standardError:
        return std::make_shared<StandardErrorSink>();
    case SinkSetting::Kind::journal:
        return std::make_shared<JournalSink>();
    case SinkSetting::Kind::file:
        return openFile(setting.path);
    case SinkSetting::Kind::off:
        break;
    }
    return nullptr;
}

} // namespace RynLog
