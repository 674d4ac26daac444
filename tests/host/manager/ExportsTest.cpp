// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The names that the provider library has in common with its process.

#include "tests/support/ExportedNames.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ExportsTests {

constexpr const char* library = SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so";

// An object manager may load the provider with RTLD_GLOBAL: any symbol that it exports beside its
// factories could replace a function of another library.
TEST(ExportsTest, AreTheSixFactoriesAndNothingElse)
{
    EXPECT_THAT(Testing::exportedNames(library),
        testing::UnorderedElementsAre("SensorProfileProvider_Create_InstanceMI",
            "SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_AssociationMI",
            "SensorSystemDeviceProvider_Create_InstanceMI",
            "SensorSystemDeviceProvider_Create_AssociationMI"));
}

TEST(ExportsTest, TheLibraryCallsNothingThatEndsTheProcess)
{
    const auto names = Testing::importedNames(library);
    EXPECT_THAT(names, testing::Contains("malloc"));
    for (const char* const name : {"exit", "_exit", "_Exit", "quick_exit"})
        EXPECT_THAT(names, testing::Not(testing::Contains(name)));
}

} // namespace ExportsTests
