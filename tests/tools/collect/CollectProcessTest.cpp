// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The process that renews the file again and again, each second.

#include "tests/tools/collect/CollectProcessTest.h"

#include "platform/instrumentation/machinefile/MachineFileWriter.h"
#include "tests/support/ErrorOf.h"

#include <sys/stat.h>

#include <algorithm>

namespace CollectProcessTests {

using Testing::nodeOf;
using Testing::waitUntil;
using Vorn::MachineFile;
using Vorn::MachineFileNode;

using CollectProcessTest = Testing::CollectProcessTest;

bool isLost(const MachineFileNode& node)
{
    return node.values.status == 13 && !node.values.reading;
}

TEST_F(CollectProcessTest, AControllerThatFallsSilentLosesAllSensorsUntilItAnswers)
{
    const std::string log = folder_.write("err", "");
    struct stat status {};
    ::stat(log.c_str(), &status);
    start(
        {{"JOURNAL_STREAM", std::to_string(status.st_dev) + ":" + std::to_string(status.st_ino)}});
    const MachineFile before = collected();
    const auto begin = std::chrono::steady_clock::now();
    bmc_.suspend();
    const double suspended = Vorn::secondsSinceStart();
    const std::string device = lockedDevice();
    ASSERT_TRUE(waitForStatus("CPU1 Temp", 13)) << errors();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(10));
    const MachineFile silent = collected();
    EXPECT_TRUE(std::all_of(silent.nodes.begin(), silent.nodes.end(), isLost));
    ASSERT_EQ(silent.nodes.size(), before.nodes.size());
    EXPECT_EQ(nodeOf(silent, "CPU1 Temp").values.upperFatal, 100);
    EXPECT_TRUE(
        waitUntil([this] { return errors() == "<3>sensorctl: the BMC does not answer\n"; }));
    // The time remains that of the last readings.
    EXPECT_LE(silent.renewal.value().time, suspended);
    EXPECT_THAT(listed("--color=never"), testing::ContainsRegex("ipmi +\\(read [4-9] s ago\\)\n"));

    bmc_.resume();
    ASSERT_TRUE(waitForStatus("CPU1 Temp", 1)) << errors();
    EXPECT_EQ(nodeOf(collected(), "CPU1 Temp").values.reading, 58);
    EXPECT_THAT(device, testing::StartsWith("socket:"));
    EXPECT_EQ(lockedDevice(), device); // was not closed meanwhile
    // A sensor that has never been read is not one that was lost.
    EXPECT_EQ(nodeOf(collected(), "NVMe Temp").values.status, 17);
    EXPECT_TRUE(waitUntil(
        [this] { return errors().ends_with("\n<6>sensorctl: the sensors are read again\n"); }));
}

TEST_F(CollectProcessTest, ASensorAtWhichTheControllerFallsSilentLosesTheOthersForOnePassOnly)
{
    start();
    bmc_.setFaults(fault(numberOf("CPU1 Temp"), "drop"));
    ASSERT_TRUE(waitForStatus("GPU Temp", 13)) << errors();
    ASSERT_TRUE(waitForStatus("GPU Temp", 26)) << errors();
    EXPECT_TRUE(isLost(nodeOf(collected(), "CPU1 Temp")));
    EXPECT_EQ(nodeOf(collected(), "CPU2 Temp").values.reading, 88);
    EXPECT_EQ(nodeOf(collected(), "CPU1 Temp").values.upperFatal, 100);
}

TEST_F(CollectProcessTest, ASatelliteThatIsSwitchedOffIsReadAgainWhenItIsOn)
{
    start();
    bmc_.command("mc_disable 0x2c");
    ASSERT_TRUE(waitForStatus("ME Temp", 13)) << errors();
    EXPECT_EQ(nodeOf(collected(), "CPU1 Temp").values.reading, 58);
    bmc_.command("mc_enable 0x2c");
    ASSERT_TRUE(waitForStatus("ME Temp", 1)) << errors();
    EXPECT_EQ(nodeOf(collected(), "ME Temp").values.reading, 51);
    EXPECT_EQ(errors(), "");
}

TEST_F(CollectProcessTest, AControllerThatRestartsInTheMiddleOfAPassIsReadAgain)
{
    start({{"SIMULATED_BMC_DELAY", "2"}});
    ASSERT_TRUE(waitUntil([this] {
        const std::vector<std::size_t> counts = passes();
        return counts.size() > 1 && counts.back() > 10 && counts.back() < 40;
    }));
    bmc_.stop();
    bmc_.start();
    ASSERT_TRUE(waitUntil([this] {
        return errors() ==
               "sensorctl: the BMC does not answer\nsensorctl: the sensors are read again\n";
    })) << errors();
    EXPECT_TRUE(waitForStatus("CPU1 Temp", 1));
}

TEST_F(CollectProcessTest, ADeviceThatTheKernelRemovesIsReadAgainWhenItIsBack)
{
    const std::filesystem::path removal = folder_.path() / "removal";
    start({{"SIMULATED_REMOVAL", removal.string()}});
    folder_.write("removal", "");
    ASSERT_TRUE(waitForStatus("CPU1 Temp", 13)) << errors();
    const std::string failure = "sensorctl: /dev/ipmi0: No such ";
    ASSERT_TRUE(waitUntil([&] {
        return errors() == failure + "device\n" + failure + "file or directory\n";
    })) << errors();
    std::filesystem::remove(removal);
    ASSERT_TRUE(waitForStatus("CPU1 Temp", 1)) << errors();
}

