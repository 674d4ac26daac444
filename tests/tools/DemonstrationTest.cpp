// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The demonstration machine, which is shown where a machine has no sensors. The expected output is
// that of `COLUMNS=80 LC_ALL=C.UTF-8 sensorctl list --model schema/demo-model.json`.

#include "tests/tools/ToolTest.h"
#include "tools/output/PrintableText.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace {

using nlohmann::json;
using namespace Testing;

const std::string demonstration = SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json";
const std::string golden = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/demonstration-list.txt";

TEST(DemonstrationTest, ListIsTheGoldenOutput)
{
    const Ended ended = run({"list", "--model", demonstration},
        {.environment = {{"COLUMNS", "80"}, {"LC_ALL", "C.UTF-8"}}});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(ended.out, contentOf(golden));
}

TEST(DemonstrationTest, ListFitsATerminalWithoutCuttingNames)
{
    const Ended ended = runOnTerminal({"list", "--model", demonstration, "--color=never"}, 80);
    EXPECT_THAT(ended.out, testing::Not(testing::HasSubstr("…")));
    for (std::string line : linesOf(ended.out)) {
        std::erase(line, '\r');
        EXPECT_LE(Tools::displayWidth(line), 80U) << line;
    }
}

TEST(DemonstrationTest, DocumentHoldsEveryNodeOfTheFile)
{
    const json file = json::parse(contentOf(demonstration));
    const json document = json::parse(run({"list", "--cim", "--model", demonstration}).out);
    EXPECT_EQ(document["instances"].size(), file["nodes"].size());
}

TEST(DemonstrationTest, EverySensorCanBeFetchedByItsId)
{
    const json document = json::parse(run({"list", "--cim", "--model", demonstration}).out);
    for (const json& instance : document["instances"]) {
        const std::string id = instance["properties"]["DeviceID"];
        const Ended ended = run({"get", id, "--cim", "--model", demonstration});
        EXPECT_EQ(ended.code, 0) << id;
        EXPECT_EQ(json::parse(ended.out)["instances"], json::array({instance}));
    }
}

TEST(DemonstrationTest, RecordReplaysToTheSameOutput)
{
    const TemporaryFolder folder;
    const std::string file = (folder.path() / "record.json").string();
    ASSERT_EQ(run({"record", "--model", demonstration, "-o", file}).code, 0);
    for (const char* const form : {"--cim", "--color=never"})
        EXPECT_EQ(run({"list", form, "--model", file}).out,
            run({"list", form, "--model", demonstration}).out);
}

} // namespace
