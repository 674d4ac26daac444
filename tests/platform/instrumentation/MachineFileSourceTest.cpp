// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "platform/instrumentation/Recorder.h"
#include "platform/instrumentation/RegularFile.h"
#include "platform/instrumentation/SourceList.h"
#include "platform/instrumentation/machinefile/MachineFileCache.h"
#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"
#include "tests/support/LogCapture.h"
#include "tests/support/TemporaryFolder.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <thread>

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace MachineFileSourceTests {

using testing::ElementsAre;
using Testing::EnvironmentVariable;
using Testing::errorOf;
using testing::HasSubstr;
using testing::SizeIs;
using Testing::TemporaryFolder;
using Testing::walk;
using Vorn::checkMachineFile;
using Vorn::NodeLexicon::NodeType;

std::string modelOf(const std::string& description)
{
    return R"({"nodes":[{"type":"voltage","path":"/v","reading":1,"description":")" + description +
           "\"}]}";
}

// Waits longer than the minimum age of a file that is cached.
void letItRest()
{
    std::this_thread::sleep_for(std::chrono::milliseconds(80));
}

class MachineFileSourceTest : public testing::Test {
protected:
    std::string write(const std::string& text) { return folder_.write("model.json", text); }
    std::string path() const { return folder_.path() / "model.json"; }

    TemporaryFolder folder_;
    EnvironmentVariable environment_{
        "VORN_INSTRUMENTATION", Vorn::formatSourceEntry("model", path())};
};

TEST_F(MachineFileSourceTest, IsServedInItsOwnOrder)
{
    write(R"({"nodes":[
        {"type":"voltage","path":"/1","description":"first","reading":3.25},
        {"type":"tachometer","path":"/2","description":"third","status":1},
        {"type":"voltage","path":"/3","description":"second","sensorType":7}]})");
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(3));
    EXPECT_EQ(nodes[0].path, "/1");
    EXPECT_EQ(nodes[0].values.reading, 3.25);
    EXPECT_EQ(nodes[0].sensorType, 21U);
    EXPECT_EQ(nodes[1].path, "/3");
    EXPECT_EQ(nodes[1].sensorType, 7U);
    EXPECT_EQ(nodes[2].path, "/2");
    EXPECT_EQ(nodes[2].values.status, 13U);
}

TEST_F(MachineFileSourceTest, ANodeWithoutADescriptionIsNamedAfterItsPath)
{
    write(R"({"nodes":[
        {"type":"voltage","path":"/board/in1","description":""},
        {"type":"voltage","path":"in2","description":" \t"},
        {"type":"voltage","path":"","description":""}]})");
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(3));
    EXPECT_EQ(nodes[0].description, "Sensor board/in1");
    EXPECT_EQ(nodes[1].description, "Sensor in2");
    EXPECT_EQ(nodes[2].description, "Sensor ");
}

TEST_F(MachineFileSourceTest, ANodeWithoutAReadingIsNeverNormal)
{
    write(R"({"nodes":[
        {"type":"voltage","path":"/1","description":"normal","status":1},
        {"type":"voltage","path":"/2","description":"warning","status":22},
        {"type":"voltage","path":"/3","description":"disabled","status":16},
        {"type":"voltage","path":"/4","description":"out of contact","status":17},
        {"type":"voltage","path":"/5","description":"normal","status":1,"reading":0}]})");
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(5));
    EXPECT_EQ(nodes[0].values.status, 13U);
    EXPECT_EQ(nodes[1].values.status, 13U);
    EXPECT_EQ(nodes[2].values.status, 16U);
    EXPECT_EQ(nodes[3].values.status, 17U);
    EXPECT_EQ(nodes[4].values.status, 1U);
}

TEST_F(MachineFileSourceTest, IsReadAfreshWhenItChanged)
{
    for (const std::string description : {"one", "two", "six"}) {
        write(modelOf(description));
        EXPECT_EQ(walk().at(0).description, description);
        letItRest();
        EXPECT_EQ(walk().at(0).description, description);
    }
}

TEST_F(MachineFileSourceTest, IsReadAfreshThoughItsTimeWasSetBack)
{
    write(modelOf("one"));
    struct stat status {};
    ASSERT_EQ(stat(path().c_str(), &status), 0);
    letItRest();
    EXPECT_EQ(walk().at(0).description, "one");
    write(modelOf("two"));
    const timespec times[] = {status.st_atim, status.st_mtim};
    ASSERT_EQ(utimensat(AT_FDCWD, path().c_str(), times, 0), 0);
    EXPECT_EQ(walk().at(0).description, "two");
}