TEST_F(CollectProcessTest, ASensorThatWasReadBeforeIsLostWhenItIsUnavailable)
{
    start();
    bmc_.setFaults(unavailable(numberOf("CPU1 Temp")));
    EXPECT_TRUE(waitForStatus("CPU1 Temp", 13));
}

TEST_F(CollectProcessTest, AnAddedRecordIsAnotherSensor)
{
    start();
    Testing::SimulatedSensor added{.idString = Testing::eightBit("New Temp"), .raw = 33};
    added.number = 200;
    // The new record is complete before the time stamp of the repository changes.
    bmc_.command("sensor_add 0x20 0 200 0x01 0x01");
    bmc_.command("sensor_set_event_support 0x20 0 200 enable scanning per-state 000000000000000 "
                 "000000000000000 000000000000000 000000000000000");
    bmc_.command("sensor_set_value 0x20 0 200 33 0");
    std::string addition = Testing::additionOf(Testing::recordOf(added));
    addition.pop_back();
    bmc_.command(addition);
    ASSERT_TRUE(waitForFile([](const MachineFile& file) {
        const MachineFileNode* const node = Testing::findNode(file, "/ipmi/20/0/200");
        return node != nullptr && node->values.reading == 33;
    })) << Testing::contentOf(file());
}

TEST_F(CollectProcessTest, ChangedThresholdsAreReadInTurn)
{
    start();
    constexpr const char* name = "Inlet Temp"; // one of the first
    ASSERT_EQ(nodeOf(collected(), name).values.upperCritical, 42);
    bmc_.command("sensor_set_threshold 0x20 0 " + std::to_string(numberOf(name)) +
                 " settable 011011 0 45 40 0 0xf9 3");
    EXPECT_TRUE(waitForFile(
        [&](const MachineFile& file) { return nodeOf(file, name).values.upperCritical == 45; }));
    EXPECT_EQ(nodeOf(collected(), name).values.upperNonCritical, 40);
}

TEST_F(CollectProcessTest, ASecondProcessSaysThatThereIsOne)
{
    start();
    // Each process has a device of its own here: a socket, which the other one does not lock.
    for (const std::vector<std::string>& options : {std::vector<std::string>{"--once"}, {}}) {
        const Testing::Ended second =
            Testing::run(arguments(options), {.environment = bmc_.environment()});
        EXPECT_EQ(second.code, 1);
        ASSERT_EQ(second.err, "sensorctl: " + file() + ": another process renews it already\n");
    }
    EXPECT_EQ(errors(), "");
    kill();
    EXPECT_NO_THROW(collect());
}

TEST_F(CollectProcessTest, WhatAnEndedProcessLeftIsRemoved)
{
    folder_.write("ipmi.json.new", "{");
    collect();
    EXPECT_FALSE(std::filesystem::exists(file() + ".new"));

    file_ = folder_.path() / "missing/ipmi.json";
    EXPECT_EQ(Testing::errorOf([this] { collect(); }),
        "sensorctl: " + file() + ": No such file or directory\n");
}

TEST_F(CollectProcessTest, TheProviderPublishesItsSensorsUntilThreePeriodsAfterItsEnd)
{
    start();
    const std::string table = listed();
    EXPECT_EQ(Testing::linesOf(table).size(), collected().nodes.size() + 1) << table;
    EXPECT_THAT(table, testing::ContainsRegex("CPU1 Temp .* 58 "));
    kill();
    EXPECT_TRUE(waitUntil([this] {
        return Testing::countOf(listed(), "Lost") == collected().nodes.size();
    })) << listed();
    const double age = Vorn::secondsSinceStart() - collected().renewal.value().time;
    EXPECT_GT(age, 3 * collected().renewal.value().period);

    std::filesystem::remove(file());
    start();
    EXPECT_THAT(listed(), testing::ContainsRegex("CPU1 Temp .* 58 "));
}

TEST_F(CollectProcessTest, ListShowsAGroupWithTheAgeOfTheReadings)
{
    collect();
    EXPECT_THAT(listed("--color=never"), testing::ContainsRegex("ipmi +\\(read [0-9]+ s ago\\)\n"));
}

TEST_F(CollectProcessTest, ListShowsTheAgeOfTheOldestOfSeveralCollections)
{
    MachineFile older = collect();
    older.nodes.resize(1);
    older.nodes[0].path = "/ipmi/22/0/1";
    older.renewal.value().time -= 20;
    const std::string sources =
        "ipmi:" + folder_.write("broken.json", "{") + ",ipmi:" + file() +
        ",ipmi:" + folder_.write("older.json", Vorn::writeMachineFile(older));
    const std::string table = Testing::run({"list", "--color=never"},
        {.environment = {{"VORN_INSTRUMENTATION",
             sources}}}).out;
    EXPECT_THAT(table, testing::ContainsRegex("ipmi +\\(read 2[0-9] s ago\\)\n"));
    EXPECT_THAT(table, testing::HasSubstr("CPU1 Temp:/ipmi/20/0/1"));
    EXPECT_THAT(table, testing::HasSubstr("CPU1 Temp:/ipmi/22/0/1"));
}

} // namespace CollectProcessTests
