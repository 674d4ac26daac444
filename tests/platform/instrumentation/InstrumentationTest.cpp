// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Instrumentation.h"

#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"
#include "tests/support/LogCapture.h"
#include "tests/support/ScriptedMachine.h"
#include "tests/support/TestSources.h"

#include <gmock/gmock.h>

#include <thread>

namespace InstrumentationTests {

using testing::ElementsAre;
using Testing::EnvironmentVariable;
using Testing::errorOf;
using testing::IsEmpty;
using Testing::LogCapture;
using testing::Not;
using Testing::ScriptedMachine;
using testing::SizeIs;
using Testing::walk;
using Vorn::Instrumentation;
using Vorn::NodeLexicon::NodeType;
using Vorn::NodeLexicon::Properties;

// Its readings are a counter, so that each differs from the others.
class CountingSource final : public Vorn::Source {
public:
    const std::vector<Vorn::Node>& nodes(NodeType type) override
    {
        nodes_ = {{"/a", "A", static_cast<unsigned>(type), 0}, {"/b", "B", 99, 1}};
        return nodes_;
    }
    const Vorn::NodeReading& read(const Vorn::Node&) override
    {
        ++count_;
        reading_ = {.status = count_, .reading = count_};
        return reading_;
    }

private:
    unsigned count_ = 0;
    std::vector<Vorn::Node> nodes_;
    Vorn::NodeReading reading_;
};

struct CountingMachine {
    CountingMachine()
    {
        Testing::provideSource("counting", [] { return std::make_unique<CountingSource>(); });
    }
    EnvironmentVariable environment{"VORN_INSTRUMENTATION", "counting"};
};

double readingAt(Instrumentation& cursor)
{
    double value = 0.0;
    EXPECT_TRUE(cursor.getProperty(Properties::Reading, value));
    return value;
}

TEST(CursorTest, ReadsANodeOncePerVisitAndAfreshAtTheNext)
{
    const CountingMachine machine;
    Instrumentation cursor;
    cursor.selectNode(NodeType::Voltage);
    EXPECT_EQ(cursor.getNodeStatus(), 1U);
    EXPECT_EQ(readingAt(cursor), 1.0);
    ++cursor;
    EXPECT_EQ(readingAt(cursor), 2.0);
    EXPECT_EQ(cursor.getNodeStatus(), 2U);
    cursor.selectNode(NodeType::Voltage);
    EXPECT_EQ(cursor.getNodeStatus(), 3U);
}

TEST(CursorTest, DoesNotReadANodeThatNobodyAsks)
{
    const CountingMachine machine;
    Instrumentation cursor;
    cursor.selectNode(NodeType::Voltage);
    EXPECT_EQ(cursor.getPathToNode(), "/a");
    EXPECT_EQ(cursor.getNodeDescription(), "A");
    EXPECT_EQ(cursor.getSensorType(), 21U);
    ++cursor;
    EXPECT_EQ(cursor.getSensorType(), 99U);
    EXPECT_EQ(cursor.getNodeStatus(), 1U);
}

TEST(CursorTest, StandsOnNothingBeforeASelectionAndAfterTheLastNode)
{
    const CountingMachine machine;
    Instrumentation cursor;
    EXPECT_FALSE(cursor);
    cursor.selectNode(NodeType::Voltage);
    EXPECT_TRUE(cursor);
    ++cursor;
    EXPECT_TRUE(cursor);
    ++cursor;
    EXPECT_FALSE(cursor);
    EXPECT_THROW(cursor.getPathToNode(), std::out_of_range);
    EXPECT_THROW(cursor.getNodeStatus(), std::out_of_range);
}

TEST(CursorTest, ShowsTheNodesOfAllSourcesInTheOrderOfTheSetting)
{
    const ScriptedMachine scripted({{NodeType::Voltage, "/s", "S", {}}});
    const CountingMachine counting;
    const EnvironmentVariable both("VORN_INSTRUMENTATION", "scripted,counting");
    std::vector<std::string> paths;
    Instrumentation cursor;
    for (cursor.selectNode(NodeType::Voltage); cursor; ++cursor)
        paths.push_back(cursor.getPathToNode());
    EXPECT_THAT(paths, ElementsAre("/s", "/a", "/b"));
}

TEST(CursorTest, GivesAPropertyOnlyInItsOwnKind)
{
    const ScriptedMachine machine({{NodeType::Temperature, "/n", "N",
        {.reading = 1,
            .lowerNonCritical = 2,
            .upperNonCritical = 3,
            .lowerCritical = 4,
            .upperCritical = 5,
            .lowerFatal = 6,
            .upperFatal = 7,
            .baseUnits = 8,
            .possibleStates = {{9}}}}});
    Instrumentation cursor;
    cursor.selectNode(NodeType::Temperature);
    double number = -1;
    unsigned code = 77;
    std::vector<unsigned> codes{77};
    const std::pair<Properties, double> numbers[] = {{Properties::Reading, 1},
        {Properties::LowerNonCritical, 2}, {Properties::UpperNonCritical, 3},
        {Properties::LowerCritical, 4}, {Properties::UpperCritical, 5}, {Properties::LowerFatal, 6},
        {Properties::UpperFatal, 7}};
    for (const auto& [property, value] : numbers) {
        EXPECT_TRUE(cursor.getProperty(property, number));
        EXPECT_EQ(number, value);
        EXPECT_FALSE(cursor.getProperty(property, code));
        EXPECT_FALSE(cursor.getProperty(property, codes));
    }
    for (const Properties property : {Properties::BaseUnits, Properties::PossibleStates})
        EXPECT_FALSE(cursor.getProperty(property, number));
    EXPECT_FALSE(cursor.getProperty(Properties::PossibleStates, code));
    EXPECT_FALSE(cursor.getProperty(Properties::BaseUnits, codes));
    EXPECT_EQ(number, 7);
    EXPECT_EQ(code, 77U);
    EXPECT_THAT(codes, ElementsAre(77));
    EXPECT_TRUE(cursor.getProperty(Properties::BaseUnits, code));
    EXPECT_TRUE(cursor.getProperty(Properties::PossibleStates, codes));
    EXPECT_EQ(code, 8U);
    EXPECT_THAT(codes, ElementsAre(9));
}

TEST(CursorTest, LeavesTheValueAloneWhenTheNodeLacksTheProperty)
{
    const ScriptedMachine machine({{NodeType::Temperature, "/n", "N", {}}});
    Instrumentation cursor;
    cursor.selectNode(NodeType::Temperature);
    double number = 4.5;
    unsigned code = 7;
    std::vector<unsigned> codes{7};
    EXPECT_FALSE(cursor.getProperty(Properties::Reading, number));
    EXPECT_FALSE(cursor.getProperty(Properties::BaseUnits, code));
    EXPECT_FALSE(cursor.getProperty(Properties::PossibleStates, codes));
    EXPECT_EQ(number, 4.5);
    EXPECT_EQ(code, 7U);
    EXPECT_THAT(codes, ElementsAre(7));
}

TEST(CursorTest, MakesPathsPrintable)
{
    const CountingMachine machine;
    const Instrumentation cursor;
    EXPECT_EQ(cursor.convertPathToString("/board/cpu 0/temp1"), "/board/cpu 0/temp1");
    EXPECT_EQ(cursor.convertPathToString("/a\n\xFF"), "/a\\n\xEF\xBF\xBD");
}

TEST(SettingsTest, AreReadAtEveryConstruction)
{
    const ScriptedMachine machine({{NodeType::Voltage, "/v", "V", {}}});
    EXPECT_THAT(walk(), SizeIs(1));
    const CountingMachine counting;
    EXPECT_THAT(walk(), SizeIs(6));
}

TEST(CursorTest, IsUsedOnManyThreadsAtOnce)
{
    const CountingMachine machine;
    std::vector<std::jthread> threads;
    for (int thread = 0; thread < 8; ++thread)
        threads.emplace_back([] {
            for (int turn = 0; turn < 50; ++turn)
                EXPECT_THAT(walk(), SizeIs(6));
        });
}

// Uses three cursors as a request does. The failure of one does not prevent the next.
void request()
{
    for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer})
        errorOf([&] {
            Instrumentation cursor;
            for (cursor.selectNode(type); cursor; ++cursor)
                cursor.getNodeStatus();
        });
}

