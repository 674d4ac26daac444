// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Every value is that of the program `sensors`, whatever the machine and the configuration are.

#include "platform/instrumentation/hwmon/ChipList.h"
#include "tests/platform/instrumentation/HwmonMachine.h"
#include "tests/support/Requirement.h"
#include "tests/support/SensorsProgram.h"

#include <gmock/gmock.h>

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <set>

namespace HwmonOracleTests {

using Testing::BoundSysfs;
using Testing::HwmonTest;
using Testing::SeenNode;
using Testing::SensorsChannel;
using Vorn::NodeReading;

using HwmonOracleTest = HwmonTest;

struct Value {
    const char* subfeature;
    std::optional<double> NodeReading::*value;
};

constexpr Value values[] = {{"input", &NodeReading::reading},
    {"min", &NodeReading::lowerNonCritical}, {"max", &NodeReading::upperNonCritical},
    {"lcrit", &NodeReading::lowerCritical}, {"crit", &NodeReading::upperCritical},
    {"emergency", &NodeReading::upperFatal}};

void expectSame(const SeenNode& node, const SensorsChannel& channel)
{
    constexpr double printedDigits = 0.0005;
    for (const Value& value : values) {
        const auto theirs = channel.values.find(value.subfeature);
        const auto ours = node.values.*value.value;
        const bool isThere = theirs != channel.values.end();
        EXPECT_EQ(ours.has_value(), isThere) << value.subfeature;
        EXPECT_NEAR(ours.value_or(0.0), isThere ? theirs->second : 0.0, printedDigits)
            << value.subfeature;
    }
    EXPECT_FALSE(node.values.lowerFatal);
    EXPECT_EQ(node.values.status == 13, !channel.values.contains("input"));
}

// Compares all nodes, and returns how many there are. The program prints nothing of a channel whose
// values cannot be read.
std::size_t compareWithSensors()
{
    auto channels = Testing::sensorsChannels();
    const auto nodes = Testing::walk();
    for (const SeenNode& node : nodes) {
        SCOPED_TRACE(node.path);
        const auto found = channels.find(node.path);
        const bool isPrinted = found != channels.end();
        expectSame(node, isPrinted ? found->second : SensorsChannel());
        if (!isPrinted)
            continue;
        EXPECT_EQ(node.description, found->second.label);
        channels.erase(found);
    }
    for (const auto& [path, channel] : channels)
        ADD_FAILURE() << path << " is missing";
    return nodes.size();
}

class HwmonMachineTest : public HwmonTest,
                         public testing::WithParamInterface<std::pair<const char*, std::size_t>> {};

TEST_P(HwmonMachineTest, HasTheValuesOfTheSensorsProgram)
{
    const BoundSysfs sysfs(GetParam().first);
    EXPECT_EQ(compareWithSensors(), GetParam().second);
}

TEST_P(HwmonMachineTest, HasTheValuesOfTheSensorsProgramWhereTheyAreComputed)
{
    const BoundSysfs sysfs(GetParam().first);
    configuration().write(Testing::sensorsConfiguration);
    EXPECT_GT(compareWithSensors(), 2U);
}

INSTANTIATE_TEST_SUITE_P(Machines, HwmonMachineTest,
    testing::Values(std::pair("desktop", 33U), std::pair("server", 42U), std::pair("hotplug", 3U),
        std::pair("twosocket", 54U), std::pair("laptop", 12U), std::pair("arm", 10U)),
    [](const auto& machine) { return std::string(machine.param.first); });

// Reading the memory of a process at address 0 fails with EIO, as reading a chip that sleeps does.
TEST_F(HwmonOracleTest, AWirelessCardThatSleepsHasNoReading)
{
    const BoundSysfs sysfs("laptop");
    const Testing::BindMount unreadable("/proc/self/mem", "/sys/class/hwmon/hwmon5/temp1_input");
    EXPECT_EQ(compareWithSensors(), 12U);
    EXPECT_EQ(Testing::nodeAt(Testing::walk(), "/hwmon/iwlwifi_1-virtual-0/temp1").values,
        (NodeReading{.status = 13, .baseUnits = 2, .possibleStates = {{1}}}));
}

TEST_F(HwmonOracleTest, AttributesOfAnOldDriverAreInTheFolderOfItsDevice)
{
    BoundSysfs sysfs("");
    sysfs.addChip("hwmon0", "board", "platform", "board.656");
    sysfs.rename("hwmon/hwmon0/name", "hwmon/hwmon0/device/name");
    for (const auto& [file, content] :
        {std::pair("temp1_input", "20000\n"), {"temp1_label", "Inlet\n"}, {"temp1_enable", "0\n"}})
        sysfs.write(std::string("hwmon/hwmon0/device/") + file, content);
    EXPECT_EQ(compareWithSensors(), 1U);
    EXPECT_EQ(Testing::walk().front().description, "Inlet");
}

// libsensors does not see attributes that nobody may read (LibsensorsHooks.cpp).
TEST_F(HwmonOracleTest, TheKernelOpensNoAttributeThatNobodyMayRead)
{
    constexpr const char* writable = "/sys/bus/platform/drivers_probe";
    if (::access(writable, F_OK) != 0)
        return Testing::cannotRun(std::string("there is no ") + writable);
    EXPECT_EQ(::open(writable, O_RDONLY | O_CLOEXEC), -1);
    EXPECT_EQ(errno, EACCES);
}

// A configuration, and the features that libsensors computes on the machine below.
struct Shape {
    const char* name;
    const char* configuration;
    std::set<std::string> computed;
};

class HwmonConfigurationTest : public HwmonTest, public testing::WithParamInterface<Shape> {
protected:
    void SetUp() override
    {
        HwmonTest::SetUp();
        if (IsSkipped() || HasFailure())
            return;
        sysfs_.emplace("");
        sysfs_->addChip("hwmon0", "board", "platform", "board.656");
        sysfs_->addChip("hwmon1", "lm75", "i2c", "1-0048");
        sysfs_->addChip("hwmon2", "lm75", "i2c", "3-0048");
        for (const std::string adapter : {"1", "3"}) {
            const std::string folder = "i2c-adapter/i2c-" + adapter;
            std::filesystem::create_directories(sysfs_->path(folder));
            sysfs_->write(folder + "/name", "Adapter " + adapter + "\n");
        }
        for (const std::string feature : {"in0", "in1", "temp1", "temp2", "fan1"})
            for (const std::string chip : {"hwmon0", "hwmon1", "hwmon2"}) {
                const std::string attribute = "hwmon/" + chip + "/" + feature;
                sysfs_->write(attribute + "_input", "3300\n");
                sysfs_->write(attribute + "_max", "4100\n");
                sysfs_->write(attribute + "_alarm", "1\n");
            }
        configuration().write(GetParam().configuration);
    }

