// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The lines and exit codes of `check`.

#include "tests/support/Pattern.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;
using namespace Testing;

class CheckTest : public ToolTest {
protected:
    Ended checkedFile(const std::string& file, std::vector<std::string> more = {}) const
    {
        more.insert(more.begin(), {"check", "--model", file});
        Ended ended = run(more);
        EXPECT_EQ(ended.err, "");
        EXPECT_EQ(linesOf(ended.out).size(), 1U) << ended.out;
        return ended;
    }

    Ended checked(const std::vector<std::string>& more = {}) const
    {
        return checkedFile(smallModel(), more);
    }
};

TEST_F(CheckTest, SourceThatCannotBeUsedIsUnknown)
{
    const std::string whole = model(
        R"({ "type": "temperature", "path": "/a", "description": "A", "status": 1, "reading": 7 })");
    const std::string broken = folder_.write("broken.json", "{");
    const Ended ended = run({"check"},
        {.environment = {{"VORN_INSTRUMENTATION", "model:" + whole + ",model:" + broken}}});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.out, HasSubstr(broken));
    EXPECT_THAT(ended.out, HasSubstr("A'=7")); // the others are judged
}

TEST_F(CheckTest, WorstSensorDecidesAndComesFirst)
{
    const Ended ended = checked();
    EXPECT_EQ(ended.code, 2);
    EXPECT_EQ(ended.out,
        "SENSORS CRITICAL - cpu1/CPU 2: Critical high (97 C), board/+12V: Warning high (12.75 V), "
        "board/Fan (fan2): Lost - 5 sensors: 2 normal, 1 warning, 1 critical, 1 lost. | "
        "'board/+12V'=12.75V;~:12.5;10.5: 'board/Fan (fan1)'=1200;300:; 'cpu0/CPU 1'=41C;5:80;~:95 "
        "'cpu1/CPU 2'=97C;;~:95\n");
}

TEST_F(CheckTest, ExitCodeFollowsTheStates)
{
    EXPECT_EQ(checked({"cpu0"}).code, 0);
    EXPECT_EQ(
        checked({"cpu0"}).out, "SENSORS OK - 1 sensor: 1 normal. | 'cpu0/CPU 1'=41C;5:80;~:95\n");
    EXPECT_EQ(checked({"fan2"}).code, 1);
    EXPECT_EQ(
        checked({"fan2"}).out, "SENSORS WARNING - board/Fan (fan2): Lost - 1 sensor: 1 lost.\n");
    EXPECT_EQ(checked({"--kind", "voltage"}).code, 1);
    EXPECT_EQ(checked({"--kind", "temperature"}).code, 2);
}

TEST_F(CheckTest, SeriesKeepTheirNamesInEverySelection)
{
    const std::vector<std::string> nodes = {
        R"({ "type": "tachometer", "path": "/b/fan1", "description": "Fan", "status": 1, "reading": 9 })",
        R"({ "type": "tachometer", "path": "/b/fan2", "description": "Fan", "status": 1, "reading": 8 })",
        R"({ "type": "tachometer", "path": "/c/fan1", "description": "Fan", "status": 1, "reading": 7 })"};
    const std::string file = model(nodes[0] + "," + nodes[1] + "," + nodes[2]);
    EXPECT_THAT(
        checkedFile(file).out, EndsWith("| 'b/Fan (fan1)'=9;; 'b/Fan (fan2)'=8;; 'c/Fan'=7;;\n"));
    EXPECT_THAT(checkedFile(file, {"fan2"}).out, EndsWith("| 'b/Fan (fan2)'=8;;\n"));
    EXPECT_THAT(checkedFile(file, {"/b/fan1"}).out, EndsWith("| 'b/Fan (fan1)'=9;;\n"));
    EXPECT_THAT(checkedFile(file, {"c"}).out, EndsWith("| 'c/Fan'=7;;\n"));
}

