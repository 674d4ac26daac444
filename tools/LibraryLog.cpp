// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/LibraryLog.h"

#include "tools/output/Output.h"

#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <fstream>
#include <optional>
#include <system_error>

namespace Tools {

namespace {

// The component under which the sources of sensors log, as a word of a line.
constexpr const char* component = " Nimbrel.Instrumentation ";

std::string pathOf(int descriptor)
{
    return "/proc/self/fd/" + std::to_string(descriptor);
}

// Returns the text of a line, which follows the component and the place in the source. Returns
// nothing for the lines of other components.
std::optional<std::string> messageIn(const std::string& line)
{
    const std::size_t at = line.find(component);
    const std::size_t place =
        at == std::string::npos ? at : at + std::string_view(component).size();
    const std::size_t blank = place == std::string::npos ? place : line.find(' ', place);
    return blank == std::string::npos ? std::nullopt : std::optional(line.substr(blank + 1));
}

} // namespace

LibraryLog::LibraryLog()
{
    ::setenv("RYNLOG_STDERR", "off", 0);
    const char* const wanted = ::getenv("RYNLOG_LOG");
    if (wanted != nullptr && *wanted != '\0')
        return;
    file_ = ::memfd_create("log", MFD_CLOEXEC);
    if (file_ >= 0)
        ::setenv("RYNLOG_LOG", ("file:" + pathOf(file_)).c_str(), 1);
}

LibraryLog::~LibraryLog()
{
    if (file_ >= 0)
        ::close(file_);
}

std::vector<std::string> LibraryLog::takeMessages(const std::string& shown)
{
    std::vector<std::string> messages;
    if (file_ < 0)
        return messages;
    std::ifstream lines(pathOf(file_));
    for (std::string line; std::getline(lines, line);) {
        const auto message = messageIn(line);
        if (!message || std::find(taken_.begin(), taken_.end(), *message) != taken_.end())
            continue;
        taken_.push_back(*message);
        if (shown.empty() || message->find(shown) == std::string::npos)
            messages.push_back(*message);
    }
    // The libraries append to the file.
    if (::ftruncate(file_, 0) != 0)
        throw std::system_error(errno, std::generic_category());
    return messages;
}

void LibraryLog::printMessages(const std::string& shown)
{
    for (const std::string& message : takeMessages(shown))
        writeAll(STDERR_FILENO, message + "\n");
}

} // namespace Tools
