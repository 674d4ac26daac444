// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The process on a full disk, with a clock that jumps, and without rights.

#include "tests/support/Requirement.h"
#include "tests/support/Umask.h"
#include "tests/tools/collect/CollectProcessTest.h"

#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>

namespace CollectSurroundingsTests {

using Testing::cannotRun;
using Testing::Ended;
using Testing::sensorctl;
using Testing::waitUntil;

using Words = std::vector<std::string>;

Words joined(Words words, const Words& more)
{
    words.insert(words.end(), more.begin(), more.end());
    return words;
}

// Returns the words of a command that mounts on the folder, where nobody else sees it, and executes
// what follows.
Words inNamespace(const std::string& mount, const std::filesystem::path& folder)
{
    return {SENSOR_PROFILE_PRIVATE_MOUNTS, "/bin/sh", "-c", mount + " && exec \"$@\"", folder};
}

Ended runCommand(Words command, const std::map<std::string, std::string>& environment = {})
{
    const std::string program = command.front();
    command.erase(command.begin());
    return Testing::run(command, {.program = program, .environment = environment});
}

bool canMount()
{
    return ::geteuid() == 0 && runCommand({SENSOR_PROFILE_PRIVATE_MOUNTS, "/bin/true"}).code == 0;
}

const Words asNobody = {
    "/usr/bin/setpriv", "--reuid=nobody", "--regid=nogroup", "--clear-groups", sensorctl};

class CollectSurroundingsTest : public Testing::CollectProcessTest {
protected:
    double renewed() const { return collected().renewal.value().time; }
};

TEST_F(CollectSurroundingsTest, AFullDiskLeavesTheLastFileWhichAges)
{
    if (!canMount())
        return cannotRun("no disk can be mounted here");
    const std::filesystem::path disk = folder_.path() / "disk";
    std::filesystem::create_directory(disk);
    file_ = disk / "ipmi.json";
    launch(joined(inNamespace("/bin/mount -t tmpfs -o size=64k tmpfs \"$0\"", disk), {sensorctl}));
    const std::filesystem::path seenDisk =
        "/proc/" + std::to_string(process_) + "/root" + disk.string();
    file_ = seenDisk / "ipmi.json";
    ASSERT_TRUE(waitUntil([this] { return std::filesystem::exists(file()); })) << errors();

    std::ofstream(seenDisk / "filler") << std::string(std::size_t{64} << 10U, ' ');
    const std::string name = "sensorctl: " + (disk / "ipmi.json").string();
    const std::string problem = name + ": No space left on device\n";
    ASSERT_TRUE(waitUntil([&] { return errors() == problem; })) << errors();
    const double before = renewed();
    const std::size_t sensors = collected().nodes.size();
    EXPECT_TRUE(waitUntil([&] { return Testing::countOf(listed(), "Lost") == sensors; }));
    EXPECT_EQ(renewed(), before);
    EXPECT_EQ(errors(), problem);

    std::filesystem::remove(seenDisk / "filler");
    EXPECT_TRUE(waitUntil([&] { return renewed() > before; }));
    EXPECT_TRUE(waitUntil([&] { return errors() == problem + name + " is written again\n"; }))
        << errors();
    EXPECT_TRUE(waitUntil([&] {
        return std::distance(std::filesystem::directory_iterator(seenDisk), {}) == 2;
    })) << "the file and its lock";
}

TEST_F(CollectSurroundingsTest, AClockThatJumpsChangesNothing)
{
    const std::map<std::string, std::string> jumping = {
        {"LD_PRELOAD", bmc_.environment().at("LD_PRELOAD")}, {"SIMULATED_CLOCK_JUMPS", "1"}};
    start(jumping);
    const double first = renewed();
    ASSERT_TRUE(waitUntil([&] { return renewed() > first + 2; })) << errors();
    EXPECT_LT(passes().size(), 6U);
    EXPECT_NEAR(renewed(), Vorn::secondsSinceStart(), 2);
    EXPECT_THAT(listed("--flat", jumping), testing::ContainsRegex("CPU1 Temp .* 58 "));
    EXPECT_THAT(listed("--color=never", jumping), testing::ContainsRegex("\\(read [012] s ago\\)"));
}

TEST_F(CollectSurroundingsTest, EverybodyCanReadTheFile)
{
    if (::geteuid() != 0)
        return cannotRun("only root can run a command as nobody");
    {
        const Testing::Umask umask(077);
        collect();
    }
    ::chmod(folder_.path().c_str(), 0755);
    const Ended ended =
        runCommand(joined(asNobody, {"list"}), {{"VORN_INSTRUMENTATION", "ipmi:" + file()}});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_THAT(ended.out, testing::ContainsRegex("CPU1 Temp .* 58 "));
}

TEST_F(CollectSurroundingsTest, ACheckThatMayNotReadTheFileIsUnknown)
{
    if (::geteuid() != 0)
        return cannotRun("only root can run a command as nobody");
    collect();
    ::chmod(folder_.path().c_str(), 0755);
    ::chmod(file().c_str(), 0600);
    const Ended ended =
        runCommand(joined(asNobody, {"check"}), {{"VORN_INSTRUMENTATION", "ipmi:" + file()}});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.out,
        testing::StartsWith("SENSORS UNKNOWN - model file " + file() + ": Permission denied"));
}

