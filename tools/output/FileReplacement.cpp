// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/FileReplacement.h"

#include "tools/output/Output.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Tools {

namespace {

void check(int answer)
{
    if (answer == -1)
        throw std::system_error(errno, std::generic_category());
}

class OpenFile {
public:
    explicit OpenFile(int number) : number_(number) { check(number); }
    ~OpenFile()
    {
        if (number_ != -1)
            ::close(number_);
    }
    OpenFile(const OpenFile&) = delete;
    OpenFile& operator=(const OpenFile&) = delete;

    int number() const { return number_; }

    // Reports the error of close(): some file systems report a full disk only there.
    void close()
    {
        const int number = number_;
        number_ = -1;
        check(::close(number));
    }

private:
    int number_;
};

// A file beside the target that is removed unless it replaces the target.
class Replacement {
public:
    explicit Replacement(const std::string& target)
        : target_(target), name_(target + ".XXXXXX"), file_(::mkstemp(name_.data()))
    {
    }
    // Replaces a file of that name, too.
    Replacement(std::string target, std::string name)
        : target_(std::move(target)), name_(std::move(name)), file_(openNew(name_))
    {
    }
    ~Replacement()
    {
        if (!isDone_)
            ::unlink(name_.c_str());
    }
    Replacement(const Replacement&) = delete;
    Replacement& operator=(const Replacement&) = delete;

    void write(std::string_view content, mode_t mode)
    {
        writeAll(file_.number(), content);
        check(::fchmod(file_.number(), mode));
        check(::fsync(file_.number()));
        file_.close();
        check(::rename(name_.c_str(), target_.c_str()));
        isDone_ = true;
    }

private:
    static int openNew(const std::string& name)
    {
        ::unlink(name.c_str());
        return ::open(name.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    }

    std::string target_;
    std::string name_;
    OpenFile file_;
    bool isDone_ = false;
};

mode_t modeOfNewFiles()
{
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return static_cast<mode_t>(0666 & ~mask);
}

void writeInPlace(const std::string& path, std::string_view content)
{
    OpenFile file(::open(path.c_str(), O_WRONLY | O_CLOEXEC));
    writeAll(file.number(), content);
    file.close();
}

bool isReplaceable(const std::optional<::mode_t>& present)
{
    return !present || S_ISREG(*present);
}

// Calls the action with the target of a path and its type and mode, which are absent where there is
// nothing. The target of what is not replaced is the path itself: links such as /dev/stdout lead to
// pipes, which have no other one. Throws std::runtime_error with the path and the reason.
template <typename Action>
void onTarget(const std::string& path, const Action& action)
{
    try {
        struct stat status {};
        const bool exists = ::stat(path.c_str(), &status) == 0;
        const std::optional<::mode_t> present =
            exists ? std::optional(status.st_mode) : std::nullopt;
        action(isReplaceable(present) ? std::filesystem::weakly_canonical(path).string() : path,
            present);
    } catch (const std::system_error& error) {
        throw std::runtime_error(path + ": " + error.code().message());
    }
}

std::string renewalOf(const std::string& target)
{
    return target + ".new";
}

// Returns the descriptor that has the lock, none where another process has it. The file is never
// removed: a process that had opened it would lock another one than the next process.
Vorn::Descriptor lockOf(const std::string& target)
{
    const std::string name = target + ".lock";
    Vorn::Descriptor lock(::open(name.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600));
    check(lock.number());
    if (::flock(lock.number(), LOCK_EX | LOCK_NB) == 0)
        return lock;
    if (errno == EWOULDBLOCK)
        return Vorn::Descriptor();
    throw std::system_error(errno, std::generic_category());
}

} // namespace

void replaceFile(const std::string& path, std::string_view content, std::optional<::mode_t> mode)
{
    onTarget(path, [&](const std::string& target, const std::optional<::mode_t>& present) {
        if (!isReplaceable(present))
            writeInPlace(target, content);
        else
            Replacement(target).write(content, mode      ? *mode
                                               : present ? *present & 07777
                                                         : modeOfNewFiles());
    });
}

RenewedFile::RenewedFile(std::string path) : path_(std::move(path))
{
    onTarget(path_, [this](const std::string& target, const std::optional<::mode_t>& present) {
        if (!isReplaceable(present))
            return;
        lock_ = lockOf(target);
        if (!lock_.isOpen())
            throw std::runtime_error(path_ + ": another process renews it already");
        const Replacement removed(target, renewalOf(target));
    });
}

void RenewedFile::renew(std::string_view content) const
{
    constexpr ::mode_t mode = 0644; // whatever the umask
    onTarget(path_, [&](const std::string& target, const std::optional<::mode_t>& present) {
        if (!isReplaceable(present))
            writeInPlace(target, content);
        else
            Replacement(target, renewalOf(target)).write(content, mode);
    });
}

} // namespace Tools
