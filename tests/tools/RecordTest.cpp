// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/Umask.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <sys/stat.h>
#include <unistd.h>

namespace {

using nlohmann::json;
using testing::HasSubstr;
using namespace Testing;

class RecordTest : public ToolTest {
protected:
    std::vector<std::string> filesInFolder() const
    {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(folder_.path()))
            names.push_back(entry.path().filename().string());
        return names;
    }
};

TEST_F(RecordTest, ReplaysToTheSameOutput)
{
    const std::string original = smallModel();
    const Ended recorded = run({"record", "--model", original});
    EXPECT_EQ(recorded.code, 0);
    EXPECT_EQ(recorded.err, "");
    const std::string replay = folder_.write("replay.json", recorded.out);
    for (const std::vector<std::string>& arguments :
        std::vector<std::vector<std::string>>{{"list"}, {"list", "--cim"}, {"get", "CPU 1"}}) {
        std::vector<std::string> first = arguments;
        std::vector<std::string> second = arguments;
        first.insert(first.end(), {"--model", original});
        second.insert(second.end(), {"--model", replay});
        const Ended expected = run(first);
        EXPECT_EQ(expected.code, 0);
        EXPECT_EQ(run(second).out, expected.out);
    }
}

TEST_F(RecordTest, RecordOfARecordIsTheSame)
{
    const std::string first = run({"record", "--model", smallModel()}).out;
    EXPECT_EQ(run({"record", "--model", folder_.write("first.json", first)}).out, first);
}

TEST_F(RecordTest, WritesAFileWithTheUsualPermissions)
{
    const std::string file = (folder_.path() / "record.json").string();
    const Testing::Umask umask(0027);
    const Ended ended = run({"record", "--model", smallModel(), "-o", file});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.out, "");
    EXPECT_EQ(contentOf(file), run({"record", "--model", smallModel()}).out);
    struct stat status {};
    ASSERT_EQ(::stat(file.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0640U);
    EXPECT_THAT(filesInFolder(), testing::UnorderedElementsAre("model.json", "record.json"));
}

TEST_F(RecordTest, DashMeansStandardOutput)
{
    EXPECT_EQ(run({"record", "--model", smallModel(), "-o", "-"}).out,
        run({"record", "--model", smallModel()}).out);
}

TEST_F(RecordTest, FailureLeavesTheOldFile)
{
    const std::string file = folder_.write("record.json", "precious");
    const Ended ended = run({"record", "--model", folder_.write("bad.json", "{"), "-o", file});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(contentOf(file), "precious");
}

TEST_F(RecordTest, NamesTheFileThatCannotBeWritten)
{
    const std::string file = (folder_.path() / "absent" / "record.json").string();
    const Ended ended = run({"record", "--model", smallModel(), "-o", file});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: " + file + ": No such file or directory\n");
    const Ended full = run({"record", "--model", smallModel(), "-o", "/dev/full"});
    EXPECT_EQ(full.code, 1);
    EXPECT_EQ(full.err, "sensorctl: /dev/full: No space left on device\n");
}

TEST_F(RecordTest, MachineWithoutSensorsIsRecordedAndSaid)
{
    const Ended ended = run({"record", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(json::parse(ended.out), json({{"nodes", json::array()}}));
    EXPECT_THAT(ended.err, HasSubstr("this machine has no sensors"));
}

TEST_F(RecordTest, MachineWithoutSensorsLeavesTheOldFile)
{
    const std::string file = folder_.write("record.json", "precious");
    const Ended ended = run({"record", "--model", model(""), "-o", file});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "");
    EXPECT_THAT(ended.err, HasSubstr("this machine has no sensors"));
    EXPECT_EQ(contentOf(file), "precious");
}

TEST_F(RecordTest, MachineThatCannotBeReadIsNoEmptyRecord)
{
    const std::string file = folder_.write("record.json", "precious");
    const Ended ended = run({"record", "-o", file},
        {.environment = {{"VORN_INSTRUMENTATION", "model:/no/such/model"}}});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("/no/such/model"));
    EXPECT_EQ(contentOf(file), "precious");
}

TEST_F(RecordTest, MachineOfWhichASourceFailsIsNotRecorded)
{
    const std::string file = folder_.write("record.json", "precious");
    const std::string broken = folder_.write("broken.json", "{");
    const std::string whole = smallModel();
    for (const std::string& sources :
        {"model:" + whole + ",model:" + broken, "model:" + broken + ",model:" + whole}) {
        const RunOptions options{.environment = {{"VORN_INSTRUMENTATION", sources}}};
        const Ended ended = run({"record", "-o", file}, options);
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, HasSubstr("sensorctl: model file " + broken + ": "));
        EXPECT_EQ(contentOf(file), "precious");
        EXPECT_EQ(run({"record"}, options).out, "");
    }
}

} // namespace
