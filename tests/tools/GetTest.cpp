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

TEST_F(GetTest, ShowsReadingStateAndLimitsFirst)
{
    const Ended ended = got("+12V:/board/in1");
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(ended.out, "+12V\n"
                         "  Reading        12.75 V\n"
                         "  State          Warning high\n"
                         "  Low critical   10.5 V\n"
                         "  High warning   12.5 V\n"
                         "  Kind           voltage\n"
                         "  Chip           board\n"
                         "  Path           /board/in1\n"
                         "  DeviceID       +12V:/board/in1\n");
}

TEST_F(GetTest, ShowsSeveralSensors)
{
    const Ended ended = got("+12V", {"cpu1"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.out, got("+12V").out + "\n" + got("CPU 2").out);
}

TEST_F(GetTest, ShowsEveryPropertyWithTheMeaningsOfCodes)
{
    const Ended ended = got("+12V:/board/in1", {"--verbose"});
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
             "\n  CurrentReading             12750 (12.75 V)\n",
             "\n  UnitModifier               -3\n",
             "\n  LowerThresholdCritical     10500 (10.5 V)\n",
             "\n  SupportedThresholds        0 (LowerThresholdNonCritical), 1 (Upper",
         })
        EXPECT_THAT(ended.out, HasSubstr(line));
    EXPECT_THAT(ended.out, Not(HasSubstr("UpperThresholdFatal  ")));
}

TEST_F(GetTest, SaysThatALostSensorHasNoReading)
{
    EXPECT_THAT(got("Fan:/board/fan2").out, HasSubstr("  Reading        -\n"));
    EXPECT_THAT(got("Fan:/board/fan2", {"-v"}).out,
        AllOf(HasSubstr("CurrentReading           0 (no reading)\n"),
            HasSubstr("OperationalStatus        13 (Lost Communication)\n")));
}

TEST_F(GetTest, AcceptsWhatOnlyOneSensorMatches)
{
    EXPECT_EQ(got("CPU 2").code, 0);
    for (const char* const wanted : {"CPU 2:/cpu1/temp1", "cpu 2", "/cpu1/temp1", "cpu1",
             "cpu1/temp1", "CPU1/cpu 2", "*2:/cpu1*", "cpu [2-9]"})
        EXPECT_EQ(got(wanted).out, got("CPU 2").out) << wanted;
}

TEST_F(GetTest, KindNarrowsWhatANameMatches)
{
    EXPECT_EQ(got("board", {"--kind", "voltage"}).out, got("+12V").out);
    EXPECT_EQ(got("+12V:/board/in1", {"--kind", "voltage", "--kind", "fan"}).out, got("+12V").out);
    const std::string path = json::parse(got("+12V", {"--cim"}).out)["instances"][0]["path"];
    EXPECT_EQ(got(path, {"--kind", "voltage"}).out, got("+12V").out);
    for (const std::string& wanted : {std::string("board"), std::string("+12V:/board/in1"), path}) {
        const Ended ended = got(wanted, {"--kind", "temperature"});
        EXPECT_EQ(ended.code, 3);
        EXPECT_EQ(ended.out, "");
        EXPECT_EQ(ended.err, "sensorctl: no sensor of that kind matches \"" + wanted + "\"\n");
    }
    EXPECT_EQ(got("ZUMLO:SensorEnabledLogicalElementCap1", {"--kind", "fan"}).code, 3);
    EXPECT_THAT(got("board", {"--kind", "fan"}).err, HasSubstr("choose one of its 2 sensors"));
}

TEST_F(GetTest, ProblemsNarrowWhatANameMatches)
{
    EXPECT_EQ(got("Fan", {"--problems"}).out, got("Fan:/board/fan2").out);
    EXPECT_EQ(got("+12V:/board/in1", {"--problems"}).out, got("+12V").out);
    EXPECT_THAT(got("cpu*", {"--problems"}).out, HasSubstr("  DeviceID       CPU 2:/cpu1/temp1\n"));
    const std::string path = json::parse(got("CPU 1", {"--cim"}).out)["instances"][0]["path"];
    for (const std::string& wanted : {std::string("cpu 1"), path}) {
        const Ended ended = got(wanted, {"--problems"});
        EXPECT_EQ(ended.code, 3);
        EXPECT_EQ(ended.err, "sensorctl: no sensor with a problem matches \"" + wanted + "\"\n");
    }
    EXPECT_EQ(got("cpu0", {"--problems", "--kind", "temperature"}).err,
        "sensorctl: no sensor of that kind with a problem matches \"cpu0\"\n");
    EXPECT_EQ(got("ZUMLO:SensorEnabledLogicalElementCap1", {"--problems"}).code, 3);
}

TEST_F(GetTest, OffersTheChoicesOfAnAmbiguousNameAsLinesToCopy)
{
    const Ended ended = got("Fan");
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.out, "");
    const std::string start =
        "\n  " + sensorctl + " get --model " + smallModel() + " Fan:/board/fan";
    EXPECT_EQ(ended.err, "sensorctl: \"Fan\" is ambiguous; choose one of its 2 sensors:" + start +
                             "1" + start + "2\n");
    EXPECT_THAT(run({"-c", linesOf(ended.err).back()}, {.program = "/bin/sh"}).out,
        HasSubstr("/board/fan2\n"));
}

