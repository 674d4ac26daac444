// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects of all classes, listed and fetched.

#include "platform/utilities/ProviderUtilities.h"
#include "tests/tools/ToolTest.h"
#include "tools/output/PrintableText.h"

#include <gmock/gmock.h>

namespace {

using nlohmann::json;
using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;
using namespace Testing;

const std::vector<std::string> classes = {"ZUMLO_NumericSensor", "ZUMLO_ComputerSystem",
    "ZUMLO_SensorEnabledLogicalElementCapabilities", "ZUMLO_SensorElementCapabilities",
    "ZUMLO_SensorSystemDevice"};

class ClassesTest : public ToolTest {
protected:
    Ended listed(const std::string& className, std::vector<std::string> more = {}) const
    {
        more.insert(more.begin(), {"list", className, "--model", smallModel()});
        return run(more);
    }

    json document(const std::string& className) const
    {
        const Ended ended = listed(className, {"--cim"});
        EXPECT_EQ(ended.code, 0) << ended.err;
        EXPECT_EQ(ended.err, "");
        return json::parse(ended.out);
    }

    json instances(const std::string& className) const
    {
        return document(className).at("instances");
    }

    const std::string system_ = Vorn::getSystemName();
};

TEST_F(ClassesTest, SensorsAreTheDefault)
{
    EXPECT_EQ(listed("ZUMLO_NumericSensor").out, run({"list", "--model", smallModel()}).out);
}

TEST_F(ClassesTest, KindAndProblemsNarrowTheClassOfSensors)
{
    const auto expectSame = [&](const std::vector<std::string>& options) {
        std::vector<std::string> arguments = {"list", "--model", smallModel()};
        arguments.insert(arguments.end(), options.begin(), options.end());
        const Ended named = listed("ZUMLO_NumericSensor", options);
        EXPECT_EQ(named.code, 0);
        EXPECT_EQ(named.out, run(arguments).out);
        EXPECT_NE(named.out, listed("ZUMLO_NumericSensor").out);
    };
    expectSame({"--kind", "fan"});
    expectSame({"--problems"});
}

TEST_F(ClassesTest, TableShowsWhatDistinguishesObjectsAndTheirStates)
{
    EXPECT_EQ(linesOf(listed("ZUMLO_ComputerSystem").out).front().substr(0, 4), "NAME");
    EXPECT_THAT(listed("ZUMLO_ComputerSystem").out,
        AllOf(HasSubstr("  ENABLEDSTATE  HEALTHSTATE  OPERATIONALSTATUS\n"),
            HasSubstr("  Enabled       OK           OK\n")));
    EXPECT_EQ(listed("ZUMLO_SensorEnabledLogicalElementCapabilities").out,
        "INSTANCEID\nZUMLO:SensorEnabledLogicalElementCap1\n");
}

TEST_F(ClassesTest, TableOfAnAssociationNamesBothEndsShortly)
{
    const auto lines = linesOf(listed("ZUMLO_SensorSystemDevice").out);
    ASSERT_EQ(lines.size(), 6U);
    EXPECT_THAT(lines[0], testing::MatchesRegex("GROUPCOMPONENT +PARTCOMPONENT"));
    EXPECT_THAT(lines[1], AllOf(StartsWith(system_ + " "), testing::EndsWith(" +12V:/board/in1")));
}

TEST_F(ClassesTest, TableOfASuperclassNamesEachObjectsClass)
{
    const auto lines = linesOf(listed("CIM_ManagedElement").out);
    ASSERT_EQ(lines.size(), 8U); // with the line of titles
    EXPECT_THAT(lines[0], testing::EndsWith("CLASS"));
    EXPECT_THAT(lines[7], testing::EndsWith("ZUMLO_ComputerSystem"));
}

TEST_F(ClassesTest, ClassNamesAreOfEitherCase)
{
    EXPECT_EQ(listed("zumlo_COMPUTERsystem", {"--cim"}).out,
        listed("ZUMLO_ComputerSystem", {"--cim"}).out);
}

TEST_F(ClassesTest, UnknownClassIsASelectorThatNothingMatches)
{
    const Ended ended = listed("ZUMLO_Unheard");
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "");
    EXPECT_THAT(ended.err, testing::StartsWith("sensorctl: no sensor matches \"ZUMLO_Unheard\"; "));
}

// The registration of the profile needs the namespaces of a server.
TEST_F(ClassesTest, ClassThatOnlyServersServeIsSaid)
{
    for (const std::string className : {"ZUMLO_SensorRegisteredProfile",
             "ZUMLO_SensorElementConformsToProfile", "CIM_Namespace"}) {
        const Ended ended = listed(className);
        EXPECT_EQ(ended.code, 1);
        EXPECT_EQ(ended.out, "");
        EXPECT_EQ(
            ended.err, "sensorctl: no provider serves the class " + className + " (code 7)\n");
    }
}

TEST_F(ClassesTest, SomeOptionsAreForSensors)
{
    for (const std::vector<std::string>& options : std::vector<std::vector<std::string>>{
             {"--csv"}, {"--flat"}, {"--problems"}, {"--kind", "fan"}}) {
        const Ended ended = listed("ZUMLO_ComputerSystem", options);
        EXPECT_EQ(ended.code, 2);
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err, HasSubstr(options.front() + " is for sensors"));
    }
}

