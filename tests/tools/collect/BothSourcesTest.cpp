// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors of the kernel, which the real libsensors reads from a sysfs tree, beside those of a
// management controller, on a machine without settings.

#include "tests/support/MountNamespace.h"
#include "tests/support/Umask.h"
#include "tests/support/bmc/SimulatedBmc.h"
#include "tests/support/bmc/SimulatedSensor.h"
#include "tests/tools/ChildProcess.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <filesystem>
#include <optional>

namespace BothSourcesTests {

using testing::ContainsRegex;
using Testing::Ended;
using testing::HasSubstr;

struct Machine {
    Testing::BoundSysfs sysfs{"server"};
    Testing::BoundSensorsConfiguration configuration{""};
    Testing::TemporaryFolder run;
    Testing::BindMount mount{run.path(), "/run"};
    Testing::SimulatedBmc controller{Testing::emulationOf(Testing::simulatedServer())};
};

class BothSourcesTest : public Testing::MountNamespaceTest {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (IsSkipped() || HasFailure())
            return;
        machine_.emplace();
        const Testing::Umask umask(077);
        const Ended ended = Testing::run(
            {"collect", "--once"}, {.environment = machine_->controller.environment()});
        ASSERT_EQ(ended.code, 0) << ended.err;
    }

    // Returns the DeviceIDs of all sensors in alphabetical order.
    static std::vector<std::string> devices(const std::string& sources)
    {
        const Ended ended =
            Testing::run({"list", "--cim"}, {.environment = {{"VORN_INSTRUMENTATION", sources}}});
        EXPECT_EQ(ended.err, "");
        std::vector<std::string> found;
        const auto document = nlohmann::json::parse(ended.out);
        for (const auto& instance : document.at("instances"))
            found.push_back(instance.at("properties").at("DeviceID"));
        std::sort(found.begin(), found.end());
        return found;
    }

    std::optional<Machine> machine_;
};

TEST_F(BothSourcesTest, EachDeviceIsThereOnceByDefault)
{
    const std::vector<std::string> ofKernel = devices("hwmon");
    const std::vector<std::string> ofController = devices("ipmi");
    EXPECT_GT(ofKernel.size(), 10U);
    EXPECT_GT(ofController.size(), 40U);
    std::vector<std::string> both;
    std::merge(ofKernel.begin(), ofKernel.end(), ofController.begin(), ofController.end(),
        std::back_inserter(both));
    EXPECT_EQ(std::adjacent_find(both.begin(), both.end()), both.end());
    EXPECT_EQ(devices(""), both);
    EXPECT_EQ(devices("ipmi,hwmon,ipmi:/run/sensor-profile/ipmi.json"), both);
}

TEST_F(BothSourcesTest, ListHasAGroupForEachChipAndForTheController)
{
    const Ended ended = Testing::run({"list", "--color=never"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_THAT(ended.out, HasSubstr("\ncoretemp-isa-0000"));
    EXPECT_THAT(ended.out, ContainsRegex("\nipmi +\\(read [0-9]+ s ago\\)\n"));
    EXPECT_THAT(ended.out, ContainsRegex("\n  CPU1 Temp +58 "));
    // Whatever the umask, everybody can enter the folder.
    EXPECT_EQ(
        std::filesystem::status("/run/sensor-profile").permissions(), std::filesystem::perms(0755));
}

TEST_F(BothSourcesTest, AFileThatCannotBeReadTakesNoSensorsOfTheKernelAway)
{
    machine_->run.write("sensor-profile/ipmi.json", "{");
    const std::string reason = "model file /run/sensor-profile/ipmi.json: line 1, column 2";
    const Ended list = Testing::run({"list"}, {.environment = {{"RYNLOG_LOG", ""}}});
    EXPECT_EQ(list.code, 0);
    EXPECT_THAT(list.out, HasSubstr("\ncoretemp-isa-0000"));
    EXPECT_THAT(list.err, HasSubstr("source \"ipmi\" cannot be used: " + reason));
    const Ended check = Testing::run({"check", "coretemp-isa-0000"});
    EXPECT_EQ(check.code, 3);
    EXPECT_THAT(check.out, testing::StartsWith("SENSORS UNKNOWN - " + reason));
}

} // namespace BothSourcesTests
