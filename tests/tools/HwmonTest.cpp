// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the tool prints of captured machines against what `sensors -j` reads from them.

#include "tests/support/MountNamespace.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <cmath>
#include <map>

namespace {

using nlohmann::json;
using namespace Testing;

// One channel as `sensors -j` shows it: subfeatures by the part of their name after "temp1_".
struct Channel {
    std::string kind; // "temp", "in" or "fan"; else not a sensor of ours
    std::map<std::string, double> values;

    bool isSet(const std::string& subfeature) const
    {
        const auto found = values.find(subfeature);
        return found != values.end() && found->second != 0;
    }
};

Channel channelOf(const json& subfeatures)
{
    Channel channel;
    for (const auto& [name, value] : subfeatures.items()) {
        channel.kind = name.substr(0, name.find_first_of("0123456789"));
        channel.values[name.substr(name.find('_') + 1)] = value.get<double>();
    }
    return channel;
}

// The readable channels by chip and label.
std::map<std::string, Channel> channels()
{
    const Ended ended = run({"-j"}, {.program = "/usr/bin/sensors"});
    EXPECT_EQ(ended.code, 0) << ended.err;
    std::map<std::string, Channel> found;
    const json document = json::parse(ended.out);
    for (const auto& [chip, features] : document.items())
        for (const auto& [label, subfeatures] : features.items()) {
            if (label == "Adapter")
                continue;
            const Channel channel = channelOf(subfeatures);
            if (channel.kind == "temp" || channel.kind == "in" || channel.kind == "fan")
                found[chip + "/" + label] = channel;
        }
    return found;
}

// The same key for an instance, whose DeviceID is "<label>:/hwmon/<chip>/<feature>".
std::string keyOf(const json& properties)
{
    const std::string label = properties.at("ElementName");
    const std::string id = properties.at("DeviceID");
    const std::string path = id.substr(label.size() + 1);
    const std::size_t chip = std::string("/hwmon/").size();
    return path.substr(chip, path.rfind('/') - chip) + "/" + label;
}

std::map<std::string, json> listedSensors()
{
    const Ended ended = run({"list", "--json"});
    EXPECT_EQ(ended.code, 0) << ended.err;
    std::map<std::string, json> found;
    const json document = json::parse(ended.out);
    for (const json& instance : document.at("instances"))
        found[keyOf(instance.at("properties"))] = instance.at("properties");
    return found;
}

// Readings are cut to whole units of 10^UnitModifier, `sensors` rounds to three decimals.
void expectSame(
    const json& properties, const char* property, const Channel& channel, const char* subfeature)
{
    const double unit = std::pow(10.0, properties.at("UnitModifier").get<int>());
    const auto theirs = channel.values.find(subfeature);
    const double expected = theirs == channel.values.end() ? 0 : theirs->second;
    const double published = properties.value(property, 0) * unit;
    EXPECT_LT(std::abs(published - expected), unit * 1.01)
        << properties.at("DeviceID") << ' ' << property;
}

void expectSame(const json& properties, const Channel& channel)
{
    const bool isRead = channel.values.contains("input") && !channel.isSet("fault");
    EXPECT_EQ(properties.at("OperationalStatus") == json({13}), !isRead)
        << properties.at("DeviceID");
    if (isRead)
        expectSame(properties, "CurrentReading", channel, "input");
    expectSame(properties, "LowerThresholdNonCritical", channel, "min");
    expectSame(properties, "UpperThresholdNonCritical", channel, "max");
    expectSame(properties, "LowerThresholdCritical", channel, "lcrit");
    expectSame(properties, "UpperThresholdCritical", channel, "crit");
    expectSame(properties, "UpperThresholdFatal", channel, "emergency");
}

class HwmonTest : public MountNamespaceTest, public testing::WithParamInterface<const char*> {};

TEST_P(HwmonTest, ListShowsWhatTheSensorsProgramReads)
{
    const BoundSysfs sysfs(GetParam());
    const auto theirs = channels();
    const auto ours = listedSensors();
    ASSERT_FALSE(theirs.empty());
    for (const auto& [key, channel] : theirs) {
        ASSERT_TRUE(ours.contains(key)) << key;
        expectSame(ours.at(key), channel);
    }
    for (const auto& [key, properties] : ours) {
        if (theirs.contains(key))
            continue;
        // `sensors` leaves out what it cannot read at all.
        EXPECT_EQ(properties.at("OperationalStatus"), json({13})) << key;
    }
}

TEST_P(HwmonTest, RecordReplaysToTheSameOutput)
{
    const TemporaryFolder folder;
    const std::string file = (folder.path() / "record.json").string();
    const BoundSysfs sysfs(GetParam());
    ASSERT_EQ(run({"record", "-o", file}).code, 0);
    EXPECT_EQ(run({"list", "--json", "--model", file}).out, run({"list", "--json"}).out);
    EXPECT_EQ(run({"list", "--model", file}).out, run({"list"}).out);
}

INSTANTIATE_TEST_SUITE_P(Machines, HwmonTest, testing::Values("desktop", "server"),
    [](const auto& machine) { return machine.param; });

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
    EXPECT_TRUE(sensors.contains("nct6798-isa-0290/Front fan"));
    EXPECT_FALSE(sensors.contains("nct6798-isa-0290/fan2"));
}

} // namespace
