// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the tool publishes of captured machines, compared with the output of `sensors -j`.

#include "tests/support/MountNamespace.h"
#include "tests/support/SensorsProgram.h"
#include "tests/tools/Tmux.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <cstdlib>
#include <map>
#include <tuple>

namespace {

using nlohmann::json;
using testing::HasSubstr;
using namespace Testing;

std::map<std::string, json> listedSensors()
{
    const Ended ended = run({"list", "--cim"});
    EXPECT_EQ(ended.code, 0) << ended.err;
    std::map<std::string, json> found;
    const json document = json::parse(ended.out);
    for (const json& instance : document.at("instances"))
        found[instance.at("properties").at("DeviceID")] = instance.at("properties");
    return found;
}

struct Value {
    const char* subfeature;
    const char* property;
};

constexpr Value values[] = {{"input", "CurrentReading"}, {"min", "LowerThresholdNonCritical"},
    {"max", "UpperThresholdNonCritical"}, {"lcrit", "LowerThresholdCritical"},
    {"crit", "UpperThresholdCritical"}, {"emergency", "UpperThresholdFatal"}};

// The properties of instances are truncated to whole units of 10^UnitModifier. Where a `compute`
// line applies, the number printed was rounded to thousandths, and the truncation may give one unit
// less. A value that is not there counts as 0.
void expectSame(const json& properties, const SensorsChannel& channel, bool mayBeComputed)
{
    const int scale = properties.at("UnitModifier") == 0 ? 1 : 1000;
    for (const Value& value : values) {
        const auto theirs = channel.values.find(value.subfeature);
        const double expected = theirs == channel.values.end() ? 0 : theirs->second;
        const long thousandths = std::lround(expected * 1000);
        EXPECT_NEAR(properties.value(value.property, 0),
            static_cast<double>(thousandths * scale / 1000), mayBeComputed ? 1 : 0)
            << value.property;
    }
    EXPECT_FALSE(properties.contains("LowerThresholdFatal"));
    EXPECT_EQ(properties.at("OperationalStatus") == json({13}), !channel.values.contains("input"));
}

// A machine and the administrator's configuration of libsensors.
class HwmonTest : public MountNamespaceTest,
                  public testing::WithParamInterface<std::tuple<const char*, bool>> {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (IsSkipped() || HasFailure())
            return;
        const auto& [machine, isConfigured] = GetParam();
        sysfs_.emplace(machine);
        configuration_.emplace(isConfigured ? sensorsConfiguration : "");
    }

private:
    std::optional<BoundSysfs> sysfs_;
    std::optional<BoundSensorsConfiguration> configuration_;
};

TEST_P(HwmonTest, ShowsWhatTheSensorsProgramReads)
{
    const auto theirs = sensorsChannels();
    const auto instances = listedSensors();
    EXPECT_GT(theirs.size(), 2U);
    EXPECT_EQ(instances.size(), theirs.size());
    for (const auto& [path, channel] : theirs) {
        const std::string id = channel.label + ":" + path;
        SCOPED_TRACE(id);
        ASSERT_TRUE(instances.contains(id));
        expectSame(instances.at(id), channel, std::get<1>(GetParam()));
    }
}

TEST_P(HwmonTest, RecordReplaysToTheSameOutput)
{
    const TemporaryFolder folder;
    const std::string file = (folder.path() / "record.json").string();
    ASSERT_EQ(run({"record", "-o", file}).code, 0);
    EXPECT_EQ(run({"list", "--cim", "--model", file}).out, run({"list", "--cim"}).out);
    EXPECT_EQ(run({"list", "--flat", "--model", file}).out, run({"list", "--flat"}).out);
}

INSTANTIATE_TEST_SUITE_P(Machines, HwmonTest,
    testing::Combine(testing::Values("desktop", "server", "hotplug", "twosocket", "laptop", "arm"),
        testing::Bool()),
    [](const auto& machine) {
        return std::get<0>(machine.param) +
               std::string(std::get<1>(machine.param) ? "Configured" : "");
    });

