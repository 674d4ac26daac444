// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <csignal>

namespace {

using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;
using namespace Testing;

class FailureTest : public ToolTest {
protected:
    std::vector<std::vector<std::string>> everyCommand() const
    {
        const std::string file = smallModel();
        return {{"list", "--model", file}, {"list", "--cim", "--model", file},
            {"get", "CPU 1", "--model", file}, {"walk", "--model", file},
            {"list", "ZUMLO_ComputerSystem", "--model", file}, {"record", "--model", file},
            {"--help"}, {"--version"}};
    }
};

TEST_F(FailureTest, FullDiskIsSaid)
{
    for (const auto& arguments : everyCommand()) {
        const Ended ended = run(arguments, {.out = RunOptions::Out::file, .outFile = "/dev/full"});
        EXPECT_EQ(ended.code, 1) << testing::PrintToString(arguments);
        EXPECT_EQ(ended.err, "sensorctl: cannot write the output: No space left on device\n");
    }
}

TEST_F(FailureTest, ClosedStandardOutputIsSaid)
{
    for (const auto& arguments : everyCommand()) {
        const Ended ended = run(arguments, {.out = RunOptions::Out::closed});
        EXPECT_EQ(ended.code, 1) << testing::PrintToString(arguments);
        EXPECT_EQ(ended.err, "sensorctl: cannot write the output: Bad file descriptor\n");
    }
}

TEST_F(FailureTest, ReaderThatGoesAwayEndsTheToolBySignal)
{
    for (const auto& arguments : everyCommand()) {
        const Ended ended = run(arguments, {.out = RunOptions::Out::abandonedPipe});
        EXPECT_EQ(ended.signal, SIGPIPE) << testing::PrintToString(arguments);
        EXPECT_EQ(ended.err, "");
    }
}

TEST_F(FailureTest, ReaderThatGoesAwayIsSaidWhereTheSignalIsIgnored)
{
    const auto before = std::signal(SIGPIPE, SIG_IGN); // inherited
    const Ended ended =
        run({"list", "--model", smallModel()}, {.out = RunOptions::Out::abandonedPipe});
    std::signal(SIGPIPE, before);
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: cannot write the output: Broken pipe\n");
}

TEST_F(FailureTest, BadModelNamesFilePlaceAndReason)
{
    const std::string file = folder_.write(
        "bad.json", R"({ "nodes": [ { "type": "voltage", "path": "/a", "description": 5 } ] })");
    for (const std::string command : {"list", "record"}) {
        const Ended ended = run({command, "--model", file});
        EXPECT_EQ(ended.code, 1);
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err,
            AllOf(StartsWith("sensorctl: "), HasSubstr(file), HasSubstr("/nodes/0/description")));
        EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
    }
}

TEST_F(FailureTest, EveryKindOfBadModelIsAFailure)
{
    const std::vector<std::string> files = {"/no/such/model.json", folder_.path().string(),
        "/dev/null", folder_.write("empty.json", ""), folder_.write("cut.json", R"({"nodes": [)"),
        folder_.write("nul.json", std::string("{\"nodes\": []}\0", 14)),
        folder_.write("array.json", "[]"),
        folder_.write("member.json", R"({"nodes": [], "more": 1})")};
    for (const std::string& file : files) {
        const Ended ended = run({"list", "--cim", "--model", file});
        EXPECT_EQ(ended.code, 1) << file;
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err, AllOf(StartsWith("sensorctl: "), HasSubstr(file)));
    }
}

TEST_F(FailureTest, InstrumentationThatCannotBeUsedIsTheReason)
{
    for (const std::vector<std::string>& arguments : std::vector<std::vector<std::string>>{{"list"},
             {"list", "--cim"}, {"list", "ZUMLO_SensorSystemDevice"}, {"get", "CPU 1"}, {"record"},
             {"walk"}, {"walk", "CPU 1"}}) {
        const Ended ended = run(
            arguments, {.environment = {{"VORN_INSTRUMENTATION", "abacus"}, {"RYNLOG_LOG", ""}}});
        EXPECT_EQ(ended.code, 1);
        EXPECT_EQ(ended.out, "");
        EXPECT_THAT(ended.err, AllOf(StartsWith("sensorctl: "), HasSubstr("\"abacus\"")));
        EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
    }
}