TEST_F(CheckTest, PerformanceDataHasTheFormOfPlugins)
{
    const std::string file = model(R"(
        { "type": "voltage", "path": "/a/1", "description": "it's | a=b; \u00fc", "status": 1,
          "baseUnits": 5, "reading": -1.5, "lowerNonCritical": -2, "upperNonCritical": 3 })");
    const Ended ended = checkedFile(file);
    EXPECT_THAT(ended.out, EndsWith(" | 'a/it_s _ a_b; ü'=-1.5V;-2:3;\n"));
    static const Pattern form("SENSORS [A-Z]+ - [^|]*( \\|( '[^'=|]+'=[-0-9.]+[A-Z]?;[-0-9.:~]*;"
                              "[-0-9.:~]*)+)?\n");
    for (const std::string& out : {ended.out, checked().out,
             checkedFile(SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json").out})
        EXPECT_TRUE(form.matches(out)) << out;
}

TEST_F(CheckTest, RangesReplaceTheSensorsOwnLimits)
{
    EXPECT_EQ(checked({"cpu0", "--warning", "CPU*=40"}).out,
        "SENSORS WARNING - cpu0/CPU 1: 41 C is beyond 40 - 1 sensor: 1 normal. | "
        "'cpu0/CPU 1'=41C;40;~:95\n");
    EXPECT_EQ(checked({"cpu0", "--critical", "CPU*=50:"}).code, 2);
    EXPECT_EQ(checked({"cpu0", "--warning", "CPU*=40", "--warning", "cpu 1=41"}).code, 0);
    EXPECT_EQ(checked({"in1", "--warning", "+12V=12.75"}).code, 0);
    EXPECT_EQ(checked({"in1", "--warning", "+12V=12.749"}).code, 1);
    EXPECT_EQ(checked({"cpu1", "--critical", "cpu1=100"}).code, 1); // still above its own limits
    EXPECT_EQ(checked({"cpu1", "--critical", "cpu1=100", "--warning", "cpu1=100"}).code, 0);
    EXPECT_EQ(checked({"fan2", "--warning", "fan=100:", "--critical", "fan=50:"}).code, 1);
}

TEST_F(CheckTest, AFileOfTheManagementControllerThatCannotBeReadIsUnknown)
{
    const std::string missing = (folder_.path() / "missing.json").string();
    const std::string broken = folder_.write("broken.json", "{");
    const std::string undated = folder_.write("undated.json", R"({"nodes":[]})");
    const auto checkedWith = [&](const std::string& collection, const std::string& selector) {
        const std::string sources = "model:" + smallModel() + ",ipmi:" + collection;
        return run({"check", selector}, {.environment = {{"VORN_INSTRUMENTATION", sources}}});
    };
    EXPECT_EQ(checkedWith(missing, "cpu0").code, 0);
    for (const auto& [file, reason] : {std::pair(broken, "line 1, column 2: "),
             {undated, "it does not say when the sensors were read"}}) {
        const Ended ended = checkedWith(file, "cpu0");
        EXPECT_EQ(ended.code, 3);
        EXPECT_THAT(ended.out, StartsWith("SENSORS UNKNOWN - model file " + file + ": " + reason));
        EXPECT_THAT(ended.out, HasSubstr(" - 1 sensor: 1 normal. | 'cpu0/CPU 1'="));
    }
    const Ended critical = checkedWith(broken, "cpu1");
    EXPECT_EQ(critical.code, 2);
    EXPECT_THAT(critical.out, HasSubstr(", model file " + broken + ": line 1, column 2: "));
    const Ended alone =
        run({"check"}, {.environment = {{"VORN_INSTRUMENTATION", "ipmi:" + broken}}});
    EXPECT_EQ(alone.code, 3);
    EXPECT_THAT(alone.out, StartsWith("SENSORS UNKNOWN - model file " + broken));
}

TEST_F(CheckTest, HelpSaysWhatSilencesASensor)
{
    EXPECT_THAT(run({"check", "--help"}).out, HasSubstr("silence a sensor, give both options"));
}

TEST_F(CheckTest, WhatIsMissingFromTheExpectedMachineIsCritical)
{
    const std::string expected = folder_.write("expected.json", contentOf(smallModel()));
    EXPECT_EQ(checked({"cpu0", "--expect", expected}).code, 0);
    const std::string file = model(R"(
        { "type": "tachometer", "path": "/board/fan1", "description": "Renamed", "status": 1,
          "reading": 900 },
        { "type": "voltage", "path": "/board/in1", "description": "+12V", "status": 1,
          "reading": 12 },
        { "type": "voltage", "path": "/new/in1", "description": "New", "status": 1,
          "reading": 1 })");
    const auto missing = [&](const std::vector<std::string>& more) {
        std::vector<std::string> arguments = {"check", "--model", file, "--expect", expected};
        arguments.insert(arguments.end(), more.begin(), more.end());
        return run(arguments);
    };
    EXPECT_EQ(missing({}).code, 2);
    EXPECT_THAT(
        missing({}).out, StartsWith("SENSORS CRITICAL - /board/fan2 is missing, chip cpu0 is "
                                    "missing, chip cpu1 is missing - 3 sensors: 3 normal."));
    EXPECT_EQ(missing({"/board/*1"}).code, 0);
    EXPECT_EQ(missing({"cpu0"}).code, 2);
    EXPECT_THAT(missing({"cpu0"}).out, HasSubstr("chip cpu0 is missing, no sensor matches"));
}

TEST_F(CheckTest, ASensorWithoutContactIsAProblemWhereItIsExpected)
{
    constexpr const char* slot = R"({ "type": "temperature", "path": "/ipmi/20/0/1",
                                      "description": "Slot 1", "status": )";
    const std::string empty = model(slot + std::string("17 }"));
    EXPECT_EQ(checkedFile(empty).out, "SENSORS OK - 1 sensor: 1 inactive.\n");
    const std::string full = folder_.write(
        "full.json", "{ \"nodes\": [" + std::string(slot) + "1, \"reading\": 20 } ] }");
    EXPECT_EQ(run({"check", "--model", empty, "--expect", empty}).code, 0);
    EXPECT_EQ(run({"check", "--model", empty, "--expect", full}).out,
        "SENSORS CRITICAL - /ipmi/20/0/1 has no contact - 1 sensor: 1 inactive.\n");
}

TEST_F(CheckTest, ASensorInAnUnknownStateIsUnknownUnlessSomethingIsWorse)
{
    constexpr const char* nodes = R"(
        { "type": "temperature", "path": "/a/temp1", "description": "A", "status": 0,
          "baseUnits": 2, "reading": 50 },
        { "type": "voltage", "path": "/b/in1", "description": "B", "status": 23,
          "baseUnits": 5, "reading": 13 })";
    const std::string file = model(nodes);
    EXPECT_EQ(checkedFile(file, {"a"}).code, 3);
    EXPECT_THAT(checkedFile(file, {"a"}).out,
        StartsWith("SENSORS UNKNOWN - a/A: Unknown (50 C) - 1 sensor: 1 unknown. | "));
    EXPECT_EQ(checkedFile(file).code, 1);
    EXPECT_THAT(
        checkedFile(file).out, HasSubstr("b/B: Warning high (13 V), a/A: Unknown (50 C) - "));
    EXPECT_EQ(checkedFile(file, {"a", "--warning", "a=60"}).code, 3);
    EXPECT_EQ(checkedFile(file, {"a", "--warning", "a=60", "--critical", "a=70"}).code, 0);
    EXPECT_EQ(checkedFile(file, {"a", "--warning", "a=60", "--critical", "a=40"}).code, 2);
}

TEST_F(CheckTest, ProblemsLeaveOutWhatIsOk)
{
    EXPECT_EQ(checked({"--problems"}).out,
        "SENSORS CRITICAL - cpu1/CPU 2: Critical high (97 C), board/+12V: Warning high (12.75 V), "
        "board/Fan (fan2): Lost - 3 sensors: 1 warning, 1 critical, 1 lost. | "
        "'board/+12V'=12.75V;~:12.5;10.5: 'cpu1/CPU 2'=97C;;~:95\n");
    EXPECT_EQ(checked({"cpu0", "--problems"}).out, "SENSORS OK - no problem in 1 sensor.\n");
    EXPECT_EQ(checked({"cpu0", "/board/fan1", "--problems"}).out,
        "SENSORS OK - no problem in 2 sensors.\n");
    EXPECT_EQ(checked({"cpu0", "--problems"}).code, 0);
    EXPECT_EQ(checked({"cpu0", "--problems", "--warning", "cpu0=40"}).out,
        "SENSORS WARNING - cpu0/CPU 1: 41 C is beyond 40 - 1 sensor: 1 normal. | "
        "'cpu0/CPU 1'=41C;40;~:95\n");
    EXPECT_EQ(
        checked({"cpu1", "--problems", "--warning", "cpu1=99", "--critical", "cpu1=100"}).code, 0);
    EXPECT_EQ(checked({"nothing", "--problems"}).out,
        "SENSORS UNKNOWN - no sensor matches \"nothing\", there are the chips \"board\", \"cpu0\", "
        "\"cpu1\"\n");
}

TEST_F(CheckTest, ManyProblemsAreCounted)
{
    const auto checkedWith = [&](int sensors) {
        std::string nodes;
        for (int i = 1; i <= sensors; ++i)
            nodes += std::string(i == 1 ? "" : ",") +
                     R"({ "type": "voltage", "status": 13, "path": "/)" + std::to_string(i) +
                     R"(", "description": "V)" + std::to_string(i) + R"(" })";
        return checkedFile(model(nodes)).out;
    };
    EXPECT_THAT(checkedWith(12), HasSubstr("//V8: Lost, 4 more problems - 12 sensors"));
    EXPECT_THAT(checkedWith(9), HasSubstr("//V8: Lost, 1 more problem - 9 sensors"));
    EXPECT_THAT(checkedWith(8), HasSubstr("//V8: Lost - 8 sensors"));
}

