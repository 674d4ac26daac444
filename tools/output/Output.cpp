// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Output.h"

#include "platform/logging/LogSettings.h"
#include "tools/output/PrintableText.h"
#include "tools/output/Terminal.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <exception>
#include <stdexcept>
#include <system_error>

namespace Tools {

namespace {

constexpr std::size_t pieceSize = std::size_t{1} << 16;

// Writes a message with the priority of sd-daemon(3).
void writeMessage(
    const char* priority, std::string_view text, const std::vector<std::string>& lines) noexcept
{
    try {
        std::string message = RynLog::isStandardErrorTheJournal() ? priority : "";
        message += "sensorctl: " + printable(text, isUtf8Locale()) + "\n";
        for (const std::string& line : lines)
            message += "  " + printable(line, isUtf8Locale()) + "\n";
        writeAll(STDERR_FILENO, message);
    } catch (const std::exception&) {
        // There is nowhere left to report it.
    }
}

} // namespace

void reserveStandardStreams()
{
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (::fcntl(stream, F_GETFD) != -1)
            continue;
        // open() returns the lowest free number, which is this one. The access mode is the wrong
        // one, so that using the stream fails.
        (void)::open("/dev/null", stream == STDIN_FILENO ? O_WRONLY : O_RDONLY);
    }
}

void writeAll(int descriptor, std::string_view text)
{
    while (!text.empty()) {
        const ssize_t written = ::write(descriptor, text.data(), text.size());
        if (written >= 0)
            text.remove_prefix(static_cast<std::size_t>(written));
        else if (errno != EINTR)
            throw std::system_error(errno, std::generic_category());
    }
}

void Output::write(std::string_view text)
{
    pending_ += text;
    if (pending_.size() >= pieceSize)
        flush();
}

void Output::flush()
{
    try {
        writeAll(descriptor_, pending_);
    } catch (const std::system_error& error) {
        throw std::runtime_error("cannot write the output: " + error.code().message());
    }
    pending_.clear();
}

void complain(std::string_view text, const std::vector<std::string>& lines) noexcept
{
    writeMessage("<3>", text, lines);
}

void inform(std::string_view text) noexcept
{
    writeMessage("<6>", text, {});
}

} // namespace Tools
