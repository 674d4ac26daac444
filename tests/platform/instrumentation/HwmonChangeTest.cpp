// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Chips that appear and disappear, and a configuration that changes, while threads read.

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "tests/platform/instrumentation/HwmonMachine.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <thread>

namespace HwmonChangeTests {

using Testing::Attributes;
using Testing::BoundSysfs;
using testing::ElementsAre;
using Testing::HwmonTest;
using testing::IsEmpty;
using Testing::OneChip;
using testing::SizeIs;
using Testing::testchip;
using Testing::walk;
using Vorn::NodeLexicon::NodeType;

using HwmonChangeTest = HwmonTest;

constexpr const char* nvme = "hwmon/hwmon1";

std::vector<std::string> paths()
{
    std::vector<std::string> found;
    for (const Testing::SeenNode& node : walk())
        found.push_back(node.path);
    return found;
}

TEST_F(HwmonChangeTest, AChipThatVanishedOrCameBackShowsAtTheNextRequest)
{
    BoundSysfs sysfs("hotplug");
    const auto before = paths();
    EXPECT_THAT(before, ElementsAre("/hwmon/coretemp-isa-0000/temp1",
                            "/hwmon/drivetemp-scsi-2-0/temp1", "/hwmon/nvme-pci-0200/temp1"));
    sysfs.rename(nvme, "unplugged");
    EXPECT_THAT(
        paths(), ElementsAre("/hwmon/coretemp-isa-0000/temp1", "/hwmon/drivetemp-scsi-2-0/temp1"));
    sysfs.rename("unplugged", "hwmon/hwmon9");
    EXPECT_EQ(paths(), before);
}

TEST_F(HwmonChangeTest, AChipThatTookAnothersPlaceIsTakenForWhatItIs)
{
    BoundSysfs sysfs("hotplug");
    walk();
    sysfs.rename(nvme, "unplugged");
    sysfs.addChip("hwmon1", "other", "pci", "0000:03:00.0");
    sysfs.write(std::string(nvme) + "/temp1_input", "20000\n");
    EXPECT_THAT(paths(), testing::Contains("/hwmon/other-pci-0300/temp1"));
}

TEST_F(HwmonChangeTest, AnAttributeThatADriverAddsShowsWithinTwoSeconds)
{
    OneChip chip(Attributes{{"temp1_input", "20000"}});
    EXPECT_THAT(walk(), SizeIs(1));
    chip.set("temp2_input", "21000");
    chip.set("temp1_max", "30000");
    std::this_thread::sleep_for(std::chrono::seconds(2));
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(2));
    EXPECT_EQ(nodes[0].values.upperNonCritical, 30.0);
    EXPECT_EQ(nodes[1].values.reading, 21.0);
}

TEST_F(HwmonChangeTest, AnAttributeThatAnOldDriverAddsToTheDeviceShowsWithinTwoSeconds)
{
    BoundSysfs sysfs("hotplug");
    sysfs.addChip("hwmon12", "old", "platform", "old.1");
    sysfs.rename("hwmon/hwmon12/name", "hwmon/hwmon12/device/name");
    sysfs.write("hwmon/hwmon12/device/temp1_input", "20000\n");
    EXPECT_THAT(paths(), testing::Contains("/hwmon/old-isa-0001/temp1"));
    sysfs.write("hwmon/hwmon12/device/temp2_input", "21000\n");
    std::this_thread::sleep_for(std::chrono::seconds(2));
    EXPECT_THAT(paths(), testing::Contains("/hwmon/old-isa-0001/temp2"));
}

TEST_F(HwmonChangeTest, AListedNodeWhoseChipVanishedIsLost)
{
    BoundSysfs sysfs("hotplug");
    Vorn::HwmonSource source;
    const auto nodes = source.nodes(NodeType::Temperature);
    ASSERT_THAT(nodes, SizeIs(3));
    EXPECT_EQ(source.read(nodes[2]).reading, 35.85);
    sysfs.remove(nvme);
    EXPECT_EQ(source.read(nodes[2]).status, 13U);
    EXPECT_FALSE(source.read(nodes[2]).reading);
    walk(); // the list is renewed without the chip
    EXPECT_EQ(source.read(nodes[2]), Vorn::NodeReading{.status = 13});
    EXPECT_EQ(source.read(nodes[0]).reading, 44.0);
}

TEST_F(HwmonChangeTest, AListedNodeOutlivesChangesElsewhere)
{
    BoundSysfs sysfs("hotplug");
    Vorn::HwmonSource source;
    const auto nodes = source.nodes(NodeType::Temperature);
    sysfs.remove("hwmon/hwmon0");
    sysfs.addChip("hwmon12", "newcomer", "platform", "newcomer.1");
    walk();
    EXPECT_EQ(source.read(nodes.at(2)).reading, 35.85);
}

