// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The selectors and filters of `list`.

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using namespace Testing;

class SelectionTest : public ToolTest {
protected:
    Ended listed(std::vector<std::string> more) const
    {
        more.insert(more.begin(), {"list", "--json", "--model", smallModel()});
        return run(more);
    }

    // Returns the sensors of a model file that the selector selects.
    nlohmann::json selectedOf(const std::string& file, const std::string& selector) const
    {
        return nlohmann::json::parse(run({"list", "--json", "--model", file, selector}).out);
    }

    std::vector<std::string> idsOf(const std::vector<std::string>& more) const
    {
        std::vector<std::string> ids;
        for (const auto& sensor : nlohmann::json::parse(listed(more).out))
            ids.push_back(sensor.at("deviceId"));
        return ids;
    }
};

TEST_F(SelectionTest, SelectorsAreNamesAndPatternsInAnyCase)
{
    for (const char* const selector :
        {"BOARD", "/board/*", "*:/board/*", "boar?", "[a-b]oard", "board/*"})
        EXPECT_THAT(
            idsOf({selector}), ElementsAre("+12V:/board/in1", "Fan:/board/fan1", "Fan:/board/fan2"))
            << selector;
    EXPECT_THAT(idsOf({"fan"}), ElementsAre("Fan:/board/fan1", "Fan:/board/fan2"));
    EXPECT_THAT(idsOf({"fan2"}), ElementsAre("Fan:/board/fan2"));
}

TEST_F(SelectionTest, LettersOfAllScriptsAreSelectedInAnyCase)
{
    const std::string file = model(R"(
        { "type": "tachometer", "path": "/Gehäuse/fan1", "description": "LÜFTER", "status": 1 },
        { "type": "tachometer", "path": "/gehäuse/fan2", "description": "вентилятор", "status": 1 },
        { "type": "tachometer", "path": "/x/fan3", "description": "Straße", "status": 1 })");
    const auto found = [&](const std::string& selector) {
        return selectedOf(file, selector).size();
    };
    for (const char* const selector :
        {"lüfter", "LÜFTER", "*üf*", "l?fter", "L[Üö]FTER", "ВЕНТИЛЯТОР", "Вент*", "STRAßE"})
        EXPECT_EQ(found(selector), 1U) << selector;
    EXPECT_EQ(found("GEHÄUSE"), 2U);
    EXPECT_EQ(found("luefter"), 0U);
    EXPECT_EQ(found("\xFC"), 0U);
    EXPECT_THAT(
        run({"list", "Lüftr", "--model", file}, {.environment = {{"LC_ALL", "C.UTF-8"}}}).err,
        HasSubstr("what comes nearest: \"LÜFTER\""));
}

TEST_F(SelectionTest, AddressesOfChipsMayBeShortened)
{
    const std::string file = model(R"(
        { "type": "tachometer", "path": "/hwmon/nct6798-isa-0290/fan1", "description": "A", "status": 1 },
        { "type": "tachometer", "path": "/hwmon/coretemp-isa-0000/fan1", "description": "B", "status": 1 },
        { "type": "tachometer", "path": "/hwmon/jc42-i2c-0-1a/fan1", "description": "C", "status": 1 })");
    const auto labels = [&](const std::string& selector) {
        std::string found;
        for (const auto& sensor : selectedOf(file, selector))
            found += sensor.at("label");
        return found;
    };
    for (const char* const selector : {"nct6798-isa-290", "nct6798-isa-0x290", "NCT6798-ISA-00290",
             "nct6798-isa-0290", "*-isa-290"})
        EXPECT_EQ(labels(selector), "A") << selector;
    for (const char* const selector : {"coretemp-isa-0", "coretemp-isa-0x0", "coretemp-isa-0000"})
        EXPECT_EQ(labels(selector), "B") << selector;
    EXPECT_EQ(labels("jc42-i2c-*-0x1A"), "C");
    EXPECT_EQ(labels("nct6798-isa-29"), "");
    EXPECT_EQ(labels("nct6798-isa-2900"), "");
    EXPECT_EQ(labels("nct6798-isa-"), "");
}

