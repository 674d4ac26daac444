// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The exports, dependencies and hardening of the installed binaries.

#include "tests/packaging/Installation.h"
#include "tests/support/ExportedNames.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <regex>
#include <set>

namespace BinariesTests {

using testing::HasSubstr;
using testing::IsSubsetOf;
using testing::Not;
using testing::UnorderedElementsAre;
using namespace Testing;

constexpr const char* sensorLibrary = "lib/cmpi/libSensorProfileProvider.so";
constexpr const char* systemLibrary = "lib/cmpi/libSensorProfileComputerSystem.so";

std::string readelf(const std::string& options, const std::string& name)
{
    return outputOf("readelf --wide " + options + " '" + installedFile(name) + "'");
}

// Returns the names of the needed libraries without versions, such as libfmt.
std::set<std::string> neededLibraries(const std::string& name)
{
    static const std::regex needed(R"(\(NEEDED\) +Shared library: \[([^.]+)\.so)");
    const std::string text = readelf("--dynamic", name);
    std::set<std::string> libraries;
    for (std::sregex_iterator each(text.begin(), text.end(), needed), end; each != end; ++each)
        libraries.insert((*each)[1]);
    return libraries;
}

class InstalledBinaryTest : public testing::TestWithParam<const char*> {};

TEST_P(InstalledBinaryTest, HasAllTheLibrariesItNeeds)
{
    const std::string libraries = outputOf("ldd '" + installedFile(GetParam()) + "' 2>&1");
    EXPECT_THAT(libraries, HasSubstr("libc.so"));
    EXPECT_THAT(libraries, Not(HasSubstr("not found")));
}

TEST_P(InstalledBinaryTest, HasAddressesThatAreFixedAtTheStartAndReadOnlyThen)
{
    EXPECT_THAT(readelf("--program-headers", GetParam()), HasSubstr("GNU_RELRO"));
    const std::string dynamic = readelf("--dynamic", GetParam());
    EXPECT_TRUE(std::regex_search(dynamic, std::regex(R"(\(FLAGS_1\) +Flags: .*\bNOW\b)")));
}

TEST_P(InstalledBinaryTest, CanLieAnywhereInMemory)
{
    EXPECT_THAT(readelf("--file-header", GetParam()), HasSubstr("DYN ("));
    EXPECT_THAT(readelf("--dynamic", GetParam()), Not(HasSubstr("TEXTREL")));
}

TEST_P(InstalledBinaryTest, HasAStackThatIsGuardedAndNotExecutable)
{
    EXPECT_THAT(readelf("--dyn-syms", GetParam()), HasSubstr("__stack_chk_fail"));
    EXPECT_TRUE(std::regex_search(readelf("--program-headers", GetParam()),
        std::regex(R"(GNU_STACK +0x\w+ 0x\w+ 0x\w+ 0x\w+ 0x\w+ RW +)")));
}

TEST_P(InstalledBinaryTest, NamesNoFoldersOfLibraries)
{
    EXPECT_THAT(readelf("--dynamic", GetParam()), Not(HasSubstr("RPATH")));
    EXPECT_THAT(readelf("--dynamic", GetParam()), Not(HasSubstr("RUNPATH")));
}

INSTANTIATE_TEST_SUITE_P(InstalledBinaries, InstalledBinaryTest,
    testing::Values("bin/sensorctl", "libexec/sensor-profile/sensorctl-collect",
        "libexec/sensor-profile/sensorctl-serve", sensorLibrary, systemLibrary));

TEST(InstalledLibraryTest, ExportsItsFactoriesAndNothingElse)
{
    EXPECT_THAT(exportedNames(installedFile(sensorLibrary)),
        UnorderedElementsAre("SensorProfileProvider_Create_InstanceMI",
            "SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_AssociationMI",
            "SensorSystemDeviceProvider_Create_InstanceMI",
            "SensorSystemDeviceProvider_Create_AssociationMI"));
    EXPECT_THAT(exportedNames(installedFile(systemLibrary)),
        UnorderedElementsAre("ComputerSystemProvider_Create_InstanceMI",
            "SensorElementConformsToProfileProvider_Create_AssociationMI",
            "SensorElementConformsToProfileProvider_Create_InstanceMI",
            "SensorRegisteredProfileProvider_Create_InstanceMI"));
}

const std::set<std::string> common = {
    "libc", "libgcc_s", "libstdc++", "libm", "ld-linux-x86-64", "ld-linux-aarch64"};

// Loading the libraries of the server takes longer than reading a few sensors.
TEST(InstalledToolTest, NeedsNothingOfTheServer)
{
    std::set<std::string> forTool = {"libfmt", "libncursesw", "libprometheus-cpp-core", "libtinfo"};
    forTool.insert(common.begin(), common.end());
    EXPECT_THAT(neededLibraries("bin/sensorctl"), IsSubsetOf(forTool));
}

// An object manager loads every library that a provider depends on.
TEST(InstalledLibraryTest, NeedsNothingOfTheServer)
{
    std::set<std::string> forSensors = {"libfmt"};
    forSensors.insert(common.begin(), common.end());
    std::set<std::string> forSystems = {"libsystemd"};
    forSystems.insert(common.begin(), common.end());
    EXPECT_THAT(neededLibraries(sensorLibrary), IsSubsetOf(forSensors));
    EXPECT_THAT(neededLibraries(systemLibrary), IsSubsetOf(forSystems));
}

} // namespace BinariesTests
