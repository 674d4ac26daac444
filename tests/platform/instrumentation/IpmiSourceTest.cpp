// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/ipmi/IpmiSource.h"
#include "platform/instrumentation/machinefile/MachineFile.h"
#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"
#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"
#include "tests/support/LogCapture.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>

#include <filesystem>

namespace IpmiSourceTests {

using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using Testing::SeenNode;
using testing::SizeIs;
using Testing::walk;
using Vorn::MachineFile;
using Vorn::Renewal;
using Vorn::secondsSinceStart;

class IpmiSourceTest : public testing::Test {
protected:
    std::string file() const { return (folder_.path() / "ipmi.json").string(); }

    void write(const std::optional<Renewal>& renewal) const
    {
        MachineFile file{{{.type = Vorn::NodeLexicon::NodeType::Temperature,
                             .path = "/ipmi/20/0/1",
                             .description = "CPU",
                             .sensorType = 22,
                             .values = {.status = 1,
                                 .reading = 41.5,
                                 .upperCritical = 95,
                                 .possibleStates = {{1, 26}}}}},
            renewal};
        folder_.write("ipmi.json.new", Vorn::writeMachineFile(file));
        std::filesystem::rename(folder_.path() / "ipmi.json.new", folder_.path() / "ipmi.json");
    }

    SeenNode seen() const { return walk().at(0); }

    Testing::TemporaryFolder folder_;
    Testing::EnvironmentVariable environment_{"VORN_INSTRUMENTATION", "ipmi:" + file()};
};

TEST_F(IpmiSourceTest, WithoutAFileThereAreNoNodes)
{
    EXPECT_THAT(walk(), IsEmpty());
}

TEST_F(IpmiSourceTest, ServesTheFileForThreePeriods)
{
    for (const double age : {0.0, 20.0, 29.0}) {
        write(Renewal{.period = 10, .time = secondsSinceStart() - age});
        EXPECT_EQ(seen().values.reading, 41.5) << age;
        EXPECT_EQ(seen().values.status, 1U) << age;
    }
}

TEST_F(IpmiSourceTest, AnOutdatedFileHasLostItsSensors)
{
    // The time of a file from before the machine started lies in the future, too.
    for (const double age : {30.5, 1e6, -5.0}) {
        write(Renewal{.period = 10, .time = secondsSinceStart() - age});
        const SeenNode node = seen();
        EXPECT_EQ(node.values.status, 13U) << age;
        EXPECT_EQ(node.values.reading, std::nullopt) << age;
        EXPECT_EQ(node.values.upperCritical, 95) << age;
        EXPECT_EQ(node.values.possibleStates, (std::vector<unsigned>{1, 26})) << age;
    }
}

TEST_F(IpmiSourceTest, AFileThatCannotBeUsedIsReportedOnceAndTakesNoOtherSensorsAway)
{
    const std::string model = folder_.write("model.json",
        R"({"nodes":[{"type":"temperature","path":"/t","description":"Other","reading":7}]})");
    const Testing::EnvironmentVariable both(
        "VORN_INSTRUMENTATION", "ipmi:" + file() + ",model:" + model);
    const Testing::LogCapture capture;
    write(std::nullopt);
    for (int request = 0; request < 3; ++request)
        EXPECT_THAT(walk(), SizeIs(1));
    ASSERT_THAT(capture.log(), SizeIs(1));
    EXPECT_THAT(capture.log().at(0).text,
        AllOf(HasSubstr(file()), HasSubstr("does not say when the sensors were read")));
    folder_.write("ipmi.json", "{");
    EXPECT_THAT(walk(), SizeIs(1));
    EXPECT_THAT(capture.log(), SizeIs(2));
}

TEST_F(IpmiSourceTest, StandsBesideOtherSources)
{
    write(Renewal{.period = 10, .time = secondsSinceStart()});
    const std::string model = folder_.write("model.json",
        R"({"nodes":[{"type":"temperature","path":"/t","description":"Other","reading":7}]})");
    const Testing::EnvironmentVariable both(
        "VORN_INSTRUMENTATION", "model:" + model + ",ipmi:" + file());
    EXPECT_THAT(walk(), SizeIs(2));
    EXPECT_EQ(Testing::nodeAt(walk(), "/t").values.reading, 7);
    EXPECT_EQ(Testing::nodeAt(walk(), "/ipmi/20/0/1").values.reading, 41.5);
}

TEST_F(IpmiSourceTest, TheTimeOfAFileIsReadAsItWasWritten)
{
    const Renewal renewal{.period = 10.5, .time = 123456.789012345};
    write(renewal);
    EXPECT_EQ(Vorn::readMachineFile(Testing::contentOf(file())).renewal, renewal);
    const std::pair<const char*, const char*> documents[] = {
        {R"({"nodes":[],"period":1})", "the document: member \"time\" is missing"},
        {R"({"nodes":[],"time":1})", "the document: member \"period\" is missing"},
        {R"({"nodes":[],"time":1,"time":1})", "/time: the member is there twice"},
        {R"({"period":1,"time":1})", "the document: member \"nodes\" is missing"},
        {R"({"nodes":[],"period":"1","time":1})",
            "/period: expected a number, found the string \"1\""},
        {R"({"nodes":[],"period":0,"time":1})", "/period: the period is not above 0"},
        {R"({"nodes":[],"period":-1.5,"time":1})", "/period: the period is not above 0"}};
    for (const auto& [document, error] : documents)
        EXPECT_EQ(Testing::errorOf([&text = document] { Vorn::readMachineFile(text); }), error);
}

} // namespace IpmiSourceTests
