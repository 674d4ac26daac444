// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The hwmon source with attributes that a test defines.

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "tests/platform/instrumentation/HwmonMachine.h"
#include "tests/support/LogCapture.h"

#include <gmock/gmock.h>

#include <sensors/error.h>

#include <new>

namespace HwmonSourceTests {

using Testing::Attributes;
using Testing::BoundSysfs;
using testing::ElementsAre;
using testing::HasSubstr;
using Testing::HwmonTest;
using testing::IsEmpty;
using Testing::nodeAt;
using Testing::nodeOf;
using Testing::OneChip;
using Testing::only;
using Testing::SeenNode;
using testing::SizeIs;
using Testing::testchip;
using Testing::walk;
using Vorn::NodeLexicon::NodeType;

TEST_F(HwmonTest, AMachineWithoutTheHwmonClassHasNoSensors)
{
    BoundSysfs sysfs("");
    sysfs.remove("hwmon");
    EXPECT_THAT(walk(), IsEmpty());
}

TEST_F(HwmonTest, AMachineWithoutChipsHasNoSensors)
{
    const BoundSysfs sysfs("");
    EXPECT_THAT(walk(), IsEmpty());
}

TEST_F(HwmonTest, EachKindHasItsTypeItsUnitsAndItsScale)
{
    const OneChip chip({{"temp1_input", "41500"}, {"in0_input", "1024"}, {"fan1_input", "900"},
        {"power1_input", "1"}, {"curr1_input", "1"}, {"humidity1_input", "1"}});
    const auto nodes = walk();
    ASSERT_THAT(nodes, SizeIs(3));
    const auto& temperature = nodeAt(nodes, testchip("temp1"));
    EXPECT_EQ(temperature.type, NodeType::Temperature);
    EXPECT_EQ(temperature.sensorType, 22U);
    EXPECT_EQ(temperature.values.baseUnits, 2U);
    EXPECT_EQ(temperature.values.reading, 41.5);
    const auto& voltage = nodeAt(nodes, testchip("in0"));
    EXPECT_EQ(voltage.type, NodeType::Voltage);
    EXPECT_EQ(voltage.sensorType, 21U);
    EXPECT_EQ(voltage.values.baseUnits, 5U);
    EXPECT_EQ(voltage.values.reading, 1.024);
    const auto& fan = nodeAt(nodes, testchip("fan1"));
    EXPECT_EQ(fan.type, NodeType::Tachometer);
    EXPECT_EQ(fan.sensorType, 20U);
    EXPECT_EQ(fan.values.baseUnits, 19U);
    EXPECT_EQ(fan.values.reading, 900.0);
}

TEST_F(HwmonTest, EveryLimitBecomesItsThreshold)
{
    const SeenNode node = nodeOf({{"temp1_input", "50000"}, {"temp1_min", "5000"},
        {"temp1_max", "80000"}, {"temp1_lcrit", "-10000"}, {"temp1_crit", "95000"},
        {"temp1_emergency", "105000"}, {"temp1_max_hyst", "75000"}, {"temp1_highest", "60000"}});
    EXPECT_EQ(node.values, (Vorn::NodeReading{.status = 1,
                               .reading = 50,
                               .lowerNonCritical = 5,
                               .upperNonCritical = 80,
                               .lowerCritical = -10,
                               .upperCritical = 95,
                               .upperFatal = 105,
                               .baseUnits = 2,
                               .possibleStates = {{1, 22, 23, 25, 26}}}));
}

TEST_F(HwmonTest, TheAverageStandsInWhereThereIsNoInput)
{
    EXPECT_EQ(nodeOf({{"in1_average", "3250"}}).values.reading, 3.25);
    EXPECT_EQ(nodeOf({{"in1_average", "3250"}, {"in1_input", "5000"}}).values.reading, 5.0);
    EXPECT_EQ(
        nodeOf({{"in1_average", "3250"}, {"in1_input", "none"}}).values.reading, std::nullopt);
}

// The attribute is a folder, has no number, or is gone: the failures that need no driver.
TEST_F(HwmonTest, AnAttributeThatCannotBeReadNowIsLostNow)
{
    OneChip chip(Attributes{{"temp1_input", "50000"}});
    Vorn::HwmonSource source;
    const Vorn::Node node = source.nodes(NodeType::Temperature).at(0);
    const auto attribute = chip.sysfs().path("hwmon/hwmon0/temp1_input");
    std::filesystem::remove(attribute);
    EXPECT_EQ(source.read(node).status, 13U);
    std::filesystem::create_symlink("nowhere", attribute);
    EXPECT_EQ(source.read(node).status, 13U);
    std::filesystem::remove(attribute);
    std::filesystem::create_directory(attribute);
    EXPECT_EQ(source.read(node).status, 13U);
    std::filesystem::remove(attribute);
    chip.set("temp1_input", "");
    EXPECT_EQ(source.read(node).status, 13U);
    chip.set("temp1_input", "51000");
    EXPECT_EQ(source.read(node).reading, 51.0);
}

TEST_F(HwmonTest, ReadsAfreshAtEveryVisit)
{
    OneChip chip(Attributes{{"temp1_input", "41000"}});
    Vorn::Instrumentation cursor;
    cursor.selectNode(NodeType::Temperature);
    double value = 0.0;
    EXPECT_TRUE(cursor.getProperty(Vorn::NodeLexicon::Properties::Reading, value));
    EXPECT_EQ(value, 41.0);
    chip.set("temp1_input", "42000");
    EXPECT_EQ(only(walk()).values.reading, 42.0);
}

TEST_F(HwmonTest, ALabelIsMadeValidAndTrimmed)
{
    const auto description = [](const std::string& label) {
        return nodeOf({{"temp1_input", "1000"}, {"temp1_label", label}}).description;
    };
    EXPECT_EQ(description("CPU Temp"), "CPU Temp");
    EXPECT_EQ(description("  \tCPU Temp  "), "CPU Temp");
    EXPECT_EQ(description("\u6E29\u5EA6"), "\u6E29\u5EA6");
    EXPECT_EQ(description("Temp \xB0"
                          "C"),
        "Temp \xEF\xBF\xBD"
        "C");
    EXPECT_EQ(description("   "), "temp1");
    EXPECT_EQ(description(""), "temp1");
    EXPECT_EQ(nodeOf({{"temp1_input", "1000"}}).description, "temp1");
}

TEST_F(HwmonTest, TheConfigurationLabelsComputesAndIgnores)
{
    configuration().write("chip \"testchip-*\"\n"
                          "  label temp1 \"  Board \xFF \"\n"
                          "  compute temp1 @*2, @/2\n"
                          "  ignore temp2\n");
    const OneChip chip({{"temp1_input", "20000"}, {"temp1_max", "30000"}, {"temp1_label", "raw"},
        {"temp2_input", "1000"}});
    const SeenNode node = only(walk());
    EXPECT_EQ(node.description, "Board \xEF\xBF\xBD");
    EXPECT_EQ(node.values.reading, 40.0);
    EXPECT_EQ(node.values.upperNonCritical, 60.0);
}

TEST_F(HwmonTest, AValueComputedToNoNumberIsLost)
{
    configuration().write("chip \"*-*\"\n  compute temp1 1/(@-@), @\n");
    EXPECT_EQ(nodeOf({{"temp1_input", "20000"}}).values.status, 13U);
}

TEST_F(HwmonTest, ChipsAreSortedByNameAndFeaturesStandAsInTheDriver)
{
    BoundSysfs sysfs("");
    for (const std::string name : {"zeta", "alpha", "mid"}) {
        const std::string folder = "hwmon" + name;
        sysfs.addChip(folder, name, "platform", name + ".1");
        for (const std::string feature : {"temp10", "temp2", "temp1"})
            sysfs.write("hwmon/" + folder + "/" + feature + "_input", "1000\n");
    }
    std::vector<std::string> paths;
    for (const SeenNode& node : walk())
        paths.push_back(node.path);
    EXPECT_THAT(paths,
        ElementsAre("/hwmon/alpha-isa-0001/temp1", "/hwmon/alpha-isa-0001/temp2",
            "/hwmon/alpha-isa-0001/temp10", "/hwmon/mid-isa-0001/temp1",
            "/hwmon/mid-isa-0001/temp2", "/hwmon/mid-isa-0001/temp10", "/hwmon/zeta-isa-0001/temp1",
            "/hwmon/zeta-isa-0001/temp2", "/hwmon/zeta-isa-0001/temp10"));
}

TEST_F(HwmonTest, AWrongConfigurationIsReportedOnceAndTheRestHolds)
{
    const Testing::LogCapture capture;
    configuration().write("chip \"testchip-*\"\n  label temp1 \"Board\"\n  nonsense here\n");
    OneChip chip(Attributes{{"temp1_input", "20000"}});
    EXPECT_EQ(only(walk()).description, "Board");
    chip.sysfs().addChip("hwmon7", "other", "platform", "other.1"); // the list is renewed
    walk();
    ASSERT_THAT(capture.log(), SizeIs(1));
    EXPECT_THAT(capture.log()[0].text, HasSubstr("Error: File /etc/sensors3.conf, line 3: "));
    EXPECT_EQ(capture.log()[0].component, "Nimbrel.Instrumentation");
    EXPECT_EQ(capture.log()[0].level, 6000);
}

TEST_F(HwmonTest, AConfigurationMayBeWrongFromTheFirstLineOnThoughItIsReadAgain)
{
    const Testing::LogCapture capture;
    configuration().write("label temp1 \"Stray\"\nchip \"*\"\n  compute temp1 @*3, @/3\n");
    OneChip chip(Attributes{{"temp1_input", "20000"}});
    for (const std::string other : {"a", "b", "c"}) {
        EXPECT_EQ(nodeAt(walk(), testchip("temp1")).description, "temp1");
        chip.sysfs().addChip("hwmon" + other, other, "platform", other + ".1");
    }
    ASSERT_THAT(capture.log(), SizeIs(1));
    EXPECT_EQ(
        capture.log()[0].text, "Error: File /etc/sensors3.conf, line 2: Parse error in chip name");
}

TEST_F(HwmonTest, TheFolderOfConfigurationsAddsToTheFile)
{
    const Testing::LogCapture capture;
    const Testing::TemporaryFolder folder;
    folder.write("10-label.conf", "chip \"testchip-*\"\n  label temp1 \"First\" \\");
    folder.write("20-wrong.conf", "\n\nnonsense here\n");
    folder.write(".hidden", "chip \"testchip-*\"\n  ignore temp1\n");
    const Testing::BindMount bound(folder.path(), "/etc/sensors.d");
    EXPECT_EQ(nodeOf({{"temp1_input", "20000"}}).description, "First");
    ASSERT_THAT(capture.log(), SizeIs(1));
    EXPECT_THAT(
        capture.log()[0].text, HasSubstr("Error: File /etc/sensors.d/20-wrong.conf, line 3: "));
}

TEST_F(HwmonTest, AConfigurationThatCannotBeReadIsNamed)
{
    const Testing::TemporaryFolder folder;
    folder.write("large.conf", std::string(2'000'000, '\n'));
    const Testing::BindMount bound(folder.path(), "/etc/sensors.d");
    const OneChip chip(Attributes{{"temp1_input", "20000"}});
    EXPECT_EQ(Testing::errorOf([] { walk(); }),
        "sensors configuration /etc/sensors.d/large.conf: Larger than 1048576 bytes");
}

TEST_F(HwmonTest, AMachineWithoutSysfsSaysThatLibsensorsCannotBeUsed)
{
    const Testing::LogCapture capture;
    const Testing::TemporaryFolder empty;
    std::filesystem::create_directories(empty.path() / "class/hwmon");
    {
        const Testing::BindMount noSysfs(empty.path(), "/sys");
        for (int request = 0; request < 2; ++request)
            EXPECT_EQ(Testing::errorOf([] { walk(); }),
                "libsensors cannot list the chips: Kernel interface error");
    }
    EXPECT_THAT(capture.log(), SizeIs(1));
    EXPECT_EQ(nodeOf({{"temp1_input", "20000"}}).values.reading, 20.0);
}

TEST_F(HwmonTest, AFatalErrorOfLibsensorsIsALackOfMemoryAndNotTheEndOfTheProcess)
{
    const OneChip chip(Attributes{{"temp1_input", "20000"}});
    walk();
    EXPECT_THROW(sensors_fatal_error("sensors_malloc", "Out of memory"), std::bad_alloc);
}

} // namespace HwmonSourceTests
