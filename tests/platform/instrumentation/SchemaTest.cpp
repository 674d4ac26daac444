// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The JSON schema and the demonstration model, compared with the reader.

#include "platform/instrumentation/SourceList.h"
#include "platform/instrumentation/hwmon/Status.h"
#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <fstream>
#include <map>
#include <set>

namespace SchemaTests {

using Testing::SeenNode;
using testing::UnorderedElementsAreArray;
namespace Member = Vorn::MachineFileMember;

const std::string folder = SENSOR_PROFILE_SOURCE_DIR "/schema/";

nlohmann::json schema()
{
    std::ifstream file(folder + "sensor-profile-model.schema.json");
    return nlohmann::json::parse(file);
}

std::vector<SeenNode> demoMachine()
{
    const Testing::EnvironmentVariable environment(
        "VORN_INSTRUMENTATION", Vorn::formatSourceEntry("model", folder + "demo-model.json"));
    return Testing::walk();
}

TEST(SchemaTest, HasTheMembersThatTheReaderHas)
{
    const auto document = schema();
    const auto& node = document.at("$defs").at("node");
    std::vector<std::string> names;
    for (const auto& [name, member] : node.at("properties").items())
        names.push_back(name);
    std::vector<std::string_view> readNames;
    Vorn::MachineFileNode machineFileNode;
    Member::forEach(machineFileNode,
        [&](std::string_view name, const auto& /*field*/) { readNames.push_back(name); });
    EXPECT_THAT(names, UnorderedElementsAreArray(readNames));
    EXPECT_EQ(node.at("required"), (nlohmann::json{"type", "path", "description"}));
    EXPECT_EQ(node.at("additionalProperties"), false);
    EXPECT_EQ(document.at("required"), nlohmann::json{Member::nodes});
    EXPECT_EQ(document.at("additionalProperties"), false);
}

TEST(SchemaTest, HasTheTypesThatTheReaderHas)
{
    std::vector<std::string_view> names;
    for (const Member::TypeName& type : Member::typeNames)
        names.push_back(type.name);
    const auto types = schema().at("/$defs/node/properties/type/enum"_json_pointer);
    EXPECT_EQ(types, nlohmann::json(names));
}

TEST(SchemaTest, NumbersAreTheNumbersOfTheReader)
{
    const auto members = schema().at("/$defs/node/properties"_json_pointer);
    Vorn::MachineFileNode node;
    Member::forEach(node, [&]<typename Field>(std::string_view name, const Field& /*field*/) {
        if constexpr (std::is_same_v<Field, std::optional<double>>) {
            EXPECT_EQ(members.at(std::string(name)).at("type"), "number");
        }
    });
    EXPECT_EQ(schema().at("/$defs/code/maximum"_json_pointer), 4294967295U);
    EXPECT_EQ(schema().at("/properties/period/exclusiveMinimum"_json_pointer), 0);
}

// The status of each sensor agrees with its reading and limits.
TEST(DemoModelTest, IsConsistent)
{
    for (const SeenNode& node : demoMachine()) {
        const Vorn::NodeReading& values = node.values;
        const Vorn::Hwmon::ChannelState channel{.isEnabled = values.status != 16,
            .reading = values.reading,
            .limits = {.min = values.lowerNonCritical,
                .max = values.upperNonCritical,
                .lcrit = values.lowerCritical,
                .crit = values.upperCritical}};
        EXPECT_EQ(values.status, Vorn::Hwmon::statusOf(channel)) << node.path;
        EXPECT_EQ(node.sensorType, static_cast<unsigned>(node.type));
        ASSERT_TRUE(values.possibleStates) << node.path;
        if (values.status != 13) {
            EXPECT_THAT(*values.possibleStates, testing::Contains(values.status)) << node.path;
        }
    }
}

TEST(DemoModelTest, ShowsSensorsOfEveryKindInEveryStateThatMatters)
{
    std::map<Vorn::NodeLexicon::NodeType, int> kinds;
    std::set<unsigned> statuses;
    for (const SeenNode& node : demoMachine()) {
        ++kinds[node.type];
        statuses.insert(node.values.status);
    }
    EXPECT_THAT(kinds, testing::SizeIs(3));
    for (const auto& [type, count] : kinds)
        EXPECT_GE(count, 8);
    EXPECT_THAT(statuses, testing::ElementsAre(1, 13, 16, 22, 23, 25, 26));
}

} // namespace SchemaTests
