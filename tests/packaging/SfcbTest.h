// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// sfcb's stand-in, and what registering in it leaves.

#pragma once

#include "tests/packaging/RegisterTest.h"

#include <algorithm>
#include <filesystem>
#include <string>
#include <tuple>

namespace SfcbTests {

using namespace Testing;

class SfcbTest : public RegisterTest {
protected:
    SfcbTest() : RegisterTest({"sfcbstage", "sfcbrepos"}) {}

    // Returns the staged files except sfcb's own.
    Lines stage() const
    {
        Lines files = filesBelow(path("stage"));
        std::erase(files, "default.reg");
        return files;
    }

    // Returns the calls that change the staging folder; others work on a copy of it.
    Lines steps() const
    {
        Lines all = calls();
        std::erase_if(all, [this](const std::string& call) {
            return call.find(" -s " + path("stage") + " ") == call.npos;
        });
        return all;
    }

    std::string repository() const
    {
        return contentOf(path("registration/repository/root/cimv2/classes"));
    }

    void expectRefusalWithoutChange(const std::string& action, const std::string& reason) const
    {
        const auto before = std::tuple(filesBelow(path("stage")), links(), repository());
        const Ended ended = runRegister({action});
        EXPECT_EQ(ended.code, 1);
        EXPECT_THAT(ended.err, testing::AllOf(testing::HasSubstr(reason),
                                   testing::EndsWith("Nothing was changed.\n")));
        EXPECT_EQ(std::tuple(filesBelow(path("stage")), links(), repository()), before);
    }

    std::string stagedRegistration() const
    {
        return contentOf(path("stage/regs/sensor-profile.reg"));
    }

    static std::string stepOf(const std::string& stage, const std::string& nameSpace,
        const std::string& registration, const Lines& files)
    {
        std::string step = "sfcbstage -s " + stage + " -n " + nameSpace + " -r " + registration;
        for (const std::string& file : files)
            step += " " + shared(file);
        return step;
    }

    // Returns the step that stages the classes of the sensors' namespace.
    std::string stageStep(const std::string& nameSpace = "root/cimv2",
        const std::string& registration = shared("registration/sensor-profile.reg")) const
    {
        return stepOf(
            path("stage"), nameSpace, registration, {computerSystem_, sensors_, conformance_});
    }

    // Returns the step that stages those of the profile's registration.
    std::string profileStep(
        const std::string& registration = shared("registration/sensor-profile.reg")) const
    {
        return stepOf(path("stage"), "root/interop", registration, {conformance_, profile_});
    }

    // Returns the files that a registration in the namespace stages.
    static Lines staged(const std::string& nameSpace)
    {
        Lines files = {"mofs/" + nameSpace + "/" + computerSystem_,
            "mofs/" + nameSpace + "/" + conformance_, "mofs/" + nameSpace + "/" + sensors_,
            std::string("mofs/root/interop/") + conformance_,
            std::string("mofs/root/interop/") + profile_, "regs/sensor-profile.reg"};
        std::sort(files.begin(), files.end());
        return files;
    }

    std::string stagedMof(const std::string& name) const { return path("stage/mofs/" + name); }

    static constexpr const char* computerSystem_ = "sensor-profile-computer-system.mof";
    static constexpr const char* sensors_ = "sensor-profile.mof";
    static constexpr const char* conformance_ = "sensor-profile-conformance.mof";
    static constexpr const char* profile_ = "sensor-profile-registered-profile.mof";
    const std::string buildStep_ = "sfcbrepos -s " + path("stage") + " -f";
};

} // namespace SfcbTests
