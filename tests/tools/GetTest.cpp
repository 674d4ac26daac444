// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using nlohmann::json;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using namespace Testing;

class GetTest : public ToolTest {
protected:
    Ended got(const std::string& wanted, std::vector<std::string> more = {}) const
    {
        more.insert(more.begin(), {"get", wanted, "--model", smallModel()});
        return run(more);
    }
};

TEST_F(GetTest, ShowsEveryPropertyWithTheMeaningsOfCodes)
{
    const Ended ended = got("+12V:/board/in1");
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(linesOf(ended.out).front(), "+12V");
    for (const char* const line : {
             "\n  DeviceID                   +12V:/board/in1\n",
             "\n  BaseUnits                  5 (Volts)\n",
             "\n  RateUnits                  0 (None)\n",
             "\n  SensorType                 3 (Voltage)\n",
             "\n  EnabledState               5 (Not Applicable)\n",
             "\n  RequestedState             2 (Enabled)\n",
             "\n  HealthState                10 (Degraded/Warning)\n",
             "\n  OperationalStatus          0 (Unknown)\n",
             "\n  CurrentReading             12750 (12.750 V)\n",
             "\n  UnitModifier               -3\n",
             "\n  LowerThresholdCritical     10500 (10.5 V)\n",
             "\n  SupportedThresholds        0 (LowerThresholdNonCritical), 1 (Upper",
         })
        EXPECT_THAT(ended.out, HasSubstr(line));
    EXPECT_THAT(ended.out, Not(HasSubstr("UpperThresholdFatal  ")));
}

TEST_F(GetTest, SaysThatALostSensorHasNoReading)
{
    EXPECT_THAT(got("Fan:/board/fan2").out,
        AllOf(HasSubstr("CurrentReading           0 (no reading)\n"),
            HasSubstr("OperationalStatus        13 (Lost Communication)\n")));
}

TEST_F(GetTest, AcceptsANameThatOnlyOneSensorHas)
{
    EXPECT_EQ(got("CPU 2").out, got("CPU 2:/cpu1/temp1").out);
    EXPECT_EQ(got("CPU 2").code, 0);
}

TEST_F(GetTest, RefusesANameOfSeveralSensorsAndListsTheirIds)
{
    const Ended ended = got("Fan");
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.out, "");
    EXPECT_EQ(ended.err,
        "sensorctl: several sensors are named \"Fan\"; give one of their DeviceIDs: "
        "\"Fan:/board/fan1\" \"Fan:/board/fan2\"\n");
}

TEST_F(GetTest, UnknownSensorIsNotFound)
{
    for (const std::string wanted : {"CPU 3", "", "list", "cpu 1"}) {
        const Ended ended = got(wanted);
        EXPECT_EQ(ended.code, 3) << wanted;
        EXPECT_EQ(ended.out, "");
        EXPECT_EQ(ended.err,
            "sensorctl: no object has the DeviceID, the name, the InstanceID or the path \"" +
                wanted + "\"\n");
    }
}

TEST_F(GetTest, IdThatBeginsWithADashFollowsTwoDashes)
{
    const std::string file =
        model(R"({ "type": "voltage", "path": "/a", "description": "-12V", "status": 1 })");
    EXPECT_EQ(run({"get", "--model", file, "--", "-12V:/a"}).code, 0);
}

TEST_F(GetTest, MachineWithoutSensorsIsSaid)
{
    const Ended ended = run({"get", "CPU 1", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.err, HasSubstr("this machine has no sensors"));
}

TEST_F(GetTest, JsonIsTheListsDocumentWithOneInstance)
{
    const Ended ended = got("CPU 1:/cpu0/temp1", {"--json"});
    const json all = json::parse(run({"list", "--json", "--model", smallModel()}).out);
    json expected = all;
    expected["instances"] = json::array({all["instances"][1]});
    EXPECT_EQ(json::parse(ended.out), expected);
}

TEST_F(GetTest, LongListsGoOnInTheNextLine)
{
    const Ended ended =
        run({"get", "CPU 1", "--model", smallModel()}, {.environment = {{"COLUMNS", "80"}}});
    for (const std::string& line : linesOf(ended.out)) {
        if (line.find("Description ") == std::string::npos) {
            EXPECT_LE(line.size(), 81U) << line; // the degree sign is two bytes
        }
    }
    EXPECT_THAT(
        ended.out, HasSubstr("0 (LowerThresholdNonCritical),\n                             1 "));
}

} // namespace
