// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// sensor-profile-register, run from an installation, with stand-ins for the commands of the
// object managers, which record how they are called.

#pragma once

#include "tests/packaging/Installation.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <string>
#include <vector>

namespace Testing {

class RegisterTest : public ::testing::Test {
protected:
    using Lines = std::vector<std::string>;

    // The stand-ins of these commands are all there is of object managers.
    explicit RegisterTest(const Lines& commands)
    {
        for (const std::string& command : commands)
            addCommand(command);
    }

    void addCommand(const std::string& command) const
    {
        std::filesystem::create_directories(path("bin"));
        std::filesystem::create_symlink(
            SENSOR_PROFILE_SOURCE_DIR "/tests/packaging/stand-in", path("bin/" + command));
    }

    Ended runRegister(const Lines& arguments) const
    {
        return run(arguments, {.program = program_.string(),
                                  .environment = {{"PATH", path("bin") + ":/usr/bin:/bin"},
                                      {"STAND_IN", folder_.path().string()}}});
    }

    // Runs it and expects it to succeed.
    std::string mustRun(const Lines& arguments) const
    {
        const Ended ended = runRegister(arguments);
        EXPECT_EQ(ended.code, 0) << ended.err;
        EXPECT_EQ(ended.err, "");
        return ended.out;
    }

    // How the stand-ins were called since the last time this was asked.
    Lines calls() const
    {
        Lines lines = linesOf(contentOf(path("calls")));
        std::filesystem::remove(path("calls"));
        return lines;
    }

    // Of the calls from now on, the one with this number fails.
    void failAt(std::size_t number) const { folder_.write("fail-at", std::to_string(number)); }
    void failNoMore() const { std::filesystem::remove(path("fail-at")); }

    std::string path(const std::string& name) const { return (folder_.path() / name).string(); }

    static std::string library(const std::string& name)
    {
        return (movedInstallation() / "lib/cmpi" / name).string();
    }

    static std::string shared(const std::string& name)
    {
        return (movedInstallation() / "share/sensor-profile" / name).string();
    }

    TemporaryFolder folder_;

private:
    std::filesystem::path program_ = movedInstallation() / "sbin/sensor-profile-register";
};

} // namespace Testing
