// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/FileReplacement.h"

#include "tests/support/ErrorOf.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/resource.h>
#include <sys/stat.h>

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

TEST_F(FileReplacementTest, RenewedFileCanBeReadByEverybody)
{
    const mode_t mask = ::umask(077);
    for (const std::string content : {"first", "second"}) {
        Tools::renewFile(path("renewed"), content);
        EXPECT_EQ(contentOf(path("renewed")), content);
    }
    ::umask(mask);
    struct stat status {};
    ::stat(path("renewed").c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0644U);
    EXPECT_EQ(files(), 1U);
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
        Tools::prepareRenewal(file);
        EXPECT_EQ(files(), 2U);
        EXPECT_EQ(contentOf(file), "before");
    }
    folder_.write("renewed.new", "half a");
    Tools::renewFile(file, "after");
    EXPECT_EQ(contentOf(file), "after");
    EXPECT_EQ(contentOf(path("other")), "other");
    EXPECT_EQ(files(), 2U);
}

TEST_F(FileReplacementTest, NamesTheFileThatCannotBeRenewed)
{
    const std::string file = path("missing/renewed");
    EXPECT_EQ(Testing::errorOf([&] { Tools::prepareRenewal(file); }),
        file + ": No such file or directory");
    EXPECT_NO_THROW(Tools::prepareRenewal("/dev/full"));
    EXPECT_EQ(Testing::errorOf([] { Tools::renewFile("/dev/full", "x"); }),
        "/dev/full: No space left on device");
}

TEST_F(FileReplacementTest, NamesAFolderAndAnEmptyPath)
{
    EXPECT_EQ(
        failureOf(folder_.path().string(), "x"), folder_.path().string() + ": Is a directory");
    EXPECT_THAT(failureOf("", "x"), testing::StartsWith(": "));
}

} // namespace