TEST_F(FailureTest, ASensorWithoutADescriptionTakesNoOtherOneAway)
{
    const std::string file = model(R"(
        { "type": "voltage", "path": "/board/in1", "description": "" },
        { "type": "voltage", "path": "/board/in2", "description": "12 V" },
        { "type": "temperature", "path": "/board/temp1", "description": "CPU" })");
    const Ended ended = run({"list", "--flat", "--model", file});
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(
        ended.out, AllOf(HasSubstr("\nSensor board/in1 "), HasSubstr("\n12 V "), HasSubstr("CPU")));
    EXPECT_EQ(ended.err, "");
}

TEST_F(FailureTest, LogGoesWhereItsSettingSays)
{
    const std::string log = (folder_.path() / "log").string();
    const Ended ended = run({"list"},
        {.environment = {{"VORN_INSTRUMENTATION", "abacus"}, {"RYNLOG_LOG", "file:" + log}}});
    EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
    EXPECT_THAT(contentOf(log), HasSubstr("source \"abacus\""));
}

TEST_F(FailureTest, ToolWithoutItsProviderSaysWhereItLooked)
{
    const std::string moved = install();
    const Ended ended = run({"list", "--model", smallModel()}, {.program = moved});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err,
        AllOf(StartsWith("sensorctl: libSensorProfileProvider.so is in none of "),
            HasSubstr(folder_.path().string() + "/lib/cmpi,"), HasSubstr("--provider FILE")));
}

TEST_F(FailureTest, InstalledToolFindsItsProviderByItsOwnPlace)
{
    const std::string moved = install();
    for (const char* const place : {"lib", "lib/cmpi"}) {
        std::filesystem::create_directories(folder_.path() / place);
        const auto copy = folder_.path() / place / "libSensorProfileProvider.so";
        std::filesystem::copy_file(sensorLibrary, copy);
        EXPECT_EQ(run({"list", "--model", smallModel()}, {.program = moved}).code, 0);
        std::filesystem::remove(copy);
    }
}

TEST_F(FailureTest, ToolWithoutItsClassesSaysWhichFileIsMissing)
{
    const std::string moved = install();
    std::filesystem::remove_all(folder_.path() / "share");
    const Ended ended =
        run({"list", "--model", smallModel(), "--provider", sensorLibrary}, {.program = moved});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.out, "");
    EXPECT_EQ(ended.err, "sensorctl: " + folder_.path().string() +
                             "/share/sensor-profile/host.mof: No such file or directory\n");
}

TEST_F(FailureTest, ServerThatIsNotInstalledIsNamed)
{
    const std::string moved = install();
    std::filesystem::remove_all(folder_.path() / "libexec");
    const Ended ended = run({"serve", "--model", smallModel()}, {.program = moved});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: " + moved + "-serve: No such file or directory\n");
}

TEST_F(FailureTest, ClassesThatCannotBeCompiledAreTheReason)
{
    const std::string moved = install();
    const auto file = folder_.path() / "share" / "sensor-profile" / "host.mof";
    std::ofstream(file) << "class {";
    const Ended ended =
        run({"list", "--model", smallModel(), "--provider", sensorLibrary}, {.program = moved});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.out, "");
    EXPECT_THAT(ended.err, StartsWith("sensorctl: " + file.string() + ":1:7: "));
}

TEST_F(FailureTest, ProviderOptionTakesAnyPath)
{
    const std::string relative = std::filesystem::relative(sensorLibrary).string();
    EXPECT_EQ(run({"list", "--model", smallModel(), "--provider", relative}).code, 0);
    const Ended ended = run({"list", "--model", smallModel(), "--provider", "libc.so.6"});
    EXPECT_EQ(ended.code, 1); // looked for here, not among the system libraries
    EXPECT_THAT(ended.err, HasSubstr("/libc.so.6: cannot open shared object file"));
    EXPECT_EQ(run({"walk", "--model", smallModel(), "--provider", systemLibrary}).err,
        "sensorctl: " + systemLibrary + ": no factory SensorProfileProvider_Create_InstanceMI\n");
}

} // namespace
