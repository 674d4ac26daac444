// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The document of `list --json` and its schema, by Debian's python3-jsonschema.

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using nlohmann::json;
using namespace Testing;

const std::string schema = SENSOR_PROFILE_SOURCE_DIR "/schema/sensorctl-list.schema.json";

class SensorJsonTest : public ToolTest {
protected:
    // Returns what the validator says of a document; an empty text when it is valid.
    std::string faultsIn(const std::string& document) const
    {
        const Ended ended =
            run({"-m", "jsonschema", "-i", folder_.write("document.json", document), schema},
                {.program = "/usr/bin/python3"});
        return ended.code == 0 ? "" : ended.out + ended.err + "invalid";
    }

    // Returns a machine with sensors in every state and one with every limit.
    std::string everyState() const
    {
        std::string nodes = R"({ "type": "temperature", "path": "/b/all", "description": "All",
            "status": 1, "baseUnits": 2, "reading": -1.5, "lowerNonCritical": 1,
            "upperNonCritical": 2, "lowerCritical": 3, "upperCritical": 4, "lowerFatal": 5,
            "upperFatal": 6 })";
        for (int status = 0; status <= 26; ++status)
            nodes += R"(, { "type": "voltage", "path": "/b/)" + std::to_string(status) +
                     R"(", "description": "in", "sensorType": 99, "status": )" +
                     std::to_string(status) + "}";
        return model(nodes);
    }
};

TEST_F(SensorJsonTest, DocumentIsValid)
{
    for (const std::string& file :
        {everyState(), std::string(SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json")}) {
        const Ended ended = run({"list", "--json", "--model", file});
        EXPECT_EQ(ended.code, 0) << ended.err;
        EXPECT_EQ(faultsIn(ended.out), "");
    }
    EXPECT_EQ(faultsIn(run({"get", "all", "--json", "--model", everyState()}).out), "");
}

TEST_F(SensorJsonTest, SchemaAllowsNothingElse)
{
    const json valid = json::parse(run({"list", "all", "--json", "--model", everyState()}).out);
    EXPECT_EQ(faultsIn(valid.dump()), "");
    for (const char* const patch :
        {R"({ "more": 1 })", R"({ "state": "Odd" })", R"({ "kind": "humidity" })",
            R"({ "value": "1" })", R"({ "limits": { "max": 1 } })", R"({ "chip": null })"}) {
        json changed = valid;
        changed[0].update(json::parse(patch));
        EXPECT_NE(faultsIn(changed.dump()), "") << patch;
    }
}

TEST_F(SensorJsonTest, SensorHasItsValues)
{
    const Ended ended = run({"list", "all", "--json", "--model", everyState()});
    EXPECT_EQ(json::parse(ended.out),
        json::array({{{"chip", "b"}, {"device", nullptr}, {"label", "All"}, {"kind", "temperature"},
            {"value", -1}, {"unit", "°C"}, {"state", "Normal"},
            {"limits", {{"lowWarning", 1}, {"lowCritical", 3}, {"lowFatal", 5}, {"highWarning", 2},
                           {"highCritical", 4}, {"highFatal", 6}}},
            {"deviceId", "All:/b/all"}}}));
}

TEST_F(SensorJsonTest, StringsAreEscaped)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "a\"b\\c\u001b\n\u202e\ufffd温" })");
    const Ended ended = run({"list", "--json", "--model", file});
    EXPECT_THAT(ended.out, testing::HasSubstr(R"("a\"b\\c\u001b\n\u202e�温")"));
    EXPECT_EQ(json::parse(ended.out)[0]["label"], "a\"b\\c\x1B\n\u202E\uFFFD温");
}

TEST_F(SensorJsonTest, MachineWithoutSensorsIsAnEmptyArray)
{
    const Ended ended = run({"list", "--json", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "[]\n");
}

} // namespace