TEST_F(SelectionTest, NumbersOfOtherFoldersAreNoAddresses)
{
    const std::string file = model(R"(
        { "type": "tachometer", "path": "/psu-1/fan1", "description": "A", "status": 1 },
        { "type": "tachometer", "path": "/psu-01/fan1", "description": "B", "status": 1 },
        { "type": "tachometer", "path": "/node-2-1/fan1", "description": "C", "status": 1 },
        { "type": "tachometer", "path": "/node-2-01/fan1", "description": "D", "status": 1 })");
    for (const char* const chip : {"psu-1", "psu-01", "node-2-1", "node-2-01"})
        EXPECT_THAT(run({"get", chip, "--model", file}).out,
            HasSubstr("  Path           /" + std::string(chip) + "/fan1\n"));
}

TEST_F(SelectionTest, SeveralSelectorsAddUp)
{
    EXPECT_THAT(idsOf({"cpu 1", "CPU*", "in1"}),
        ElementsAre("+12V:/board/in1", "CPU 1:/cpu0/temp1", "CPU 2:/cpu1/temp1"));
}

TEST_F(SelectionTest, KindsAndProblemsNarrowTheSelection)
{
    EXPECT_THAT(idsOf({"--kind", "Fan"}), ElementsAre("Fan:/board/fan1", "Fan:/board/fan2"));
    EXPECT_THAT(idsOf({"--kind", "voltage", "--kind", "temperature", "board"}),
        ElementsAre("+12V:/board/in1"));
    EXPECT_THAT(idsOf({"--problems"}),
        ElementsAre("+12V:/board/in1", "Fan:/board/fan2", "CPU 2:/cpu1/temp1"));
    EXPECT_THAT(idsOf({"--problems", "fan"}), ElementsAre("Fan:/board/fan2"));
}

TEST_F(SelectionTest, NameWithMarksOfAPatternMatchesItself)
{
    const std::string file =
        model(R"({ "type": "voltage", "path": "/a", "description": "in[0]", "status": 1 })");
    EXPECT_EQ(run({"list", "in[0]", "--model", file}).code, 0);
    EXPECT_EQ(run({"list", "in0", "--model", file}).code, 3);
}

TEST_F(SelectionTest, EachSelectorThatNothingMatchesIsSaid)
{
    const Ended ended = listed({"CPU 3", "Fan", "bord"});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(nlohmann::json::parse(ended.out).size(), 2U);
    const auto lines = linesOf(ended.err);
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_THAT(lines[0], HasSubstr("no sensor matches \"CPU 3\"; what comes nearest: "));
    EXPECT_EQ(lines[1], "sensorctl: no sensor matches \"bord\"; what comes nearest: \"board\", "
                        "\"/board/in1\", \"/board/fan1\"");
}

TEST_F(SelectionTest, NamesAreNearestUpToAThirdOfTheSelector)
{
    for (const char* const selector : {"xp", "xyz0", "CPU 1234"})
        EXPECT_EQ(
            listed({selector}).err, std::string("sensorctl: no sensor matches \"") + selector +
                                        "\"; there are the chips \"board\", \"cpu0\", \"cpu1\"\n");
    for (const char* const selector : {"cp", "cup0", "xpu0", "baord", "xyu1/t", "CPU 12"})
        EXPECT_THAT(listed({selector}).err, HasSubstr("; what comes nearest: ")) << selector;
}

TEST_F(SelectionTest, FurtherChipsAreCountedWhereNoNameIsNear)
{
    EXPECT_EQ(
        run({"list", "quux", "--model", SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json"}).err,
        "sensorctl: no sensor matches \"quux\"; there are the chips \"system\", \"system/board\", "
        "\"system/chassis\" and 7 more\n");
}

TEST_F(SelectionTest, NothingLeftIsSaidAndEndsWithThree)
{
    const Ended healthy = listed({"cpu0", "--problems"});
    EXPECT_EQ(healthy.code, 3);
    EXPECT_EQ(healthy.out, "[]\n");
    EXPECT_EQ(healthy.err, "sensorctl: none of the sensors has a problem\n");
    EXPECT_EQ(listed({"cpu0", "--kind", "fan"}).err, "sensorctl: no sensor is of that kind\n");
}

TEST_F(SelectionTest, SummaryCountsWhatIsShown)
{
    const Ended ended = run({"list", "fan", "--model", smallModel()});
    EXPECT_EQ(linesOf(ended.out).back(), "2 sensors: 1 normal, 1 lost.");
}

} // namespace
