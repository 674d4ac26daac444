// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The metrics of captured machines: of their sensors, and those of node_exporter, compared with the
// real one. The expected output is that of `sensorctl metrics` without the harvest's duration.

#include "tests/support/MountNamespace.h"
#include "tests/tools/NodeExporter.h"
#include "tests/tools/Scrape.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <optional>
#include <thread>

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

using Labeled = std::pair<std::string, std::map<std::string, std::string>>;

// Returns the values of the series of node_exporter's collector.
std::map<Labeled, double> hwmonSeriesIn(const std::string& text)
{
    std::map<Labeled, double> values;
    for (const Series& each : seriesIn(text))
        if (each.name.starts_with("node_hwmon_")) {
            EXPECT_TRUE(values.emplace(Labeled(each.name, each.labels), each.value).second)
                << each.name;
        }
    return values;
}

std::string textOf(const Labeled& series)
{
    std::string text = series.first;
    for (const auto& [name, value] : series.second)
        text.append(" ").append(name).append("=").append(value);
    return text;
}

// Returns the number with 16 digits, which is what prometheus-cpp writes of it.
double rounded(double number)
{
    std::array<char, 32> digits{};
    std::snprintf(digits.data(), digits.size(), "%.16g", number);
    return std::atof(digits.data());
}

void expectSame(const std::map<Labeled, double>& ours, const std::map<Labeled, double>& theirs)
{
    EXPECT_FALSE(theirs.empty());
    for (const auto& [series, value] : theirs) {
        const auto found = ours.find(series);
        if (found == ours.end())
            ADD_FAILURE() << "missing: " << textOf(series);
        else
            EXPECT_EQ(found->second, rounded(value)) << textOf(series);
    }
    for (const auto& [series, value] : ours)
        EXPECT_TRUE(theirs.contains(series)) << "too many: " << textOf(series);
}

std::string scrape(const ServerProcess& server, const std::string& fields = "")
{
    HttpClient client(server.port());
    client.send("GET /metrics HTTP/1.1\r\nHost: localhost\r\n" + fields + "\r\n");
    return client.receive().body;
}

// Returns the devices of the chips.
std::map<std::string, std::string> devicesIn(const std::string& text)
{
    std::map<std::string, std::string> devices;
    for (const Series& each : seriesIn(text))
        if (each.name == "sensor_profile_health")
            devices[each.labels.at("chip")] = each.labels.at("device");
    return devices;
}

std::string compatible()
{
    return run({"metrics", "--compatible", "node_exporter"}).out;
}

class HwmonMetricsTest : public MountNamespaceTest {
protected:
    // Binds the tree of a machine; an empty name gives an empty tree.
    void bind(const std::string& machine)
    {
        sysfs_.emplace(machine);
        configuration_.emplace("");
    }

    // Adds an attribute of a chip, whose folder is created if need be.
    void add(const std::string& path, const std::string& content)
    {
        std::filesystem::create_directories(sysfs_->path("hwmon/" + path).parent_path());
        sysfs_->write("hwmon/" + path, content + "\n");
    }

    std::optional<BoundSysfs> sysfs_;
    std::optional<BoundSensorsConfiguration> configuration_;
};

class HwmonMachineTest : public HwmonMetricsTest,
                         public testing::WithParamInterface<const char*> {};

