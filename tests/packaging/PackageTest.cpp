// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The Debian packages, and the shell scripts.

#include "tests/support/ExportedNames.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace PackageTests {

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;
using namespace Testing;

const std::string packaging = SENSOR_PROFILE_SOURCE_DIR "/packaging/";

class PackagesTest : public testing::Test {
protected:
    // The packages are made with a restrictive umask.
    static void SetUpTestSuite()
    {
        const Ended ended =
            run({"-c", "umask 077 && exec \"$@\"", "sh", SENSOR_PROFILE_CPACK, "--config",
                    SENSOR_PROFILE_BINARY_DIR "/CPackConfig.cmake", "-B", folder().path().string()},
                {.program = "/bin/sh"});
        ASSERT_EQ(ended.code, 0) << ended.out << ended.err;
    }

    static const TemporaryFolder& folder()
    {
        static const TemporaryFolder folder;
        return folder;
    }

    static std::string field(const std::string& package, const std::string& name)
    {
        const std::string file = folder().path().string() + "/" + package + "_";
        const auto lines = linesOf(outputOf("dpkg-deb --field '" + file + "'*.deb " + name));
        return lines.empty() ? "" : lines[0];
    }
};

TEST_F(PackagesTest, HaveNoErrorsForLintian)
{
    const std::string complaints =
        outputOf("lintian --allow-root --fail-on error '" + folder().path().string() +
                 "'/*.deb 2>&1 && echo passed");
    EXPECT_THAT(complaints, HasSubstr("passed")) << complaints;
    EXPECT_THAT(complaints, Not(HasSubstr("E: "))) << complaints;
}

TEST_F(PackagesTest, DependOnWhatTheyLoad)
{
    const std::string provider = field("sensor-profile-provider", "Depends");
    EXPECT_THAT(provider, HasSubstr("libsensors-config"));
    EXPECT_THAT(provider, HasSubstr("libsystemd0"));
    EXPECT_THAT(provider, Not(HasSubstr("libsensors5")));
    EXPECT_THAT(provider, Not(HasSubstr("sensor-profile")));
    EXPECT_THAT(provider, Not(HasSubstr("libprometheus")));
    const std::string tool = field("sensor-profile", "Depends");
    EXPECT_THAT(tool, HasSubstr("libprometheus-cpp-core"));
    EXPECT_THAT(tool, HasSubstr("sensor-profile-provider (= " +
                                field("sensor-profile-provider", "Version") + ")"));
}

// The library and sensorctl contain a copy of libsensors, whose licence requires its source.
TEST_F(PackagesTest, NameTheSourceOfLibsensors)
{
    const std::string installed =
        outputOf("dpkg-query --show --showformat='${source:Version}' libsensors-dev");
    for (const char* const package : {"sensor-profile", "sensor-profile-provider"})
        EXPECT_EQ(field(package, "Built-Using"), "lm-sensors (= " + installed + ")");
}

TEST_F(PackagesTest, CanBeReadByEverybody)
{
    for (const char* const package : {"sensor-profile", "sensor-profile-provider"}) {
        const auto entries = linesOf(outputOf(
            "dpkg-deb --contents '" + folder().path().string() + "/" + package + "_'*.deb"));
        EXPECT_GT(entries.size(), 10U);
        for (const std::string& entry : entries)
            EXPECT_THAT(entry, testing::ContainsRegex("^(drwxr-xr-x|-rw[x-]r-[x-]r-[x-]) "));
    }
}

// Debian requires files of each package that a plain installation does not have.
TEST_F(PackagesTest, SaySomethingOfThemselves)
{
    for (const std::string package : {"sensor-profile", "sensor-profile-provider"}) {
        const std::string documents = " ./usr/share/doc/" + package + "/";
        EXPECT_THAT(outputOf("dpkg-deb --contents '" + folder().path().string() + "/" + package +
                             "_'*.deb"),
            AllOf(HasSubstr(documents + "copyright\n"), HasSubstr(documents + "changelog.gz\n"),
                HasSubstr(documents + "changelog.Debian.gz\n"),
                Not(HasSubstr(documents + "LICENSE"))));
        EXPECT_EQ(field(package, "Section"), "admin");
    }
}

TEST_F(PackagesTest, HaveTheVersionOfTheirLogOfChanges)
{
    const std::string log = contentOf(packaging + "debian/changelog");
    for (const char* const package : {"sensor-profile", "sensor-profile-provider"}) {
        const std::string version = field(package, "Version");
        EXPECT_THAT(version, testing::StartsWith(SENSOR_PROFILE_VERSION "-"));
        EXPECT_THAT(log, testing::StartsWith("sensor-profile (" + version + ") "));
    }
}

// shellcheck reads all scripts of the source tree.
TEST(ScriptsTest, AreFreeOfWarnings)
{
    const std::string complaints = outputOf(
        "cd '" SENSOR_PROFILE_SOURCE_DIR "' && "
        "grep -rlE --exclude-dir=build --exclude-dir=.git '^#!/(usr/)?bin/(env bash|bash|sh)' . | "
        "xargs shellcheck scripts/packages.sh packaging/sensorctl.bash packaging/register/*.sh "
        "2>&1 && echo passed");
    EXPECT_EQ(complaints, "passed\n");
}

} // namespace PackageTests
