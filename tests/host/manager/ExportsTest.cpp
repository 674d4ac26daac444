// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An object manager may load the provider with RTLD_GLOBAL: any symbol that it exports beside its
// factories could replace a function of another library.

#include "tests/support/ExportedNames.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ExportsTests {

TEST(ExportsTest, AreTheSixFactoriesAndNothingElse)
{
    EXPECT_THAT(
        Testing::exportedNames(SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so"),
        testing::UnorderedElementsAre("SensorProfileProvider_Create_InstanceMI",
            "SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_InstanceMI",
            "SensorElementCapabilitiesProvider_Create_AssociationMI",
            "SensorSystemDeviceProvider_Create_InstanceMI",
            "SensorSystemDeviceProvider_Create_AssociationMI"));
}

} // namespace ExportsTests
