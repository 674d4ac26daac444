// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/RegularFile.h"

#include "platform/utilities/Descriptor.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <stdexcept>
#include <system_error>

#include <fcntl.h>
#include <unistd.h>

namespace Vorn {

namespace {

[[noreturn]] void failWithErrno()
{
    throw std::runtime_error(std::generic_category().message(errno));
}

FileStamp stampOfRegular(const struct stat& status)
{
    if (S_ISDIR(status.st_mode))
        throw std::runtime_error(std::generic_category().message(EISDIR));
    if (!S_ISREG(status.st_mode))
        throw std::runtime_error("Not a regular file");
    return stampOf(status);
}

[[noreturn]] void failTooLarge(std::size_t limit)
{
    throw std::runtime_error("Larger than " + std::to_string(limit) + " bytes");
}

// Reads to the end of the file, which may have grown since its size was read.
std::string readToEnd(const Descriptor& file, std::size_t expected, std::size_t limit)
{
    std::string text;
    text.reserve(expected);
    std::array<char, 65536> block;
    for (;;) {
        const ssize_t count = read(file.number(), block.data(), block.size());
        if (count == 0)
            return text;
        if (count < 0 && errno == EINTR)
            continue;
        if (count < 0)
            failWithErrno();
        text.append(block.data(), static_cast<std::size_t>(count));
        if (text.size() > limit)
            failTooLarge(limit);
    }
}

} // namespace

FileStamp stampOfRegularFile(const std::string& path)
{
    struct stat status {};
    if (stat(path.c_str(), &status) != 0)
        failWithErrno();
    return stampOfRegular(status);
}

FileContent readRegularFile(const std::string& path, std::size_t limit)
{
    stampOfRegularFile(path); // opening a device can have side effects
    const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
    if (!file.isOpen())
        failWithErrno();
    struct stat status {};
    if (fstat(file.number(), &status) != 0)
        failWithErrno();
    const FileStamp stamp = stampOfRegular(status);
    const auto size = static_cast<std::size_t>(stamp.size);
    if (size > limit)
        failTooLarge(limit);
    return {readToEnd(file, size, limit), stamp};
}

bool isSettled(const FileStamp& stamp)
{
    constexpr auto tick = std::chrono::milliseconds(50);
    const auto before = (std::chrono::system_clock::now() - tick).time_since_epoch();
    const auto seconds = std::chrono::floor<std::chrono::seconds>(before);
    const FileTime settled{seconds.count(), std::chrono::nanoseconds(before - seconds).count()};
    return std::max(stamp.changed, stamp.modified) < settled;
}

} // namespace Vorn