// The chips of a machine as `list --json` names them.
std::map<std::string, std::string> devices()
{
    std::map<std::string, std::string> found;
    for (const json& sensor : json::parse(run({"list", "--json"}).out))
        found[sensor.at("chip")] = sensor.at("device").is_null() ? "" : sensor.at("device");
    return found;
}

class ChipDevicesTest : public MountNamespaceTest {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (!IsSkipped() && !HasFailure())
            sysfs_.emplace("");
    }

    // Adds a chip with a temperature, whose device is at the path below the tree.
    void add(const std::string& folder, const std::string& name, const std::string& bus,
        const std::string& device)
    {
        sysfs_->addChip(folder, name, bus, device);
        sysfs_->write("hwmon/" + folder + "/temp1_input", "41000\n");
    }

    std::optional<BoundSysfs> sysfs_;
};

TEST_F(ChipDevicesTest, AreNamedWhereTheKernelKnowsThem)
{
    add("hwmon0", "drivetemp", "scsi", "7:0:0:0");
    sysfs_->write("hwmon/hwmon0/device/model", "WDC WD80EFAX    \n");
    add("hwmon1", "mlx5", "pci", "0000:3b:00.1");
    sysfs_->addInterface("0000:3b:00.1", "eth4");
    sysfs_->addInterface("virtual", "veth0");
    sysfs_->write("net/bonding_masters", "\n");
    add("hwmon2", "jc42", "i2c", "0-0018");
    add("hwmon3", "nvme", "pci", "10000:01:00.0");
    sysfs_->write("hwmon/hwmon3/device/model", "SOLIDIGM\n");
    EXPECT_EQ(devices(),
        (std::map<std::string, std::string>{{"drivetemp-scsi-7-0", "WDC WD80EFAX"},
            {"mlx5-pci-3b01", "eth4"}, {"jc42-i2c-0-18", ""}, {"nvme-pci-0100", "SOLIDIGM"}}));
    EXPECT_THAT(run({"list"}).out, testing::HasSubstr("\ndrivetemp-scsi-7-0   (WDC WD80EFAX)\n"));
    EXPECT_THAT(
        run({"get", "drivetemp*"}).out, testing::HasSubstr("\n  Device         WDC WD80EFAX\n"));
}

TEST_F(ChipDevicesTest, SlotsBatteriesAndWirelessInterfacesAreNamed)
{
    const TemporaryFolder buses;
    std::filesystem::create_directories(buses.path() / "pci/slots/4");
    std::filesystem::create_directories(buses.path() / "pci/slots/7-1");
    buses.write("pci/slots/4/address", "0000:3b:00\n");
    buses.write("pci/slots/7-1/address", "0000:5e:00\n");
    const BindMount mount(buses.path(), "/sys/bus");
    add("hwmon0", "amdgpu", "pci", "0000:5e:00.0");
    add("hwmon1", "radeon", "pci", "0000:61:00.0");
    add("hwmon2", "BAT0", "acpi", "PNP0C0A:00");
    sysfs_->write("hwmon/hwmon2/device/model_name", "DELL 7FHHV\n");
    // The device of the chip is that of the radio, below the addressed one.
    add("hwmon3", "mt7921_phy0", "pci", "0000:02:00.0");
    const auto card = sysfs_->path("devices/0000:02:00.0");
    std::filesystem::create_directories(card / "ieee80211/phy0");
    sysfs_->addInterface("0000:02:00.0", "wlan0");
    std::filesystem::create_symlink(
        "../../../../class/ieee80211", card / "ieee80211/phy0/subsystem");
    std::filesystem::create_symlink("../..", card / "ieee80211/phy0/device");
    sysfs_->remove("hwmon/hwmon3/device");
    std::filesystem::create_symlink(
        "../../devices/0000:02:00.0/ieee80211/phy0", sysfs_->path("hwmon/hwmon3/device"));
    EXPECT_EQ(devices(), (std::map<std::string, std::string>{{"amdgpu-pci-5e00", "PCI slot 7-1"},
                             {"radeon-pci-6100", ""}, {"BAT0-acpi-0", "DELL 7FHHV"},
                             {"mt7921_phy0-pci-0200", "wlan0"}}));
}

