// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The commands of README.md that need a BMC, with the simulated one.

#include "tests/tools/collect/CollectTest.h"

#include <filesystem>

namespace CollectReadmeTests {

using CollectReadmeTest = Testing::CollectTest;

TEST_F(CollectReadmeTest, CommandsPrintWhatItShows)
{
    const std::string readme = Testing::contentOf(SENSOR_PROFILE_SOURCE_DIR "/README.md");
    const std::string start = "```text bmc\n";
    const auto begin = readme.find(start);
    ASSERT_NE(begin, std::string::npos);
    const std::string commands = readme.substr(begin + start.size());
    folder_.write("commands", "```text\n" + commands.substr(0, commands.find("```")) + "```\n");
    std::filesystem::create_symlink(Testing::sensorctl, folder_.path() / "run");
    auto environment = bmc_.environment();
    environment["COLUMNS"] = "80";
    environment["LC_ALL"] = "C.UTF-8";
    const Testing::Ended ended = Testing::run(
        {"-c", "cd " + folder_.path().string() +
                   " && exec " SENSOR_PROFILE_SOURCE_DIR "/tests/docs/run-commands commands"},
        {.program = "/bin/bash", .environment = environment});
    EXPECT_EQ(ended.code, 0) << ended.out << ended.err;
    EXPECT_THAT(ended.out, testing::HasSubstr("2 commands"));
}

} // namespace CollectReadmeTests
