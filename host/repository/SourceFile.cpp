// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/SourceFile.h"

#include <cerrno>
#include <stdexcept>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Host {

namespace {

class FileDescriptor {
public:
    explicit FileDescriptor(int descriptor) : descriptor_(descriptor) {}
    ~FileDescriptor()
    {
        if (descriptor_ >= 0)
            ::close(descriptor_);
    }
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;

    int get() const { return descriptor_; }

private:
    int descriptor_;
};

[[noreturn]] void failWithErrno()
{
    throw std::runtime_error(std::generic_category().message(errno));
}

void requireRegular(int descriptor)
{
    struct stat status = {};
    if (::fstat(descriptor, &status) != 0)
        failWithErrno();
    if (S_ISDIR(status.st_mode))
        throw std::runtime_error("is a folder");
    if (!S_ISREG(status.st_mode))
        throw std::runtime_error("is no regular file");
}

} // namespace

std::string readSourceFile(const std::filesystem::path& file)
{
    // Opening a pipe without anybody at its other end would wait.
    const FileDescriptor descriptor(::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (descriptor.get() < 0)
        failWithErrno();
    requireRegular(descriptor.get());
    constexpr std::size_t step = std::size_t{64} << 10U;
    std::string text;
    for (;;) {
        const std::size_t size = text.size();
        text.resize(size + step);
        const ssize_t count = ::read(descriptor.get(), text.data() + size, step);
        if (count < 0 && errno != EINTR)
            failWithErrno();
        text.resize(size + static_cast<std::size_t>(count < 0 ? 0 : count));
        if (count == 0)
            return text;
        if (text.size() > maximumSourceSize)
            throw std::runtime_error("is larger than 4 MiB");
    }
}

} // namespace Host