TEST_F(ChipDevicesTest, ChannelsOfOtherKindsAreCounted)
{
    add("hwmon0", "testchip", "platform", "testchip.656");
    for (const char* const attribute : {"curr1_input", "power1_average", "power1_input",
             "power2_average", "energy1_input", "humidity1_input", "power1_cap", "intrusion0_beep"})
        sysfs_->write(std::string("hwmon/hwmon0/") + attribute, "0\n");
    EXPECT_EQ(linesOf(run({"list"}).out).back(),
        "1 sensor: 1 normal.  5 channels of other kinds are not shown (current, energy, humidity, "
        "power).");
    EXPECT_EQ(linesOf(run({"list", "temp1"}).out).back(), "1 sensor: 1 normal.");
}

class HwmonAbsentTest : public MountNamespaceTest {};

TEST_F(HwmonAbsentTest, MachineWithoutChipsIsSaid)
{
    const BoundSysfs sysfs("");
    const Ended ended = run({"list"});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.err, testing::StartsWith("sensorctl: this machine has no sensors"));
}

TEST_F(HwmonAbsentTest, SensorsConfigurationIsHonoured)
{
    const BoundSysfs sysfs("desktop");
    const BoundSensorsConfiguration configuration(
        "chip \"nct6798-*\"\n  label fan1 \"Front fan\"\n  ignore fan2\n");
    const auto sensors = listedSensors();
    EXPECT_TRUE(sensors.contains("Front fan:/hwmon/nct6798-isa-0290/fan1"));
    EXPECT_FALSE(sensors.contains("fan2:/hwmon/nct6798-isa-0290/fan2"));
}

// Returns what a command writes to standard error.
std::string standardErrorOf(const std::string& command)
{
    const TemporaryFolder folder;
    const std::string file = (folder.path() / "err").string();
    EXPECT_EQ(std::system((command + " >/dev/null 2>'" + file + "'").c_str()) & 0xFF, 0);
    return contentOf(file);
}

class ConfigurationMistakesTest : public MountNamespaceTest {};

TEST_F(ConfigurationMistakesTest, ArePrintedOnceInTheWordsOfSensors)
{
    const BoundSysfs sysfs("desktop");
    const BoundSensorsConfiguration configuration("chip \"*-*\"\n"
                                                  "  lable temp1 \"First\"\n"
                                                  "  compute in0 @*(\n"
                                                  "bus \"i2c-99\" \"gone\n");
    const std::string expected = standardErrorOf("/usr/bin/sensors");
    EXPECT_NE(expected.find("Error: File /etc/sensors3.conf, line 2: "), std::string::npos)
        << expected;
    for (const std::vector<std::string>& words : {std::vector<std::string>{"list"}, {"get", "fan2"},
             {"walk"}, {"check", "fan2"}, {"metrics"}, {"record"}}) {
        // The parser of libsensors does not free the words of a line with an error.
        const Ended ended =
            run(words, {.environment = {{"RYNLOG_LOG", ""}, {"ASAN_OPTIONS", "detect_leaks=0"}}});
        EXPECT_EQ(ended.code, 0) << words.front();
        EXPECT_EQ(ended.err, expected) << words.front();
    }
}

TEST_F(ConfigurationMistakesTest, ArePrintedByWatchAtOnce)
{
    const BoundSysfs sysfs("desktop");
    const BoundSensorsConfiguration configuration("chip \"*-*\"\n"
                                                  "  lable temp1 \"First\"\n"
                                                  "  compute in0 @*(\n");
    const std::string expected = standardErrorOf("/usr/bin/sensors");
    const TemporaryFolder folder;
    const std::string err = (folder.path() / "err").string();
    const std::string watch =
        "env -u RYNLOG_LOG ASAN_OPTIONS=detect_leaks=0 " + sensorctl + " watch --interval 0.1";
    run({"-c", watch + " 2>" + err + " & while [ ! -s " + err +
                   " ]; do sleep 0.1; done; sleep 0.5; kill $!"},
        {.program = "/bin/sh"});
    EXPECT_EQ(contentOf(err), expected);
    const Tmux terminal(watch, 120, 24);
    EXPECT_THAT(
        terminal.waitFor("line 4: "), HasSubstr("Error: File /etc/sensors3.conf, line 2: "));
}

} // namespace