    static std::set<std::string> computed()
    {
        std::set<std::string> paths;
        for (const auto& feature : Vorn::Hwmon::ChipList::instance().present()->features)
            for (const auto& attribute : feature.attributes)
                if (attribute.isComputed)
                    paths.insert(feature.node.path.substr(std::string("/hwmon/").size()));
        return paths;
    }

private:
    std::optional<BoundSysfs> sysfs_;
};

TEST_P(HwmonConfigurationTest, HasTheValuesOfTheSensorsProgram)
{
    EXPECT_GT(compareWithSensors(), 10U);
    EXPECT_EQ(computed(), GetParam().computed);
}

const std::set<std::string> everything = [] {
    std::set<std::string> paths;
    for (const std::string chip : {"board-isa-0290", "lm75-i2c-1-48", "lm75-i2c-3-48"})
        for (const std::string feature : {"in0", "in1", "temp1", "temp2", "fan1"})
            paths.insert(chip + "/" + feature);
    return paths;
}();

const Shape shapes[] = {
    {"computesNothing", "chip \"board-*\"\n  label in0 \"Core\"\n  ignore temp2\n", {}},
    {"labelsEveryChip", "chip \"*-*\"\n  label in1 \"Rail\"\n", {}},
    {"labelsOneAddress", "chip \"board-isa-0290\"\n  label \"temp1\" \"Outlet\"\n", {}},
    {"labelsABusByItsAdapter",
        "bus \"i2c-0\" \"Adapter 3\"\nchip \"lm75-i2c-0-48\"\n  label temp1 \"Inlet\"\n", {}},
    {"computesOneFeature", "chip \"board-*\"\n  compute in0 @*2, @/2\n", {"board-isa-0290/in0"}},
    {"computesOnEveryChip", "chip \"*-*\"\n  compute fan1 @/2, @*2\n",
        {"board-isa-0290/fan1", "lm75-i2c-1-48/fan1", "lm75-i2c-3-48/fan1"}},
    {"computesOnAnAddress", "chip \"board-isa-0290\"\n  compute in1 (6.8/10+1)*@, @/(6.8/10+1)\n",
        {"board-isa-0290/in1"}},
    {"computesForAChipThatIsNotThere", "chip \"board-isa-0291\"\n  compute in1 @*2, @/2\n", {}},
    {"computesOnABusByItsAdapter",
        "bus \"i2c-0\" \"Adapter 3\"\nchip \"lm75-i2c-0-48\"\n  compute temp1 @-1, @+1\n",
        {"lm75-i2c-1-48/temp1", "lm75-i2c-3-48/temp1"}}, // adapters are not distinguished
    {"computesOnAnyBus", "chip \"lm75-i2c-*-48\"\n  compute temp1 @-1, @+1\n",
        {"lm75-i2c-1-48/temp1", "lm75-i2c-3-48/temp1"}},
    {"refersToAnotherFeature", "chip \"board-*\"\n  compute in0 in1_input+@, @\n",
        {"board-isa-0290/in0"}},
    {"refersToAFeatureThatIsComputed",
        "chip \"board-*\"\n  compute in1 @*3, @/3\n  compute in0 in1_input-@, @\n",
        {"board-isa-0290/in0", "board-isa-0290/in1"}},
    {"refersToNothing", "chip \"board-*\"\n  compute in0 nothing_input, @\n",
        {"board-isa-0290/in0"}},
    {"dividesByZero", "chip \"board-*\"\n  compute temp1 1/(@-@), @\n", {"board-isa-0290/temp1"}},
    {"takesTheLogarithmOfANegative", "chip \"board-*\"\n  compute temp1 `(0-@), @\n",
        {"board-isa-0290/temp1"}},
    {"computesOnALabel", "chip \"board-*\"\n  label in0 \"Core\"\n  compute Core @*2, @/2\n", {}},
    {"refersToALabel", "chip \"board-*\"\n  label in0 \"Core\"\n  compute in1 Core+@, @\n",
        {"board-isa-0290/in1"}},
    {"hasTwoSectionsForAChip",
        "chip \"board-*\"\n  compute in0 @*2, @/2\n  label in0 \"First\"\n"
        "chip \"*-isa-*\"\n  compute in0 @*5, @/5\n  compute in1 @*7, @/7\n  label in0 "
        "\"Second\"\n",
        {"board-isa-0290/in0", "board-isa-0290/in1"}},
    {"namesTwoChips", "chip \"none-*\" \"lm75-i2c-*-*\"\n  compute fan1 @*2, @/2\n",
        {"lm75-i2c-1-48/fan1", "lm75-i2c-3-48/fan1"}},
    {"quotesNames",
        "chip \"board-*\" \"none-*\"\n  compute \"in0\" @*2, @/2\n  label \"in0\" \"#1\"\n",
        {"board-isa-0290/in0"}},
    {"escapesInTheNameOfAFeature", "chip \"board-*\"\n  compute \"in\\060\" @*2, @/2\n",
        everything},
    {"escapesInTheNameOfAChip", "chip \"bo\\141rd-*\"\n  compute in0 @*2, @/2\n", everything},
    {"continuesLines",
        "chip \\\n  \"none-*\" \\\n\"board-*\"\n  compute \\\n in0 \\\n  @*2, \\\n  @/2\n",
        {"board-isa-0290/in0"}},
    {"commentsOut",
        "chip \"board-*\" # chip \"none-*\" \\\n"
        "# compute in0 @*2, @/2\n  label in1 \"# compute in1\" # \\\n  compute temp1 @*2, @/2\n",
        {"board-isa-0290/temp1"}},
    {"hasLinesOfWindows", "chip \"board-*\"\r\n  compute in0 @*2, @/2\r\n", {"board-isa-0290/in0"}},
    {"hasAnErrorInTheChip", "chip \"board-*\"\nchip \"wrong\"\n  compute in0 @*2, @/2\n",
        everything},
    {"hasAnErrorInALineThatContinues", "chip \"board-*\"\nnonsense \\\n  compute in0 @*2, @/2\n",
        everything},
    {"endsWithinALine", "chip \"board-*\"\n  compute in0 @*2, @/2", {"board-isa-0290/in0"}},
};

INSTANTIATE_TEST_SUITE_P(Shapes, HwmonConfigurationTest, testing::ValuesIn(shapes),
    [](const auto& shape) { return std::string(shape.param.name); });

} // namespace HwmonOracleTests
