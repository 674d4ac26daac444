// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The manager with the real provider libraries.

#include "host/manager/SensorProfile.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "tests/support/Environment.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/ShippedClasses.h"
#include "tests/support/TemporaryFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <thread>

namespace SensorProfileTests {

using testing::HasSubstr;

const std::string sensorLibrary = SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so";
const std::string systemLibrary =
    SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileComputerSystem.so";

constexpr const char* nameSpace = "root/cimv2";
constexpr const char* model = R"({ "nodes": [
    { "type": "temperature", "path": "/board/temp1", "description": "Temp", "status": 1 },
    { "type": "tachometer", "path": "/board/fan1", "description": "Fan", "status": 1 } ] })";

class SensorProfileTest : public testing::Test {
protected:
    std::size_t count(Host::Manager& manager, const char* className)
    {
        Host::Request request(manager.broker());
        return manager
            .enumerateInstances(request.context(), request.makePath(nameSpace, className), nullptr)
            .instances()
            .size();
    }

    Testing::TemporaryFolder folder_;
    Testing::EnvironmentVariable machine_{
        "VORN_INSTRUMENTATION", "model:" + folder_.write("model.json", model)};
    const std::unique_ptr<const Host::Repository> classes_ = Testing::shippedClasses();
};

TEST_F(SensorProfileTest, EveryClassIsServed)
{
    Host::Manager manager(*classes_, Host::sensorProfileProviders(sensorLibrary, systemLibrary));
    EXPECT_EQ(count(manager, "ZUMLO_NumericSensor"), 2U);
    EXPECT_EQ(count(manager, "ZUMLO_ComputerSystem"), 1U);
    EXPECT_EQ(count(manager, "ZUMLO_SensorEnabledLogicalElementCapabilities"), 1U);
    EXPECT_EQ(count(manager, "ZUMLO_SensorElementCapabilities"), 2U);
    EXPECT_EQ(count(manager, "ZUMLO_SensorSystemDevice"), 2U);
    EXPECT_EQ(count(manager, "CIM_ManagedElement"), 4U);
    EXPECT_EQ(count(manager, "CIM_Component"), 2U);
}

TEST_F(SensorProfileTest, EveryObjectsOwnPathFindsIt)
{
    Host::Manager manager(*classes_, Host::sensorProfileProviders(sensorLibrary, systemLibrary));
    Host::Request request(manager.broker());
    for (const char* const className :
        {"CIM_ManagedElement", "CIM_Component", "CIM_ElementCapabilities"}) {
        const auto answer = manager.enumerateInstances(
            request.context(), request.makePath(nameSpace, className), nullptr);
        for (const Host::Instance* const each : answer.instances()) {
            const Host::ObjectPath& path = each->objectPath();
            const Host::Instance& found = manager.getInstance(request.context(), path, nullptr);
            EXPECT_EQ(found.objectPath().toText(), path.toText());
        }
    }
}

TEST_F(SensorProfileTest, TheSystemLeadsToItsSensorsAndBack)
{
    Host::Manager manager(*classes_, Host::sensorProfileProviders(sensorLibrary, systemLibrary));
    Host::Request request(manager.broker());
    const auto systems = manager.enumerateInstanceNames(
        request.context(), request.makePath(nameSpace, "CIM_ComputerSystem"));
    ASSERT_EQ(systems.paths().size(), 1U);
    const auto sensors = manager.associatorNames(request.context(), *systems.paths()[0],
        {.associationClass = "CIM_SystemDevice", .resultRole = "PartComponent"});
    ASSERT_EQ(sensors.paths().size(), 2U);
    const auto back = manager.associatorNames(
        request.context(), *sensors.paths()[0], {.resultClass = "CIM_System"});
    ASSERT_EQ(back.paths().size(), 1U);
    EXPECT_EQ(back.paths()[0]->className(), "ZUMLO_ComputerSystem");
}

TEST_F(SensorProfileTest, WithoutTheCompanionSensorsAreStillServed)
{
    Host::Manager manager(*classes_, Host::sensorProfileProviders(sensorLibrary, std::nullopt));
    EXPECT_EQ(count(manager, "ZUMLO_NumericSensor"), 2U);
    EXPECT_THROW(count(manager, "ZUMLO_ComputerSystem"), Host::Refusal);
}

TEST_F(SensorProfileTest, AMissingLibraryIsAFailureThatNamesIt)
{
    EXPECT_THAT(Testing::errorOf([&] {
        const Host::Manager manager(
            *classes_, Host::sensorProfileProviders(sensorLibrary, "/no/such/library.so"));
    }),
        HasSubstr("/no/such/library.so"));
}

TEST_F(SensorProfileTest, EightThreadsWalkAtOnce)
{
    Host::Manager manager(*classes_, Host::sensorProfileProviders(sensorLibrary, systemLibrary));
    std::vector<std::thread> threads;
    for (int i = 0; i < 8; ++i)
        threads.emplace_back([&] {
            for (int round = 0; round < 5; ++round) {
                EXPECT_EQ(count(manager, "CIM_ManagedElement"), 4U);
                EXPECT_EQ(count(manager, "ZUMLO_SensorSystemDevice"), 2U);
            }
        });
    for (std::thread& thread : threads)
        thread.join();
}

} // namespace SensorProfileTests
