// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The exports of the library, and its unloading.

#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "host/manager/ProviderLibrary.h"
#include "tests/support/ExportedNames.h"
#include "tests/support/ProcessState.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ComputerSystemLibraryTests {

const std::string library = SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileComputerSystem.so";

TEST(ComputerSystemLibraryTest, ExportsItsFactoriesAndNothingElse)
{
    EXPECT_THAT(Testing::exportedNames(library),
        testing::UnorderedElementsAre("ComputerSystemProvider_Create_InstanceMI",
            "SensorElementConformsToProfileProvider_Create_AssociationMI",
            "SensorElementConformsToProfileProvider_Create_InstanceMI",
            "SensorRegisteredProfileProvider_Create_InstanceMI"));
}

TEST(ComputerSystemLibraryTest, IsUsedAndUnloadedOverAndOver)
{
    for (int use = 0; use < 20; ++use) {
        Host::Broker broker;
        Host::ProviderLibrary loaded(broker, library);
        Host::Request request(broker);
        CMPIInstanceMI& mi = loaded.createInstanceMI("ComputerSystemProvider");
        Host::CollectedResult answer;
        Host::Result result(answer);
        const CMPIStatus status =
            mi.ft->enumerateInstances(&mi, request.context().handle(), result.handle(),
                request.makePath("root/cimv2", "ZUMLO_ComputerSystem").handle(), nullptr);
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(answer.instances().size(), 1U);
        EXPECT_TRUE(Testing::isMapped(library));
    }
    EXPECT_FALSE(Testing::isMapped(library));
}

} // namespace ComputerSystemLibraryTests