TEST_P(HwmonMachineTest, MetricsAreTheGoldenOutput)
{
    bind(GetParam());
    const Ended ended = run({"metrics"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    const std::string golden = contentOf(std::string(SENSOR_PROFILE_SOURCE_DIR) +
                                         "/tests/data/tools/" + GetParam() + "-metrics.txt");
    EXPECT_EQ(comparable(ended.out), golden);
    EXPECT_THAT(comparable(scrape(ServerProcess({}))), StartsWith(golden));
}

INSTANTIATE_TEST_SUITE_P(Machines, HwmonMachineTest, testing::Values("arm", "hotplug", "laptop"),
    [](const auto& machine) { return std::string(machine.param); });

class NodeExporterTest : public HwmonMetricsTest,
                         public testing::WithParamInterface<const char*> {};

TEST_P(NodeExporterTest, HasTheSameSeries)
{
    bind(GetParam());
    expectSame(hwmonSeriesIn(compatible()), hwmonSeriesIn(NodeExporter().metrics()));
}

INSTANTIATE_TEST_SUITE_P(Machines, NodeExporterTest,
    testing::Values("desktop", "server", "hotplug", "twosocket", "laptop", "arm"),
    [](const auto& machine) { return std::string(machine.param); });

TEST_F(HwmonMetricsTest, NodeExporterHasTheSameSeriesOfEveryAttribute)
{
    bind("");
    sysfs_->addChip("hwmon0", "Odd Name-2.x", "platform", "Odd-Device.1-");
    int value = 1000;
    for (const std::string sensor : {"temp1", "temp12", "in0", "cpu0", "curr1", "power1", "energy1",
             "humidity1", "fan1", "pwm1", "intrusion0", "freq1", "voltage1", "vid"})
        for (const std::string element : {"input", "min", "max", "crit", "lcrit", "emergency",
                 "label", "alarm", "max_alarm", "beep", "fault", "enable", "type", "offset",
                 "lowest", "highest", "average", "rated_max", "div", "target", "pulses",
                 "average_interval", "average_interval_max", "average_interval_min", "average_max",
                 "input_highest", "accuracy", "cap", "cap_hyst", "max_hyst", "mode", "freq",
                 "auto_channels_temp", "auto_point1_pwm", "auto_point1_temp", "unheard_of"})
            if (sensor != "pwm1" || element != "input") // pwm1 is an attribute itself
                add("hwmon0/" + sensor + "_" + element, std::to_string(++value));
    for (const std::string attribute : {"pwm1", "vrm", "update_interval", "beep_enable", "alarms",
             "uevent", "in_reset", "temp1_odd-name", "temp1_A", "temp1_x.y", "temp1_é", "temp1-b",
             "TEMP1_input", "temp1_ALARM", "fan1_Input", "fan1_MIN", "power1_Accuracy",
             "temp3_Label", "temp5_input_"})
        add("hwmon0/" + attribute, "1");
    const std::string text = compatible();
    expectSame(hwmonSeriesIn(text), hwmonSeriesIn(NodeExporter().metrics()));

    const TemporaryFolder folder;
    const Ended promtool = run(
        {"-c", "promtool check metrics <" + folder.write("text", text)}, {.program = "/bin/sh"});
    EXPECT_EQ(promtool.out + promtool.err, "");
    const ServerProcess server({"--compatible", "node_exporter"});
    scrape(server); // the first response that is counted
    const Ended parser =
        run({"-c", openMetricsParser, folder.write("open", scrape(server, acceptOfPrometheus))},
            {.program = "/usr/bin/python3"});
    EXPECT_EQ(parser.err, "");
    EXPECT_EQ(parser.out, std::to_string(seriesIn(scrape(server)).size()) + "\n");
}

TEST_F(HwmonMetricsTest, NodeExporterHasTheSameSeriesOfOddChips)
{
    bind("");
    add("hwmon1/name", "values");
    for (const auto& [attribute, content] :
        std::map<std::string, std::string>{{"temp1_input", "-5000"}, {"temp2_input", "12.5"},
            {"temp3_input", "none"}, {"temp4_input", ""}, {"temp5_input", " 42000 "},
            {"temp6_input", "42000\nmore"}, {"temp7_max", "5000"},
            {"temp1_label", "  a \"b\" \\ c  "}, {"temp2_label", ""}, {"temp3_label", "alone"},
            {"temp4_label", "caf\xE9"}, {"temp5_label", "two\nlines"}, {"fan1_label", "ä€𝄞"}})
        add("hwmon1/" + attribute, content);
    add("hwmon2/temp1_input", "2000");                     // neither name nor device
    for (const std::string chip : {"hwmon3", "hwmon10"}) { // two of one name
        add(chip + "/name", "twice");
        add(chip + "/temp1_input", chip.substr(5));
        add(chip + "/temp" + chip.substr(5) + "_input", "1");
    }
    add("hwmon4/name", "--");
    add("hwmon4/temp1_input", "4000");
    sysfs_->addChip("hwmon5", "both", "pci", "0000:01:00.0");
    add("hwmon5/temp1_input", "5000");
    add("hwmon5/device/temp1_input", "5500");
    add("hwmon5/device/temp2_input", "5600");
    std::filesystem::create_directories(sysfs_->path("hwmon/hwmon5/device/power"));
    sysfs_->addChip("hwmon6", "dangling", "pci", "0000:02:00.0");
    add("hwmon6/temp1_input", "6000");
    std::filesystem::remove_all(sysfs_->path("devices/0000:02:00.0"));
    expectSame(hwmonSeriesIn(compatible()), hwmonSeriesIn(NodeExporter().metrics()));
}

// The exporter publishes each of two equal series once, and logs an error at every scrape.
TEST_F(HwmonMetricsTest, TextfileStandsBesideEitherCollectorOfHwmon)
{
    bind("laptop");
    const TemporaryFolder folder;
    const auto write = [&](std::vector<std::string> options) {
        options.insert(
            options.begin(), {"metrics", "--textfile", (folder.path() / "sensors.prom").string()});
        EXPECT_EQ(run(options).code, 0);
    };
    const std::vector<std::string> textfile = {
        "--collector.textfile", "--collector.textfile.directory=" + folder.path().string()};
    const auto errorsOf = [&](std::vector<std::string> collectors, std::size_t series) {
        collectors.insert(collectors.end(), textfile.begin(), textfile.end());
        const NodeExporter exporter(collectors);
        const std::string text = exporter.metrics();
        EXPECT_EQ(hwmonSeriesIn(text).size(), series);
        EXPECT_THAT(text, HasSubstr("\nnode_textfile_scrape_error 0\n"));
        EXPECT_THAT(text, HasSubstr("\nsensor_profile_health{"));
        return countOf(exporter.log(), "level=error");
    };
    const std::size_t count = hwmonSeriesIn(compatible()).size();
    write({});
    EXPECT_EQ(errorsOf({"--collector.hwmon"}, count), 0U);
    write({"--compatible", "node_exporter"});
    EXPECT_EQ(errorsOf({"--no-collector.hwmon"}, count), 0U);
    EXPECT_GT(errorsOf({"--collector.hwmon"}, count), 0U);
}

TEST_F(HwmonMetricsTest, ServerHasThoseOfNodeExporterOnRequest)
{
    bind("laptop");
    EXPECT_EQ(hwmonSeriesIn(scrape(ServerProcess({"--compatible", "node_exporter"}))),
        hwmonSeriesIn(compatible()));
    EXPECT_TRUE(hwmonSeriesIn(scrape(ServerProcess({}))).empty());
    EXPECT_EQ(run({"metrics", "--compatible", "another"}).code, 2);
}

TEST_F(HwmonMetricsTest, DeviceBehindAChipIsALabel)
{
    bind("");
    sysfs_->addChip("hwmon0", "nvme", "pci", "0000:01:00.0");
    add("hwmon0/temp1_input", "41000");
    add("hwmon0/device/model", "SOLIDIGM \"X\"");
    EXPECT_THAT(run({"metrics"}).out,
        HasSubstr("sensor_profile_reading_celsius{device_id=\"temp1:/hwmon/nvme-pci-0100/temp1\","
                  "chip=\"nvme-pci-0100\",device=\"SOLIDIGM \\\"X\\\"\",label=\"temp1\"} 41\n"));
}

TEST_F(HwmonMetricsTest, DevicesAreThoseOfThePresentChips)
{
    using Devices = std::map<std::string, std::string>;
    bind("");
    const auto addDisk = [this](const std::string& model) {
        sysfs_->addChip("hwmon0", "nvme", "pci", "0000:01:00.0");
        add("hwmon0/temp1_input", "41000");
        add("hwmon0/device/model", model);
    };
    addDisk("first");
    sysfs_->addChip("hwmon1", "nic", "pci", "0000:02:00.0");
    add("hwmon1/temp1_input", "42000");
    const ServerProcess server({});
    EXPECT_EQ(
        devicesIn(scrape(server)), (Devices{{"nvme-pci-0100", "first"}, {"nic-pci-0200", ""}}));
    sysfs_->addInterface("0000:02:00.0", "eth0");
    EXPECT_EQ(devicesIn(scrape(server)).at("nic-pci-0200"), "eth0");
    sysfs_->remove("net/eth0");
    sysfs_->addInterface("0000:02:00.0", "enp2s0");
    EXPECT_EQ(devicesIn(scrape(server)).at("nic-pci-0200"), "enp2s0");
    sysfs_->addInterface("0000:02:00.0", "enp2s0f1");
    EXPECT_EQ(devicesIn(scrape(server)).at("nic-pci-0200"), "enp2s0"); // the first by name

    sysfs_->rename("hwmon/hwmon0", "gone"); // its inode stays in use
    std::filesystem::remove_all(sysfs_->path("devices/0000:01:00.0"));
    addDisk("second");
    EXPECT_EQ(devicesIn(scrape(server)).at("nvme-pci-0100"), "second");
}

TEST_F(HwmonMetricsTest, SourceIsUpUnlessItsChipsCannotBeListed)
{
    const std::string up = "\nsensor_profile_source_up{source=\"hwmon\"} ";
    const TemporaryFolder folder;
    const std::string model = "model:" + folder.write("model.json", R"({"nodes": [
        {"type": "temperature", "path": "/m/a", "description": "A", "status": 1, "reading": 40}]})");
    const std::string reading = "\nsensor_profile_reading_celsius{device_id=\"A:/m/a\"";
    const std::string modelIsUp = "\nsensor_profile_source_up{source=\"" + model + "\"} 1\n";
    bind("");
    add("hwmon0/name", "first");
    add("hwmon0/temp1_input", "41000");
    add("hwmon0/fan1_input", "900");
    const ServerProcess server({}, {{"VORN_INSTRUMENTATION", "hwmon," + model}});
    std::string text = scrape(server);
    EXPECT_THAT(text, AllOf(HasSubstr(up + "1\n"), HasSubstr(modelIsUp), HasSubstr(reading)));
    EXPECT_EQ(countOf(text, "\nsensor_profile_health{"), 3U);

    sysfs_->rename("hwmon", "gone");
    std::filesystem::create_symlink("hwmon", sysfs_->path("hwmon"));
    text = scrape(server);
    EXPECT_THAT(text, AllOf(HasSubstr(up + "0\n"), HasSubstr(modelIsUp), HasSubstr(reading)));
    EXPECT_EQ(countOf(text, "\nsensor_profile_health{"), 1U);
    sysfs_->remove("hwmon");
    sysfs_->rename("gone", "hwmon");

    // The driver removes an attribute, which the library sees within two seconds.
    sysfs_->remove("hwmon/hwmon0/fan1_input");
    std::this_thread::sleep_for(std::chrono::milliseconds(2100));
    text = scrape(server);
    EXPECT_THAT(text, HasSubstr(up + "1\n"));
    EXPECT_EQ(countOf(text, "\nsensor_profile_health{"), 2U);
}

} // namespace