std::vector<std::string> textsOf(const LogCapture& capture)
{
    std::vector<std::string> texts;
    for (const Testing::LogLine& line : capture.log()) {
        EXPECT_EQ(line.level, 6000);
        EXPECT_EQ(line.component, "Nimbrel.Instrumentation");
        texts.push_back(line.text);
    }
    return texts;
}

// Clears the recorded failures after each test, since a recorded failure is not reported again.
class FailureTest : public testing::Test {
protected:
    void TearDown() override
    {
        const ScriptedMachine working;
        request();
    }
};

TEST_F(FailureTest, AtConstructionIsReportedOnce)
{
    const LogCapture capture;
    ScriptedMachine machine;
    machine.failConstruction();
    EXPECT_EQ(errorOf([] { Instrumentation cursor; }), "scripted: construction");
    request();
    request();
    EXPECT_THAT(textsOf(capture),
        ElementsAre("source \"scripted\" cannot be used: scripted: construction"));
}

// Has nodes of one type.
class VoltageSource final : public Vorn::Source {
public:
    const std::vector<Vorn::Node>& nodes(NodeType type) override
    {
        return type == NodeType::Voltage ? voltages_ : none_;
    }
    const Vorn::NodeReading& read(const Vorn::Node&) override { return reading_; }

private:
    const std::vector<Vorn::Node> voltages_ = {{"/v", "V", 21, 0}};
    const std::vector<Vorn::Node> none_ = {};
    const Vorn::NodeReading reading_ = {};
};

