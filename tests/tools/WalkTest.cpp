// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"
#include "tests/tools/ToolTest.h"
#include "tools/output/PrintableText.h"

#include <gmock/gmock.h>

#include <filesystem>

namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;
using namespace Testing;

const std::string system_ = Vorn::getSystemName();
constexpr const char* capabilities = "ZUMLO:SensorEnabledLogicalElementCap1";

class WalkTest : public ToolTest {
protected:
    Ended walked(std::vector<std::string> more = {}, const RunOptions& options = {}) const
    {
        more.insert(more.begin(), {"walk", "--model", twoSensors()});
        return run(more, options);
    }

    std::string twoSensors() const
    {
        return model(R"(
            { "type": "temperature", "path": "/cpu0/temp1", "description": "CPU 1", "status": 1 },
            { "type": "tachometer", "path": "/board/fan1", "description": "Fan", "status": 1 })");
    }
};

TEST_F(WalkTest, GoesFromTheSystemDown)
{
    const Ended ended = walked();
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(ended.out,
        system_ + " (ZUMLO_ComputerSystem)\n"
                  "|- PartComponent CPU 1:/cpu0/temp1 (ZUMLO_SensorSystemDevice)\n"
                  "|- PartComponent Fan:/board/fan1 (ZUMLO_SensorSystemDevice)\n"
                  "`- each PartComponent: Capabilities ZUMLO:SensorEnabledLogicalElementCap1 "
                  "(ZUMLO_SensorElementCapabilities)\n");
}

TEST_F(WalkTest, DrawsLinesWhereTheLocaleHasThem)
{
    for (const char* const locale : {"C.UTF-8", "de_DE.utf8"})
        EXPECT_THAT(walked({}, {.environment = {{"LC_ALL", locale}}}).out,
            HasSubstr("\n└─ each PartComponent: Capabilities "));
}

TEST_F(WalkTest, BeginsAtAnyObject)
{
    const std::string fromFan = "Fan:/board/fan1 (ZUMLO_NumericSensor)\n"
                                "|- Capabilities ZUMLO:SensorEnabledLogicalElementCap1 "
                                "(ZUMLO_SensorElementCapabilities)\n"
                                "|  `- ManagedElement CPU 1:/cpu0/temp1 "
                                "(ZUMLO_SensorElementCapabilities)\n"
                                "`- GroupComponent " +
                                system_ +
                                " (ZUMLO_SensorSystemDevice)\n"
                                "   `- PartComponent CPU 1:/cpu0/temp1 "
                                "(ZUMLO_SensorSystemDevice)\n";
    EXPECT_EQ(walked({"Fan:/board/fan1"}).out, fromFan);
    EXPECT_EQ(walked({"Fan"}).out, fromFan);
    EXPECT_THAT(walked({capabilities}).out,
        AllOf(StartsWith(std::string(capabilities) +
                         " (ZUMLO_SensorEnabledLogicalElementCapabilities)\n|- "),
            HasSubstr("\n`- each ManagedElement: GroupComponent " + system_ + " ")));
}

TEST_F(WalkTest, KindNarrowsWhereItBegins)
{
    EXPECT_EQ(walked({"*", "--kind", "fan"}).out, walked({"Fan"}).out);
    EXPECT_EQ(walked({"Fan", "--kind", "voltage"}).code, 3);
    const Ended ended = walked({"--kind", "fan"});
    EXPECT_EQ(ended.code, 2);
    EXPECT_THAT(ended.err, HasSubstr("--kind requires OBJECT"));
}

TEST_F(WalkTest, LinesFitTheWidth)
{
    const Ended ended =
        walked({"Fan"}, {.environment = {{"COLUMNS", "80"}, {"LC_ALL", "C.UTF-8"}}});
    EXPECT_THAT(ended.out, HasSubstr("…\n"));
    for (const std::string& line : linesOf(ended.out))
        EXPECT_LE(Tools::displayWidth(line), 80U) << line;
}

TEST_F(WalkTest, ColorIsThereOnlyWhenAskedFor)
{
    EXPECT_THAT(walked().out, Not(HasSubstr("\x1B[")));
    EXPECT_THAT(walked({"--color", "always"}).out, HasSubstr("\x1B[2m (ZUMLO_ComputerSystem)"));
}

TEST_F(WalkTest, ControlCharactersInNamesAreEscaped)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "a\u001b[31mb" })");
    EXPECT_THAT(run({"walk", "--model", file}).out,
        AllOf(HasSubstr(R"(a\x1B[31mb)"), Not(HasSubstr("\x1B"))));
}

TEST_F(WalkTest, MachineWithoutSensorsIsItsSystem)
{
    const Ended ended = run({"walk", "--model", model("")});
    EXPECT_EQ(ended.code, 0) << ended.err;
    EXPECT_EQ(ended.out, system_ + " (ZUMLO_ComputerSystem)\n");
}

TEST_F(WalkTest, UnknownObjectIsNotFound)
{
    const Ended ended = walked({"nothing"});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "");
    EXPECT_THAT(ended.err, testing::StartsWith("sensorctl: no sensor matches \"nothing\"; "));
}

// The tool with only the library of the sensors installed.
class WalkWithoutCompanionTest : public WalkTest {
protected:
    WalkWithoutCompanionTest()
    {
        std::filesystem::create_directory(folder_.path() / "lib");
        std::filesystem::copy(sensorLibrary, folder_.path() / "lib");
    }

    const std::string moved_ = install();
};

TEST_F(WalkWithoutCompanionTest, TheSystemIsNotServed)
{
    const Ended ended = walked({}, {.program = moved_});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.out, "");
    EXPECT_EQ(ended.err, "sensorctl: no provider serves the class ZUMLO_ComputerSystem (code 7)\n");
}

TEST_F(WalkWithoutCompanionTest, SensorsAreShownWithWhatElseThereIs)
{
    const Ended ended = walked({"Fan"}, {.program = moved_});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_THAT(ended.out, AllOf(StartsWith("Fan:/board/fan1 "), HasSubstr(capabilities),
                               Not(HasSubstr("ZUMLO_SensorSystemDevice"))));
    EXPECT_EQ(run({"list", "--model", twoSensors()}, {.program = moved_}).code, 0);
}

} // namespace