TEST_F(CollectSurroundingsTest, UserWithoutPermissionGetsTheReason)
{
    if (::geteuid() != 0)
        return cannotRun("only root can run a command as nobody");
    const Words once = joined(asNobody, arguments({"--once"}));
    ::chmod(folder_.path().c_str(), 0755);
    EXPECT_EQ(
        runCommand(once, bmc_.environment()).err, "sensorctl: " + file() + ": Permission denied\n");

    if (!canMount())
        return cannotRun("no folder can be mounted here");
    // A folder takes the place of /run, where the file is by default.
    std::filesystem::create_directory(folder_.path() / "run");
    EXPECT_EQ(
        runCommand(joined(inNamespace("/bin/mount --bind \"$0\" /run", folder_.path() / "run"),
                       joined(asNobody, {"collect", "--once"})),
            bmc_.environment())
            .err,
        "sensorctl: /run/sensor-profile: Permission denied\n");

    // A folder takes the place of /dev.
    std::filesystem::create_directory(folder_.path() / "dev");
    folder_.write("dev/ipmi0", "");
    ::chmod((folder_.path() / "dev/ipmi0").c_str(), 0600);
    const Ended ended = runCommand(
        joined(inNamespace("/bin/mount --bind \"$0\" /dev", folder_.path() / "dev"), once));
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: /dev/ipmi0: Permission denied\n");
}

TEST_F(CollectSurroundingsTest, ADeviceThatAnotherProcessHasLockedIsNotRead)
{
    if (!canMount())
        return cannotRun("no folder can be mounted here");
    std::filesystem::create_directory(folder_.path() / "dev");
    folder_.write("dev/ipmi0", "");
    const Words locked = {
        "/usr/bin/flock", "--shared", "/dev/ipmi0", "/usr/bin/timeout", "10", sensorctl};
    const Ended ended =
        runCommand(joined(inNamespace("/bin/mount --bind \"$0\" /dev", folder_.path() / "dev"),
            joined(locked, arguments({}))));
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: another process reads the sensors of /dev/ipmi0 already\n");
    EXPECT_FALSE(std::filesystem::exists(file() + ".lock"));
}

TEST_F(CollectSurroundingsTest, WithoutADeviceThereIsAnError)
{
    if (!canMount())
        return cannotRun("no folder can be mounted here");
    // An empty folder takes the place of /dev, since this machine may have a BMC.
    std::filesystem::create_directory(folder_.path() / "dev");
    const Ended ended =
        runCommand(joined(inNamespace("/bin/mount --bind \"$0\" /dev", folder_.path() / "dev"),
            joined({sensorctl}, arguments({}))));
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: /dev/ipmi0: No such file or directory\n");
}

} // namespace CollectSurroundingsTests