TEST_F(ClassesTest, DocumentsHaveOneShape)
{
    for (const std::string& className : classes) {
        const json all = document(className);
        EXPECT_EQ(all.size(), 3U);
        EXPECT_EQ(all.at("namespace"), "root/cimv2");
        EXPECT_EQ(all.at("class"), className);
        EXPECT_FALSE(all.at("instances").empty());
        for (const json& instance : all["instances"]) {
            EXPECT_EQ(instance.size(), 2U);
            EXPECT_THAT(instance.at("path").get<std::string>(),
                StartsWith("//" + system_ + "/root/cimv2:" + className + "."));
        }
    }
}

TEST_F(ClassesTest, ReferencesAreThePathsOfTheObjectsThemselves)
{
    const json sensors = document("ZUMLO_NumericSensor");
    const json system = document("ZUMLO_ComputerSystem");
    const json links = document("ZUMLO_SensorSystemDevice");
    ASSERT_EQ(links["instances"].size(), sensors["instances"].size());
    const json& ends = links["instances"][0]["properties"];
    EXPECT_EQ(ends.at("GroupComponent"), system["instances"][0]["path"]);
    EXPECT_THAT(
        ends.at("PartComponent").get<std::string>(), HasSubstr("DeviceID=\"+12V:/board/in1\""));
}

TEST_F(ClassesTest, EveryPathThatIsListedCanBeFetched)
{
    for (const std::string& className : classes)
        for (const json& instance : instances(className)) {
            const std::string path = instance["path"];
            const Ended ended = run({"get", path, "--cim", "--model", smallModel()});
            EXPECT_EQ(ended.code, 0) << path << "\n" << ended.err;
            EXPECT_EQ(
                json::parse(ended.out), json({{"namespace", "root/cimv2"}, {"class", className},
                                            {"instances", json::array({instance})}}));
        }
}

TEST_F(ClassesTest, EveryPathThatIsListedCanBeWalkedFrom)
{
    for (const std::string& className : classes)
        for (const json& instance : instances(className)) {
            const std::string path = instance["path"];
            const Ended ended = run({"walk", path, "--model", smallModel()});
            EXPECT_EQ(ended.code, 0) << path << "\n" << ended.err;
            EXPECT_THAT(linesOf(ended.out).front(), HasSubstr("(" + className + ")"));
        }
}

TEST_F(ClassesTest, EveryReferenceThatIsListedCanBeFetched)
{
    for (const char* const className :
        {"ZUMLO_SensorElementCapabilities", "ZUMLO_SensorSystemDevice"})
        for (const json& instance : instances(className))
            for (const json& reference : instance["properties"])
                EXPECT_EQ(run({"get", reference, "--model", smallModel()}).code, 0) << reference;
}

TEST_F(ClassesTest, InstanceIdFindsTheCapabilities)
{
    const Ended ended =
        run({"get", "ZUMLO:SensorEnabledLogicalElementCap1", "--model", smallModel()});
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(ended.out, AllOf(StartsWith("ZUMLO_SensorEnabledLogicalElementCapabilities\n"),
                               HasSubstr("  InstanceID ")));
}

TEST_F(ClassesTest, CodesOfTheSystemHaveTheirMeanings)
{
    const Ended ended = run({"get", document("ZUMLO_ComputerSystem")["instances"][0]["path"]});
    EXPECT_THAT(ended.out, AllOf(HasSubstr(" 0 (Not Dedicated)\n"), HasSubstr(" 2 (Enabled)\n"),
                               HasSubstr(" 12 (Not Applicable)\n")));
}

TEST_F(ClassesTest, CodesOfTheCapabilitiesHaveTheirMeanings)
{
    EXPECT_THAT(run({"get", "ZUMLO:SensorEnabledLogicalElementCap1", "--model", smallModel()}).out,
        HasSubstr("  RequestedStatesSupported  0, 1, 2 (Enabled)\n"));
}

TEST_F(ClassesTest, PathOfNoObjectIsNotFound)
{
    for (const char* const path : {"ZUMLO_ComputerSystem.CreationClassName=\"x\",Name=\"y\"",
             "ZUMLO_NumericSensor.DeviceID=\"unheard\"",
             "root/cimv2:ZUMLO_SensorEnabledLogicalElementCapabilities.InstanceID=\"x\""}) {
        const Ended ended = run({"get", path, "--model", smallModel()});
        EXPECT_EQ(ended.code, 3) << path << ended.err;
        EXPECT_EQ(ended.out, "");
    }
}

TEST_F(ClassesTest, MistakeInAPathIsWrongUsage)
{
    for (const char* const command : {"get", "walk"}) {
        const Ended ended =
            run({command, "ZUMLO_ComputerSystem.Name=\"y", "--model", smallModel()});
        EXPECT_EQ(ended.code, 2);
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err,
            StartsWith("sensorctl: ZUMLO_ComputerSystem.Name=\"y: column 27: the quotes are not "
                       "closed"));
    }
}

TEST_F(ClassesTest, ClassWithoutObjectsIsSaid)
{
    const Ended ended = run({"list", "ZUMLO_SensorSystemDevice", "--cim", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(json::parse(ended.out).at("instances"), json::array());
    EXPECT_EQ(ended.err, "sensorctl: there are no objects of the class "
                         "ZUMLO_SensorSystemDevice\n");
}

} // namespace