TEST_F(GetTest, ChoicesRepeatTheOptions)
{
    const std::string file = model(R"(
        { "type": "tachometer", "path": "/a/1", "description": "Fan", "status": 13 },
        { "type": "tachometer", "path": "/a/2", "description": "Fan", "status": 13 },
        { "type": "tachometer", "path": "/a/3", "description": "Fan", "status": 1 })");
    const std::vector<std::vector<std::string>> forms = {{"--json"}, {"--cim"},
        {"-v", "--kind", "fan", "--kind", "voltage", "--problems", "--color", "always"}};
    for (std::vector<std::string> options : forms) {
        options.insert(options.end(), {"--provider", sensorLibrary, "--model", file});
        std::vector<std::string> words = {"get", "Fan"};
        words.insert(words.end(), options.begin(), options.end());
        const std::string line = linesOf(run(words).err).at(1);
        words[1] = "Fan:/a/1";
        const std::string expected = run(words).out;
        EXPECT_THAT(expected, HasSubstr("Fan:/a/1"));
        EXPECT_EQ(run({"-c", line}, {.program = "/bin/sh"}).out, expected) << line;
    }
}

TEST_F(GetTest, ChoicesBeginWithTheWordsOfTheCall)
{
    const auto called = [&](const std::string& name) {
        const std::string command =
            "exec -a " + name + " " + sensorctl + " get Fan --model " + smallModel();
        return run({"-c", command}, {.program = "/bin/bash"}).err;
    };
    EXPECT_THAT(called("./run"), HasSubstr("\n  ./run get --model "));
    EXPECT_THAT(called("'/my tools/sensorctl'"), HasSubstr("\n  '/my tools/sensorctl' get "));
}

TEST_F(GetTest, ChoicesAreQuotedForTheShell)
{
    const std::string file = model(R"(
        { "type": "voltage", "path": "/a", "description": "-it's", "status": 1 },
        { "type": "voltage", "path": "/b", "description": "-it's", "status": 1 })");
    const Ended ended = run({"get", "--model", file, "--", "-it's"});
    const std::string line = linesOf(ended.err).back();
    EXPECT_THAT(line, testing::EndsWith(R"( -- '-it'\''s:/b')"));
}

TEST_F(GetTest, ChoicesWorkInEveryLocale)
{
    const std::string file = model(R"(
        { "type": "temperature", "path": "/a/t1", "description": "ÄRGER", "status": 1 },
        { "type": "temperature", "path": "/b/t5", "description": "ÄRGER", "status": 1 },
        { "type": "voltage", "path": "/c/in1", "description": "a\u0007b", "status": 1 },
        { "type": "voltage", "path": "/c/in2", "description": "a\u0007b", "status": 1 })");
    const auto chosen = [&](const char* selector, const std::string& locale) {
        const RunOptions options{.environment = {{"LC_ALL", locale}}};
        const Ended ended = run({"get", "--model", file, selector}, options);
        return run({"-c", linesOf(ended.err).back()},
            {.program = "/bin/sh", .environment = {{"LC_ALL", locale}}})
            .out;
    };
    for (const char* const locale : {"C", "C.UTF-8"}) {
        EXPECT_THAT(chosen("ärger", locale), HasSubstr("  Path           /b/t5\n"));
        EXPECT_THAT(chosen("a?b", locale), HasSubstr("  Path           /c/in2\n"));
    }
}

TEST_F(GetTest, WhatNothingMatchesHasTheNearestNames)
{
    const Ended ended = got("CPU 3");
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "");
    EXPECT_EQ(ended.err, "sensorctl: no sensor matches \"CPU 3\"; what comes nearest: \"CPU 1\", "
                         "\"CPU 2\"\n");
    for (const std::string wanted : {"xyz", "", "list"})
        EXPECT_EQ(got(wanted).err, "sensorctl: no sensor matches \"" + wanted +
                                       "\"; there are the chips \"board\", \"cpu0\", \"cpu1\"\n");
    EXPECT_EQ(got("ZUMLO_NumericSensor.DeviceID=\"none\"").err,
        "sensorctl: there is no object with the path \"ZUMLO_NumericSensor.DeviceID=\"none\"\"\n");
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

TEST_F(GetTest, CimIsTheListsDocumentWithOneInstance)
{
    const Ended ended = got("CPU 1:/cpu0/temp1", {"--cim"});
    const json all = json::parse(run({"list", "--cim", "--model", smallModel()}).out);
    json expected = all;
    expected["instances"] = json::array({all["instances"][3]});
    EXPECT_EQ(json::parse(ended.out), expected);
}

TEST_F(GetTest, LongListsGoOnInTheNextLine)
{
    const Ended ended =
        run({"get", "-v", "CPU 1", "--model", smallModel()}, {.environment = {{"COLUMNS", "80"}}});
    for (const std::string& line : linesOf(ended.out)) {
        if (line.find("Description ") == std::string::npos) {
            EXPECT_LE(line.size(), 81U) << line; // the degree sign is two bytes
        }
    }
    EXPECT_THAT(
        ended.out, HasSubstr("0 (LowerThresholdNonCritical),\n                             1 "));
}

} // namespace