TEST_F(CheckTest, WhatCannotBeJudgedIsUnknown)
{
    const std::vector<std::pair<std::vector<std::string>, std::string>> cases = {
        {{"--model", smallModel(), "nothing"}, "no sensor matches \"nothing\", there are"},
        {{"--model", smallModel(), "cpu0", "--warning", "x=1"},
            "no sensor matches \"x\", there are the chips"},
        {{"--model", smallModel(), "--warning", "cpu0"}, "\"cpu0\" is not SELECTOR=RANGE ("},
        {{"--model", smallModel(), "--critical", "cpu0=hot"}, "\"hot\" is no range such as 10:80"},
        {{"--model", smallModel(), "--critical", "cpu0=5:4"}, "\"5:4\" begins above its end"},
        {{"--nonsense"}, "The following argument was not expected: --nonsense ("},
        {{"--model", "/no/such/file"}, "model file /no/such/file: No such file or directory\n"},
        {{"--model", smallModel(), "--expect", "/none"}, "model file /none: No such file"}};
    for (const auto& [arguments, reason] : cases) {
        std::vector<std::string> all = arguments;
        all.insert(all.begin(), "check");
        const Ended ended = run(all);
        EXPECT_EQ(ended.code, 3) << reason;
        EXPECT_THAT(ended.out, StartsWith("SENSORS UNKNOWN - " + reason));
        EXPECT_EQ(ended.err, "");
    }
    const Ended empty = run({"check", "--model", model("")});
    EXPECT_EQ(empty.code, 3);
    EXPECT_EQ(empty.out, "SENSORS UNKNOWN - this machine has no sensors\n");
}

TEST_F(CheckTest, OutputThatCannotBeWrittenIsUnknown)
{
    const Ended ended = run({"check", "--model", smallModel(), "cpu0"},
        {.out = RunOptions::Out::file, .outFile = "/dev/full"});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.err, HasSubstr("No space left on device"));
}

} // namespace
