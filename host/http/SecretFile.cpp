// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/SecretFile.h"

#include "platform/utilities/Descriptor.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstddef>
#include <stdexcept>
#include <system_error>

namespace Host::Http {

namespace {

constexpr std::size_t maximumSize = std::size_t{1} << 20;

[[noreturn]] void failAt(const std::string& file, const std::string& reason)
{
    throw std::runtime_error(file + ": " + reason);
}

[[noreturn]] void failByErrno(const std::string& file)
{
    failAt(file, std::system_category().message(errno));
}

std::string readAll(int descriptor, const std::string& file)
{
    std::string content;
    std::array<char, 4096> piece{};
    for (;;) {
        const ::ssize_t got = ::read(descriptor, piece.data(), piece.size());
        if (got < 0 && errno == EINTR)
            continue;
        if (got < 0)
            failByErrno(file);
        if (got == 0)
            return content;
        content.append(piece.data(), static_cast<std::size_t>(got));
        if (content.size() > maximumSize)
            failAt(file, "it is larger than a megabyte");
    }
}

// The owner's rights are not checked: an owner can change them.
void requireSecrecy(const struct stat& status, const std::string& file)
{
    if (status.st_uid != 0 && status.st_uid != ::geteuid())
        failAt(file, "it belongs neither to root nor to the user who reads it (chown mends that)");
    if ((status.st_mode & (S_IWGRP | S_IRWXO)) != 0)
        failAt(file, "others than its owner can change it, or anybody can read it (chmod 600 or "
                     "640 mends that)");
}

std::string readFile(const std::string& file, bool isSecret)
{
    // Without O_NONBLOCK, opening a FIFO would wait for its writer.
    const Vorn::Descriptor descriptor(::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    struct stat status = {};
    if (!descriptor.isOpen() || ::fstat(descriptor.number(), &status) != 0)
        failByErrno(file);
    if (!S_ISREG(status.st_mode))
        failAt(file, "it is no regular file");
    if (isSecret)
        requireSecrecy(status, file);
    return readAll(descriptor.number(), file);
}

} // namespace

std::string readSecretFile(const std::string& file)
{
    return readFile(file, true);
}

std::string readPublicFile(const std::string& file)
{
    return readFile(file, false);
}

} // namespace Host::Http
