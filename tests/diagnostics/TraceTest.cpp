// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "diagnostics/Trace.h"

#include "diagnostics/TracedOperation.h"
#include "tests/support/LogCapture.h"

#include <gtest/gtest.h>

#include <fstream>
#include <thread>

namespace {

using namespace Vorn;
using Testing::LogCapture;
using Testing::LogLine;

const std::string component = "Nimbrel.Test";
const std::string separator(78, '=');

TEST(TraceTest, EachTypeHasItsFormat)
{
    EXPECT_STREQ(trace("Sensor_GetInstance", "f", 120, Exiting),
        "EXITING: Sensor_GetInstance() in f [Line: 120]");
    EXPECT_STREQ(trace("Sensor_GetInstance", "f", 120, Entering),
        "ENTERING: Sensor_GetInstance() in f [Line: 120]");
    EXPECT_STREQ(trace("sensor", "f", 12, Method), "METHOD: sensor() was invoked in f [Line: 12]");
    EXPECT_STREQ(trace("t", "f", 7, Message), "MESSAGE [File: f, Line: 7]: t");
}

TEST(TraceTest, TheNumbersOfTheTypesAreFixed)
{
    EXPECT_EQ(Entering, 0);
    EXPECT_EQ(Exiting, 1);
    EXPECT_EQ(Method, 2);
    EXPECT_EQ(Message, 3);
}

TEST(TraceTest, AnyOtherTypeIsAnEnteringLine)
{
    EXPECT_STREQ(trace("f", "F", 1, static_cast<MessageType>(9)), "ENTERING: f() in F [Line: 1]");
    EXPECT_STREQ(trace("f", "F", 1, static_cast<MessageType>(-1)), "ENTERING: f() in F [Line: 1]");
}

TEST(TraceTest, AParameterListFollowsEachFormat)
{
    EXPECT_STREQ(tracepara("getAllSensorCMPIInstances", "f", 162, " broker=0x1", Entering),
        "ENTERING: getAllSensorCMPIInstances() in f [Line: 162],Parameters List:  broker=0x1");
    EXPECT_STREQ(tracepara("g", "f", 1, " a=1", Exiting),
        "EXITING: g() in f [Line: 1],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("g", "f", 1, " a=1", Method),
        "METHOD: g() was invoked in f [Line: 1],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("t", "f", 7, " a=1", Message),
        "MESSAGE [File: f, Line: 7]: t,Parameters List:  a=1");
    EXPECT_STREQ(tracepara("g", "f", 1, " a=1", static_cast<MessageType>(4)),
        "ENTERING: g() in f [Line: 1],Parameters List:  a=1");
    EXPECT_STREQ(tracepara("g", "f", 1, nullptr, Entering),
        "ENTERING: g() in f [Line: 1],Parameters List: (null)");
}

TEST(TraceTest, ALongLineIsCutAndTheRestOfAShorterOneIsCleared)
{
    const std::string longText(2000, 'x');
    char* const line = trace(longText.c_str(), "f", 1, Message);
    EXPECT_EQ(std::string(line).size(), 511U);
    EXPECT_EQ(trace("t", "f", 1, Message), line);
    for (std::size_t i = std::string(line).size(); i < 512; ++i)
        ASSERT_EQ(line[i], '\0') << i;

    const char* const parameters = tracepara("t", "f", 1, longText.c_str(), Entering);
    EXPECT_EQ(std::string(parameters).size(), 511U);
}

TEST(TraceTest, LinesWithAndWithoutParametersHaveABufferEach)
{
    const char* const plain = trace("a", "f", 1, Entering);
    const char* const withParameters = tracepara("b", "f", 1, "", Entering);
    EXPECT_NE(plain, withParameters);
    EXPECT_STREQ(plain, "ENTERING: a() in f [Line: 1]");
}

TEST(TraceTest, EachThreadHasBuffersOfItsOwn)
{
    const char* const mine = trace("a", "f", 1, Entering);
    std::thread([&] { EXPECT_NE(trace("b", "f", 1, Entering), mine); }).join();
    EXPECT_STREQ(mine, "ENTERING: a() in f [Line: 1]");
}

TEST(MarksTest, TheEntryMarkIsASeparatorAndAnEnteringLine)
{
    const LogCapture capture;
    markProviderEntry(component, "Sensor_GetInstance", "SensorProvider", 192);
    const std::vector<LogLine> expected = {
        {"log", 4000, component, "markProviderEntry", "Trace", 336, separator},
        {"log", 4000, component, "markProviderEntry", "Trace", 337,
            "ENTERING: Sensor_GetInstance() in SensorProvider [Line: 192]"}};
    EXPECT_EQ(capture.log(), expected);
}

TEST(MarksTest, TheExitMarkIsAnExitingLineAndASeparator)
{
    const LogCapture capture;
    markProviderExit(component, "Sensor_GetInstance", "SensorProvider", 293);
    const std::vector<LogLine> expected = {
        {"log", 4000, component, "markProviderExit", "Trace", 348,
            "EXITING: Sensor_GetInstance() in SensorProvider [Line: 293]"},
        {"log", 4000, component, "markProviderExit", "Trace", 349, separator}};
    EXPECT_EQ(capture.log(), expected);
}

TEST(MarksTest, TheTraceChannelReceivesTheSameLinesAsTheLogChannel)
{
    const LogCapture capture;
    markProviderEntry(component, "f", "F", 1);
    traceMessage({component, "F"}, "f", 2, "failed");
    markProviderExit(component, "f", "F", 3);
    auto expected = capture.log();
    ASSERT_EQ(expected.size(), 5U);
    for (LogLine& line : expected)
        line.channel = "trace";
    EXPECT_EQ(capture.trace(), expected);
}

TEST(MarksTest, TheLogChannelReceivesALineBeforeTheTraceChannel)
{
    const Testing::TemporaryFolder folder;
    const std::filesystem::path both = folder.path() / "both";
    RynLog::configure({0, "file:" + both.string(), "file:" + both.string()});
    traceMessage({component, "F"}, "f", 2, "failed");
    RynLog::configure({6000, "off", "off"});
    std::ifstream lines(both);
    std::vector<std::string> channels;
    for (std::string time, channel, rest; lines >> time >> channel && std::getline(lines, rest);)
        channels.push_back(channel);
    EXPECT_EQ(channels, (std::vector<std::string>{"log", "trace"}));
}

TEST(TracedOperationTest, MarksCarryTheParameterListAtLevel3000)
{
    const LogCapture capture;
    const int* const nothing = nullptr;
    const TracedOperation traced({component, "F"}, "f",
        [&] { return parameterList(" isSen=", true, " isCap=", false, " ref=", nothing); });
    traced.entering(10);
    traced.exiting(20);
    const std::vector<LogLine> expected = {
        {"log", 3000, component, "f", "F", 10,
            "ENTERING: f() in F [Line: 10],Parameters List:  isSen=1 isCap=0 ref=0"},
        {"log", 3000, component, "f", "F", 20,
            "EXITING: f() in F [Line: 20],Parameters List:  isSen=1 isCap=0 ref=0"}};
    EXPECT_EQ(capture.log(), expected);
}

TEST(TracedOperationTest, PlainMarksHaveLevel4000)
{
    const LogCapture capture;
    const TracedOperation traced({component, "F"}, "f");
    traced.entering(10);
    traced.exiting(20);
    const std::vector<LogLine> expected = {
        {"log", 4000, component, "f", "F", 10, "ENTERING: f() in F [Line: 10]"},
        {"log", 4000, component, "f", "F", 20, "EXITING: f() in F [Line: 20]"}};
    EXPECT_EQ(capture.log(), expected);
}

TEST(TracedOperationTest, AMarkWithoutALineNumberCarriesItsSourceLine)
{
    const LogCapture capture;
    const TracedOperation traced({component, "F"}, "f");
    traced.entering();
    const unsigned here = __LINE__ - 1;
    ASSERT_EQ(capture.log().size(), 1U);
    EXPECT_EQ(capture.log().front().line, here);
}

TEST(TracedOperationTest, AFailureIsAMessageLineAtLevel6000)
{
    const LogCapture capture;
    traceMessage({component, "F"}, "f", 94, "getAllSensorCMPIObjPaths failed");
    const std::vector<LogLine> expected = {{"log", 6000, component, "f", "F", 94,
        "MESSAGE [File: F, Line: 94]: getAllSensorCMPIObjPaths failed"}};
    EXPECT_EQ(capture.log(), expected);
}

TEST(TracedOperationTest, AParameterListIsNotComposedWhenNobodyWantsIt)
{
    const LogCapture capture(6000);
    bool composed = false;
    const TracedOperation traced({component, "F"}, "f", [&] {
        composed = true;
        return std::string();
    });
    traced.entering();
    traced.exiting();
    EXPECT_FALSE(composed);
    EXPECT_TRUE(capture.log().empty());
}

} // namespace