TEST_F(HwmonChangeTest, AComputedNodeOutlivesChangesElsewhere)
{
    configuration().write("chip \"nvme-*\"\n  compute temp1 @*2, @/2\n");
    BoundSysfs sysfs("hotplug");
    Vorn::HwmonSource source;
    const auto nodes = source.nodes(NodeType::Temperature);
    sysfs.remove("hwmon/hwmon0");
    walk();
    EXPECT_EQ(source.read(nodes.at(2)).reading, 71.7);
    configuration().write("");
    walk();
    EXPECT_EQ(source.read(nodes.at(2)).reading, 35.85) << "the configuration is that of now";
}

TEST_F(HwmonChangeTest, AComputedNodeIsNotReadFromAChipThatTookItsPlace)
{
    configuration().write("chip \"*-*\"\n  compute temp1 @*2, @/2\n");
    BoundSysfs sysfs("hotplug");
    Vorn::HwmonSource source;
    const auto nodes = source.nodes(NodeType::Temperature);
    sysfs.rename(nvme, "unplugged");
    sysfs.addChip("hwmon1", "other", "pci", "0000:03:00.0");
    sysfs.write(std::string(nvme) + "/temp1_input", "20000\n");
    EXPECT_EQ(source.read(nodes.at(2)), Vorn::NodeReading{.status = 13});
    walk();
    EXPECT_EQ(source.read(nodes.at(2)), Vorn::NodeReading{.status = 13});
}

TEST_F(HwmonChangeTest, AChangedConfigurationHoldsAtTheNextRequest)
{
    const OneChip chip(Attributes{{"temp1_input", "20000"}});
    EXPECT_EQ(walk().at(0).description, "temp1");
    configuration().write("chip \"*-*\"\n  label temp1 \"Board\"\n");
    EXPECT_EQ(walk().at(0).description, "Board");
    configuration().write("chip \"*-*\"\n  ignore temp1\n");
    EXPECT_THAT(walk(), IsEmpty());
}

TEST_F(HwmonChangeTest, TwoCursorsOnOneThreadDoNotBlockEachOther)
{
    BoundSysfs sysfs("hotplug");
    Vorn::Instrumentation first;
    first.selectNode(NodeType::Temperature);
    sysfs.remove(nvme);
    Vorn::Instrumentation second;
    second.selectNode(NodeType::Temperature);
    EXPECT_EQ(first.getNodeStatus(), 1U);
    EXPECT_EQ(second.getNodeStatus(), 1U);
}

// Returns the reading that is in the tree; nothing for a lost node.
std::optional<double> expectedReading(const Testing::SeenNode& node)
{
    static const std::map<std::string, double> readings{{"/hwmon/coretemp-isa-0000/temp1", 44.0},
        {"/hwmon/drivetemp-scsi-2-0/temp1", 62.0}, {"/hwmon/nvme-pci-0200/temp1", 35.85}};
    if (node.values.status == 13)
        return std::nullopt;
    return readings.at(node.path);
}

class HwmonChangeByOrderTest : public HwmonTest, public testing::WithParamInterface<const char*> {};

TEST_P(HwmonChangeByOrderTest, EightThreadsReadWhileChipsComeAndGo)
{
    const Testing::EnvironmentVariable source("VORN_INSTRUMENTATION", GetParam());
    configuration().write("chip \"drivetemp-*\"\n  compute temp1 @*2, @/2\n");
    BoundSysfs sysfs("hotplug");
    std::atomic<bool> goOn{true};
    std::atomic<unsigned> walks{0};
    std::vector<std::jthread> readers;
    for (int reader = 0; reader < 8; ++reader)
        readers.emplace_back([&] {
            while (goOn) {
                const auto nodes = walk();
                EXPECT_GE(nodes.size(), 2U);
                for (const Testing::SeenNode& node : nodes)
                    EXPECT_EQ(node.values.reading, expectedReading(node)) << node.path;
                ++walks;
            }
        });
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(1);
    while (std::chrono::steady_clock::now() < end) {
        sysfs.rename(nvme, "unplugged");
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
        sysfs.renew("unplugged");
        sysfs.rename("unplugged", nvme);
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    goOn = false;
    readers.clear();
    EXPECT_GT(walks, 8U);
    EXPECT_THAT(walk(), SizeIs(3));
}

INSTANTIATE_TEST_SUITE_P(Orders, HwmonChangeByOrderTest, testing::Values("hwmon", "hwmon:parallel"),
    [](const auto& order) { return order.param == std::string("hwmon") ? "Serial" : "Parallel"; });

} // namespace HwmonChangeTests
