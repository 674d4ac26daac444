// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/FileReplacement.h"

#include "tests/support/ErrorOf.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Umask.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <csignal>

namespace {

using Testing::contentOf;
using Tools::replaceFile;

class FileReplacementTest : public testing::Test {
protected:
    std::string path(const char* name) const { return (folder_.path() / name).string(); }

    std::size_t files() const
    {
        const std::filesystem::directory_iterator entries(folder_.path());
        return static_cast<std::size_t>(std::distance(begin(entries), end(entries)));
    }

    std::string failureOf(const std::string& file, const std::string& content) const
    {
        return Testing::errorOf([&] { replaceFile(file, content); });
    }

    Testing::TemporaryFolder folder_;
};

// Limits the size of files that this process writes during its lifetime.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t size)
    {
        signalBefore_ = std::signal(SIGXFSZ, SIG_IGN);
        ::getrlimit(RLIMIT_FSIZE, &before_);
        rlimit limit = before_;
        limit.rlim_cur = size;
        ::setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FileSizeLimit()
    {
        ::setrlimit(RLIMIT_FSIZE, &before_);
        std::signal(SIGXFSZ, signalBefore_);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;

private:
    rlimit before_{};
    void (*signalBefore_)(int) = nullptr;
};

TEST_F(FileReplacementTest, MakesANewFile)
{
    replaceFile(path("new"), "content");
    EXPECT_EQ(contentOf(path("new")), "content");
    EXPECT_EQ(files(), 1U);
}

TEST_F(FileReplacementTest, KeepsThePermissionsOfTheOldOne)
{
    const std::string file = folder_.write("old", "a long content before");
    ::chmod(file.c_str(), 0604);
    replaceFile(file, "after");
    struct stat status {};
    ::stat(file.c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0604U);
    EXPECT_EQ(contentOf(file), "after");
    EXPECT_EQ(files(), 1U);
}

TEST_F(FileReplacementTest, FollowsASymbolicLink)
{
    const std::string file = folder_.write("old", "before");
    std::filesystem::create_symlink("old", path("link"));
    replaceFile(path("link"), "after");
    EXPECT_TRUE(std::filesystem::is_symlink(path("link")));
    EXPECT_EQ(contentOf(file), "after");
}

TEST_F(FileReplacementTest, FailingWriteLeavesTheOldContentAndNothingElse)
{
    const std::string file = folder_.write("old", "before");
    std::string failure;
    {
        const FileSizeLimit limit(1000);
        failure = failureOf(file, std::string(100000, 'x'));
    }
    EXPECT_EQ(failure, file + ": File too large");
    EXPECT_EQ(contentOf(file), "before");
    EXPECT_EQ(files(), 1U);
}

TEST_F(FileReplacementTest, DoesNotReplaceADevice)
{
    EXPECT_EQ(failureOf("/dev/full", "x"), "/dev/full: No space left on device");
    replaceFile("/dev/null", "x");
    EXPECT_TRUE(std::filesystem::is_character_file("/dev/null"));
}

TEST_F(FileReplacementTest, WritesToAPipeThatOnlyALinkOfTheKernelNames)
{
    std::array<int, 2> ends{};
    ASSERT_EQ(::pipe(ends.data()), 0);
    const Vorn::Descriptor output(ends[0]);
    const Vorn::Descriptor input(ends[1]);
    const std::string link = "/dev/fd/" + std::to_string(input.number());
    replaceFile(link, "once");
    Tools::RenewedFile(link).renew(" more");
    std::array<char, 16> content{};
    EXPECT_EQ(::read(output.number(), content.data(), content.size()), 9);
    EXPECT_STREQ(content.data(), "once more");
}

TEST_F(FileReplacementTest, RenewedFileCanBeReadByEverybody)
{
    const Testing::Umask umask(077);
    const Tools::RenewedFile renewed(path("renewed"));
    for (const std::string content : {"first", "second"}) {
        renewed.renew(content);
        EXPECT_EQ(contentOf(path("renewed")), content);
    }
    struct stat status {};
    ::stat(path("renewed").c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0644U);
    EXPECT_EQ(files(), 2U); // the file and its lock
}

TEST_F(FileReplacementTest, RenewalRemovesWhatAnEndedProcessLeft)
{
    const std::string file = folder_.write("renewed", "before");
    folder_.write("other", "other");
    for (int turn = 0; turn < 2; ++turn) { // a link is not followed
        if (turn == 0)
            folder_.write("renewed.new", "half a");
        else
            std::filesystem::create_symlink("other", path("renewed.new"));
        const Tools::RenewedFile renewed(file);
        EXPECT_FALSE(std::filesystem::exists(std::filesystem::symlink_status(path("renewed.new"))));
        EXPECT_EQ(contentOf(file), "before");
    }
    const Tools::RenewedFile renewed(file);
    folder_.write("renewed.new", "half a");
    renewed.renew("after");
    EXPECT_EQ(contentOf(file), "after");
    EXPECT_EQ(contentOf(path("other")), "other");
    EXPECT_EQ(files(), 3U); // with the lock
}

TEST_F(FileReplacementTest, AFileIsRenewedByOneProcessAtATime)
{
    const std::string file = folder_.write("renewed", "before");
    std::filesystem::create_symlink("renewed", path("link"));
    {
        const Tools::RenewedFile first(file);
        folder_.write("renewed.new", "half a"); // of the first one
        EXPECT_EQ(Testing::errorOf([&] { const Tools::RenewedFile second(path("link")); }),
            path("link") + ": another process renews it already");
        EXPECT_EQ(contentOf(path("renewed.new")), "half a");
    }
    EXPECT_NO_THROW(Tools::RenewedFile{file});
}

TEST_F(FileReplacementTest, NamesTheFileThatCannotBeRenewed)
{
    const std::string file = path("missing/renewed");
    EXPECT_EQ(Testing::errorOf([&] { const Tools::RenewedFile renewed(file); }),
        file + ": No such file or directory");
    const Tools::RenewedFile device("/dev/full");
    EXPECT_EQ(Testing::errorOf([&] { device.renew("x"); }), "/dev/full: No space left on device");
    EXPECT_FALSE(std::filesystem::exists("/dev/full.lock"));
}

TEST_F(FileReplacementTest, NamesAFolderAndAnEmptyPath)
{
    EXPECT_EQ(
        failureOf(folder_.path().string(), "x"), folder_.path().string() + ": Is a directory");
    EXPECT_THAT(failureOf("", "x"), testing::StartsWith(": "));
}

} // namespace
