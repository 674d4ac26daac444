// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What we read from captured machines against what `sensors -j` reads from them.

#include "tests/platform/instrumentation/HwmonMachine.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <array>
#include <cstdio>

namespace HwmonOracleTests {

using Json = nlohmann::json;
using Testing::BoundSysfs;
using Testing::HwmonTest;
using Testing::SeenNode;

// What `sensors -j` prints; readings that fail go to its standard error.
Json askSensors()
{
    FILE* pipe = popen("sensors -j 2>/dev/null", "r");
    if (pipe == nullptr)
        throw std::runtime_error("cannot run sensors");
    std::string text;
    std::array<char, 4096> block{};
    for (std::size_t count = 0; (count = fread(block.data(), 1, block.size(), pipe)) > 0;)
        text.append(block.data(), count);
    if (pclose(pipe) != 0)
        throw std::runtime_error("sensors failed; is the package lm-sensors installed?");
    return Json::parse(text);
}

// One feature as sensors shows it: subfeatures by the part of their name after "temp1_".
struct Feature {
    std::string name; // empty when no value of it can be read
    std::map<std::string, double> values;

    std::optional<double> value(const std::string& subfeature) const
    {
        const auto found = values.find(subfeature);
        return found == values.end() ? std::nullopt : std::optional(found->second);
    }
    bool isSet(const std::string& subfeature) const { return value(subfeature).value_or(0) != 0; }
};

Feature featureOf(const Json& subfeatures)
{
    Feature feature;
    for (const auto& [key, value] : subfeatures.items()) {
        const std::size_t underscore = key.find('_');
        feature.name = key.substr(0, underscore);
        feature.values[key.substr(underscore + 1)] = value.get<double>();
    }
    return feature;
}

bool isOurs(const Feature& feature)
{
    const std::string kind = feature.name.substr(0, feature.name.find_first_of("0123456789"));
    return kind == "temp" || kind == "in" || kind == "fan";
}

// The node that has this description on this chip.
const SeenNode* findNode(
    const std::vector<SeenNode>& nodes, const std::string& chip, const std::string& label)
{
    for (const SeenNode& node : nodes)
        if (node.path.starts_with("/hwmon/" + chip + "/") && node.description == label)
            return &node;
    return nullptr;
}

void expectNear(std::optional<double> ours, std::optional<double> theirs, const std::string& what)
{
    constexpr double printedDigits = 0.0005;
    ASSERT_EQ(ours.has_value(), theirs.has_value()) << what;
    EXPECT_NEAR(ours.value_or(0.0), theirs.value_or(0.0), printedDigits) << what;
}

using Pair = std::pair<std::optional<double>, std::optional<double>>;

// Both ends, or neither when nobody set them.
Pair limits(const Feature& feature, const std::string& lower, const std::string& upper)
{
    const Pair pair{feature.value(lower), feature.value(upper)};
    const bool isSet = pair.first.value_or(0) != 0 || pair.second.value_or(0) != 0;
    return isSet ? pair : Pair{};
}

void expectSame(const SeenNode& node, const Feature& feature)
{
    const auto [min, max] = limits(feature, "min", "max");
    const auto [lcrit, crit] = limits(feature, "lcrit", "crit");
    const auto reading = feature.isSet("fault") ? std::nullopt : feature.value("input");
    expectNear(node.values.reading, reading, node.path);
    expectNear(node.values.lowerNonCritical, min, node.path + " min");
    expectNear(node.values.upperNonCritical, max, node.path + " max");
    expectNear(node.values.lowerCritical, lcrit, node.path + " lcrit");
    expectNear(node.values.upperCritical, crit, node.path + " crit");
    expectNear(node.values.upperFatal, feature.value("emergency"), node.path + " emergency");
    EXPECT_FALSE(node.values.lowerFatal) << node.path;
    EXPECT_EQ(node.values.status == 13, !reading.has_value()) << node.path;
}

class OracleTest : public HwmonTest, public testing::WithParamInterface<const char*> {};

// Compares every feature that sensors shows, and makes sure that we show no other.
void expectSameMachine()
{
    const auto nodes = Testing::walk();
    std::size_t compared = 0;
    const Json theirs = askSensors();
    for (const auto& [chip, features] : theirs.items())
        for (const auto& [label, subfeatures] : features.items()) {
            if (label == "Adapter" || !isOurs(featureOf(subfeatures)))
                continue;
            const SeenNode* node = findNode(nodes, chip, label);
            ASSERT_NE(node, nullptr) << chip << ' ' << label;
            EXPECT_EQ(node->path, "/hwmon/" + chip + "/" + featureOf(subfeatures).name);
            expectSame(*node, featureOf(subfeatures));
            ++compared;
        }
    EXPECT_GT(compared, 2U);
    EXPECT_EQ(nodes.size(), compared);
}

TEST_P(OracleTest, AgreesOnEveryReadingLimitAndLabel)
{
    const BoundSysfs sysfs(GetParam());
    expectSameMachine();
}

TEST_P(OracleTest, AgreesUnderAConfigurationOfTheAdministrator)
{
    configuration().write("chip \"*-*\"\n"
                          "  label temp1 \"First\"\n"
                          "  label fan1 \"Front fan\"\n"
                          "  compute temp1 @*2-1.5, (@+1.5)/2\n"
                          "  compute in0 @*(1+10/3.3), @/(1+10/3.3)\n"
                          "  ignore temp2\n"
                          "  ignore fan2\n");
    const BoundSysfs sysfs(GetParam());
    expectSameMachine();
}

INSTANTIATE_TEST_SUITE_P(Trees, OracleTest, testing::Values("desktop", "server", "hotplug"),
    [](const auto& tree) { return std::string(tree.param); });

} // namespace HwmonOracleTests
