// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// `check` under Icinga 2, with the configuration that the manual page shows.

#include "tests/support/Requirement.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using testing::HasSubstr;
using testing::StartsWith;
using namespace Testing;

class IcingaTest : public ToolTest {
protected:
    void SetUp() override
    {
        if (!std::filesystem::exists("/usr/sbin/icinga2"))
            cannotRun("there is no Icinga 2 (package icinga2)");
    }

    // Returns the objects of the manual page, with this build's tool and the machine of a test.
    std::string example() const
    {
        const std::string page = contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/man/sensorctl.1");
        const std::size_t begin = page.find("object CheckCommand");
        std::string text = page.substr(begin, page.find(".Ed", begin) - begin);
        text = replaced(text, "/usr/bin/sensorctl", sensorctl);
        text = replaced(text, "/etc/icinga2/machine.json", smallModel());
        return replaced(text, "check_command =", "check_interval = 1s\n  check_command =");
    }

    // Runs Icinga in this test's folder, as this user, by a command of the shell that ends with
    // other words.
    Ended icinga(const std::string& objects, const std::string& zone, const std::string& rest) const
    {
        folder_.write("check.conf", objects);
        std::string command = "cd " + folder_.path().string() +
                              "; setsid icinga2 daemon -D RunAsUser=$(id -un) "
                              "-D RunAsGroup=$(id -gn) -D HostZone=" +
                              zone +
                              " -c " SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/icinga2.conf";
        for (const char* const kind : {"Data", "Log", "Cache", "InitRun", "Spool"})
            command += std::string(" -D ") + kind + "Dir=" + folder_.path().string();
        return run({"-c", command + rest},
            {.program = "/bin/bash",
                .environment = {{"VORN_INSTRUMENTATION", "model:" + smallModel()}}});
    }
};

TEST_F(IcingaTest, ExampleOfTheManualIsValid)
{
    const Ended ended = icinga(example(), "server", " --validate");
    EXPECT_EQ(ended.code, 0) << ended.out;
    EXPECT_THAT(ended.out, HasSubstr("Instantiated 1 Service.\n"));
}

TEST_F(IcingaTest, UnderstandsStatusAndPerformanceData)
{
    // An agent needs certificates, so that the host is checked without one.
    const std::string objects = replaced(example(), "command_endpoint = host.name\n",
        "vars.sensors_problems = true\n  vars.sensors_selectors = [ \"cpu0\", \"cpu1\", \"+12V\" "
        "]\n");
    const Ended ended = icinga(objects, "",
        " >log & while kill -0 $! && ((SECONDS < 30)); do sleep 0.1; "
        "grep --no-filename . service.[0-9]* && break; done || cat log; kill -KILL -- -$!");
    EXPECT_THAT(ended.out, StartsWith("CRITICAL SENSORS CRITICAL - cpu1/CPU 2: Critical high"));
    EXPECT_THAT(ended.out, HasSubstr(" - 2 sensors: 1 warning, 1 critical."));
    EXPECT_THAT(ended.out, HasSubstr(" | board/+12V=12.75V;"));
}

} // namespace
