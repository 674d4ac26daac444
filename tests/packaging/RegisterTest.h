// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Fixtures that run sensor-profile-register from an installation, with stand-ins for the commands
// of the object managers, which record their calls.

#pragma once

#include "tests/packaging/Installation.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

namespace Testing {

class RegisterTest : public ::testing::Test {
protected:
    using Lines = std::vector<std::string>;

    // No other commands of object managers than these are found.
    explicit RegisterTest(const Lines& commands)
    {
        for (const char* const name : {"providers", "stage", "CIM"})
            std::filesystem::create_directory(path(name));
        folder_.write("stage/default.reg", "");
        folder_.write("CIM/CIM_Schema.mof", "");
        for (const std::string& command : commands)
            addCommand(command);
    }

    void addCommand(const std::string& command) const
    {
        std::filesystem::create_directories(path("bin"));
        std::filesystem::create_symlink(
            SENSOR_PROFILE_SOURCE_DIR "/tests/packaging/stand-in", path("bin/" + command));
    }

    // Runs the command with the stand-ins in PATH.
    Ended runWords(const Lines& words) const
    {
        return run({words.begin() + 1, words.end()},
            {.program = words.at(0),
                .environment = {{"PATH", path("bin") + ":/usr/bin:/bin"},
                    {"STAND_IN", folder_.path().string()}}});
    }

    // Runs it with the folders of the machine unless the arguments name others.
    Ended runAsTyped(Lines arguments) const
    {
        arguments.insert(arguments.begin(), program_);
        return runWords(arguments);
    }

    // Runs it with folders of the test's own, since the machine may have object managers.
    Ended runRegister(Lines arguments) const
    {
        arguments.insert(arguments.begin(),
            {"--provider-folder", path("providers"), "--staging-folder", path("stage")});
        return runAsTyped(arguments);
    }

    // Runs it and expects it to succeed.
    std::string mustRun(const Lines& arguments) const { return succeeding(runRegister(arguments)); }

    // Returns the output of a dry run with the folders of the machine.
    std::string plan(Lines arguments) const
    {
        arguments.emplace_back("--dry-run");
        return succeeding(runAsTyped(arguments));
    }

    // Runs the command that is between two texts in a message, and expects it to succeed.
    void mustRunAdvice(
        const std::string& message, const std::string& before, const std::string& after) const
    {
        const std::string start = before + program_ + " ";
        const auto begin = message.find(start);
        ASSERT_NE(begin, std::string::npos) << message;
        std::istringstream command(message.substr(begin + start.size(),
            message.find(after, begin + start.size()) - begin - start.size()));
        const Lines words(std::istream_iterator<std::string>(command), {});
        succeeding(runAsTyped(words));
    }

    // Returns the calls of the stand-ins and clears their record.
    Lines calls() const
    {
        Lines lines = linesOf(contentOf(path("calls")));
        std::filesystem::remove(path("calls"));
        return lines;
    }

    // Makes the stand-in with this number among the following calls fail.
    void failAt(std::size_t number) const { folder_.write("fail-at", std::to_string(number)); }
    void failNoMore() const { std::filesystem::remove(path("fail-at")); }

    std::string path(const std::string& name) const { return (folder_.path() / name).string(); }

    Lines links() const { return filesBelow(path("providers")); }

    std::string linkStep(const std::string& name) const
    {
        return "ln -s " + library(name) + " " + path("providers/" + name);
    }

    std::string unlinkStep(const std::string& name) const
    {
        return "rm " + path("providers/" + name);
    }

    // Makes the link of a registration by 0.2, whose target an upgrade deletes.
    void addFormerLink() const
    {
        std::filesystem::create_symlink(library("libComputerSystemProvider.so"),
            path("providers/libComputerSystemProvider.so"));
    }

    // Returns the beginning of the message when the step after the first `done` ones fails.
    static std::string failureAt(std::size_t done, const Lines& steps)
    {
        std::string message =
            "failed with exit code 7: " + steps.at(done) + "\nIt may have done part of its work" +
            (done == 0 ? "; nothing was done before it.\n" : ". Done before it:\n");
        for (std::size_t i = 0; i < done; ++i)
            message += "  " + steps[i] + "\n";
        return message + "To undo it: ";
    }

    // Returns the path of an installed library, or of the folder of libraries.
    static std::string library(const std::string& name = "")
    {
        return installedFile("lib/cmpi" + (name.empty() ? "" : "/" + name));
    }

    static std::string shared(const std::string& name)
    {
        return installedFile("share/sensor-profile/" + name);
    }

    TemporaryFolder folder_;
    const std::string program_ = installedFile("sbin/sensor-profile-register");
    static constexpr const char* sensorLibrary_ = "libSensorProfileProvider.so";
    static constexpr const char* systemLibrary_ = "libSensorProfileComputerSystem.so";

private:
    static std::string succeeding(const Ended& ended)
    {
        EXPECT_EQ(ended.code, 0) << ended.err;
        EXPECT_EQ(ended.err, "");
        return ended.out;
    }
};

// A fixture in which the step of the parameter fails.
template <typename ObjectManager>
class EveryStepOf : public ObjectManager, public ::testing::WithParamInterface<std::size_t> {
protected:
    using Lines = typename ObjectManager::Lines;

    EveryStepOf()
    {
        this->addCommand("ln");
        this->addCommand("rm");
    }

    // Runs it and expects a message that lists the steps before the failure. `callsBefore` is the
    // number of the stand-ins' calls before the first step.
    std::string failing(std::size_t callsBefore, const Lines& arguments, const Lines& steps)
    {
        const std::size_t done = this->GetParam();
        this->calls();
        this->failAt(callsBefore + done + 1);
        const Ended ended = this->runRegister(arguments);
        this->failNoMore();
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, ::testing::HasSubstr(this->failureAt(done, steps)));
        return ended.err;
    }
};

} // namespace Testing