TEST_F(MachineFileSourceTest, IsReadWhateverTimeItClaims)
{
    write(modelOf("one"));
    const timespec farFuture = {10'413'792'000, 999'999'999}; // the year 2300
    const timespec longAgo = {-2'000'000'000, 0};
    for (const timespec& time : {farFuture, longAgo}) {
        const timespec times[] = {time, time};
        ASSERT_EQ(utimensat(AT_FDCWD, path().c_str(), times, 0), 0);
        EXPECT_EQ(walk().at(0).description, "one");
    }
}

TEST_F(MachineFileSourceTest, IsNotReadAgainWhileItStays)
{
    write(modelOf("one"));
    letItRest();
    auto& cache = Vorn::MachineFileCache::instance();
    const auto first = cache.load(path());
    EXPECT_EQ(cache.load(path()), first);
    write(modelOf("two"));
    EXPECT_NE(cache.load(path()), first);
    EXPECT_EQ(first->nodes.at(NodeType::Voltage).at(0).description, "one");
}

TEST_F(MachineFileSourceTest, ThatJustChangedIsNotTrustedToShowTheNextChange)
{
    write(modelOf("one"));
    EXPECT_FALSE(Vorn::isSettled(Vorn::stampOfRegularFile(path())));
    letItRest();
    EXPECT_TRUE(Vorn::isSettled(Vorn::stampOfRegularFile(path())));
}

TEST_F(MachineFileSourceTest, MoreFilesThanTheCacheKeepsAreServedAllTheSame)
{
    for (int turn = 0; turn < 2; ++turn)
        for (int number = 0; number < 20; ++number) {
            const std::string name = std::to_string(number);
            const std::string file =
                turn == 0 ? folder_.write(name, modelOf(name)) : (folder_.path() / name).string();
            EXPECT_EQ(Vorn::MachineFileCache::instance()
                          .load(file)
                          ->nodes.at(NodeType::Voltage)
                          .at(0)
                          .description,
                name);
        }
}

TEST_F(MachineFileSourceTest, WithACommaInItsNameIsServed)
{
    const std::string file = folder_.write(R"(a,b\c.json)", modelOf("comma"));
    const EnvironmentVariable environment(
        "VORN_INSTRUMENTATION", Vorn::formatSourceEntry("model", file));
    EXPECT_EQ(walk().at(0).description, "comma");
}

TEST_F(MachineFileSourceTest, ErrorsNameTheFileThePlaceAndTheReason)
{
    const std::string start = "model file " + path() + ": ";
    write(R"({"nodes":[{"status":"x"}]})");
    const std::string shape = start + "/nodes/0/status: expected an unsigned 32-bit integer, found "
                                      "the string \"x\"";
    EXPECT_EQ(errorOf([&] { checkMachineFile(path()); }), shape);
    EXPECT_EQ(errorOf([] { walk(); }), shape);
    letItRest();
    EXPECT_EQ(errorOf([] { walk(); }), shape);
    EXPECT_EQ(errorOf([] { walk(); }), shape);
    write("{");
    EXPECT_THAT(errorOf([] { walk(); }), HasSubstr(start + "line 1, column 2: "));
    write(modelOf("good"));
    EXPECT_NO_THROW(checkMachineFile(path()));
}

TEST_F(MachineFileSourceTest, ThatIsMissingIsNamed)
{
    EXPECT_EQ(errorOf([&] { checkMachineFile(path()); }),
        "model file " + path() + ": No such file or directory");
}

TEST_F(MachineFileSourceTest, ThatIsADirectoryIsRefused)
{
    EXPECT_EQ(errorOf([&] { checkMachineFile(folder_.path()); }),
        "model file " + folder_.path().string() + ": Is a directory");
}

TEST_F(MachineFileSourceTest, ThatIsAPipeOrADeviceIsRefusedWithoutWaiting)
{
    ASSERT_EQ(mkfifo(path().c_str(), 0600), 0);
    EXPECT_EQ(errorOf([&] { checkMachineFile(path()); }),
        "model file " + path() + ": Not a regular file");
    EXPECT_EQ(
        errorOf([] { checkMachineFile("/dev/zero"); }), "model file /dev/zero: Not a regular file");
}

TEST_F(MachineFileSourceTest, ThatIsTooLargeIsRefusedUnread)
{
    write("");
    ASSERT_EQ(truncate(path().c_str(), 1LL << 40U), 0);
    EXPECT_EQ(errorOf([&] { checkMachineFile(path()); }),
        "model file " + path() + ": Larger than 67108864 bytes");
}

// Root may read every file, so that a child process of the user nobody reads it.
TEST_F(MachineFileSourceTest, ThatMayNotBeReadIsNamed)
{
    write(modelOf("secret"));
    ASSERT_EQ(chmod(path().c_str(), 0), 0);
    ASSERT_EQ(chmod(folder_.path().c_str(), 0755), 0);
    const std::string expected = "model file " + path() + ": Permission denied";
    const pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
        constexpr uid_t nobody = 65534;
        if (geteuid() == 0 && setuid(nobody) != 0)
            _exit(2);
        _exit(errorOf([&] { checkMachineFile(path()); }) == expected ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 0);
}

TEST_F(MachineFileSourceTest, ThatIsMalformedIsReportedOnceUntilItWasGood)
{
    const Testing::LogCapture capture;
    write("{");
    for (int request = 0; request < 3; ++request)
        EXPECT_NE(errorOf([] { walk(); }), "");
    EXPECT_THAT(capture.log(), SizeIs(1));
    EXPECT_THAT(capture.log().at(0).text, HasSubstr("model file " + path() + ": line 1, column 2"));
    write(modelOf("good"));
    walk();
    write("{");
    EXPECT_NE(errorOf([] { walk(); }), "");
    EXPECT_THAT(capture.log(), SizeIs(2));
}

TEST_F(MachineFileSourceTest, IsServedToManyThreadsWhileItChanges)
{
    const auto replace = [&](const std::string& description) {
        const std::string file = folder_.write("next", modelOf(description));
        std::filesystem::rename(file, path());
    };
    replace("even");
    std::atomic<bool> goOn{true};
    std::vector<std::jthread> readers;
    for (int reader = 0; reader < 8; ++reader)
        readers.emplace_back([&] {
            while (goOn) {
                const std::string seen = walk().at(0).description;
                EXPECT_TRUE(seen == "even" || seen == "odd") << seen;
            }
        });
    for (int turn = 0; turn < 100; ++turn) {
        replace(turn % 2 == 0 ? "odd" : "even");
        std::this_thread::sleep_for(std::chrono::milliseconds(turn % 20 == 0 ? 60 : 1));
    }
    goOn = false;
}

TEST_F(MachineFileSourceTest, SixtyThousandSensorsAreServed)
{
    std::string text = "{\"nodes\":[";
    for (int number = 0; number < 60'000; ++number)
        text +=
            (number == 0 ? "" : ",") +
            std::string(R"({"type":"temperature","description":"T","reading":41.5,"path":"/t)") +
            std::to_string(number) + "\"}";
    write(text + "]}");
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(60'000));
    EXPECT_EQ(nodes.back().path, "/t59999");
}

TEST_F(MachineFileSourceTest, RecordedIsTheSameMachine)
{
    write(R"({"nodes":[
        {"type":"tachometer","path":"/f","description":"Fan \"A\" \\ 温度","status":1,
         "possibleStates":[1,22],"baseUnits":19,"reading":5273,"lowerNonCritical":712},
        {"type":"voltage","path":"/v","description":"","sensorType":4294967295,"reading":0.1,
         "lowerCritical":-1.7976931348623157e308,"upperCritical":5e-324,"lowerFatal":-0.0},
        {"type":"temperature","path":"/t","description":" T ","status":26,"possibleStates":[],
         "upperNonCritical":80.123456789012345,"upperFatal":1e22}]})");
    const auto before = walk();
    const std::string recorded = Vorn::recordMachineFile();
    write(recorded);
    EXPECT_EQ(walk(), before);
    EXPECT_EQ(Vorn::recordMachineFile(), recorded);
}

TEST_F(MachineFileSourceTest, RecordedHasOneLineForEveryNode)
{
    write(modelOf("V"));
    EXPECT_EQ(Vorn::recordMachineFile(),
        "{ \"nodes\": [\n"
        R"(  {"type":"voltage","path":"/v","description":"V","sensorType":21,"status":0,"reading":1.0})"
        "\n] }\n");
    write(R"({"nodes":[]})");
    EXPECT_EQ(Vorn::recordMachineFile(), "{ \"nodes\": [\n] }\n");
}

} // namespace MachineFileSourceTests