TEST_F(FailureTest, OfOneSourceTakesNoNodesOfOthersAway)
{
    Testing::provideSource("volts", [] { return std::make_unique<VoltageSource>(); });
    for (const bool failsAtOnce : {true, false}) {
        const LogCapture capture;
        ScriptedMachine machine;
        machine.failConstruction(failsAtOnce);
        machine.failSelection(NodeType::Voltage);
        machine.failSelection(NodeType::Temperature);
        for (const std::string list : {"scripted,volts", "volts,scripted"}) {
            const EnvironmentVariable both("VORN_INSTRUMENTATION", list);
            Instrumentation cursor;
            cursor.selectNode(NodeType::Voltage);
            ASSERT_TRUE(cursor) << list;
            EXPECT_EQ(cursor.getPathToNode(), "/v");
            EXPECT_FALSE(++cursor);
            EXPECT_NO_THROW(cursor.selectNode(NodeType::Temperature)) << list;
            EXPECT_FALSE(cursor);
        }
        EXPECT_THAT(textsOf(capture), Not(IsEmpty()));
        const EnvironmentVariable alone("VORN_INSTRUMENTATION", "scripted,scripted");
        EXPECT_THROW(Instrumentation().selectNode(NodeType::Temperature), std::runtime_error);
    }
}

TEST_F(FailureTest, ThatComesBackIsReportedAgain)
{
    const LogCapture capture;
    ScriptedMachine machine;
    machine.failConstruction();
    request();
    machine.failConstruction(false);
    request();
    machine.failConstruction();
    request();
    EXPECT_THAT(textsOf(capture), SizeIs(2));
}

TEST_F(FailureTest, OfOneNodeTypeIsReportedOnceThoughTheOthersWork)
{
    const LogCapture capture;
    ScriptedMachine machine;
    machine.failSelection(NodeType::Voltage);
    request();
    request();
    EXPECT_THAT(
        textsOf(capture), ElementsAre("source \"scripted\" cannot be used: scripted: selection"));
}

TEST_F(FailureTest, OfAReadingIsReportedOnceThoughOtherNodesCanBeRead)
{
    const LogCapture capture;
    const ScriptedMachine machine({{NodeType::Voltage, "/1", "1", {}},
        {.type = NodeType::Voltage, .path = "/2", .description = "2", .failsWhenRead = true},
        {NodeType::Temperature, "/3", "3", {}}});
    request();
    request();
    EXPECT_THAT(
        textsOf(capture), ElementsAre("source \"scripted\" cannot be used: scripted: reading"));
}

TEST_F(FailureTest, WithAnotherReasonIsReported)
{
    const LogCapture capture;
    const EnvironmentVariable environment("VORN_INSTRUMENTATION", "reasons");
    std::string reason = "first";
    Testing::provideSource(
        "reasons", [&]() -> std::unique_ptr<Vorn::Source> { throw std::runtime_error(reason); });
    request();
    reason = "second";
    request();
    EXPECT_THAT(textsOf(capture), ElementsAre("source \"reasons\" cannot be used: first",
                                      "source \"reasons\" cannot be used: second"));
}

TEST_F(FailureTest, OfASettingIsReportedOnce)
{
    const LogCapture capture;
    const EnvironmentVariable environment("VORN_INSTRUMENTATION", "nonsense,");
    request();
    request();
    EXPECT_THAT(textsOf(capture), SizeIs(1));
}

} // namespace InstrumentationTests
