// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The properties that the providers publish, compared with the shipped classes.

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/String.h"
#include "host/manager/Manager.h"
#include "host/manager/SensorProfile.h"
#include "host/repository/TypeNames.h"
#include "tests/support/Environment.h"
#include "tests/support/ShippedClasses.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace ProvidedPropertiesTests {

using ::testing::UnorderedElementsAreArray;

constexpr const char* cimv2 = "root/cimv2";

struct ProvidedClass {
    const char* name;
    const char* nameSpace = cimv2;
};

void PrintTo(const ProvidedClass& provided, std::ostream* out)
{
    *out << provided.name;
}

class ProvidedPropertiesTest : public ::testing::TestWithParam<ProvidedClass> {
protected:
    Testing::EnvironmentVariable machine_{
        "VORN_INSTRUMENTATION", "model:" SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json"};
    std::unique_ptr<const Host::Repository> repository_ = Testing::shippedClasses();
    Host::Manager manager_{
        *repository_, Host::registeredProfileProviders(SENSOR_PROFILE_BINARY_DIR
                          "/lib/libSensorProfileProvider.so",
                          SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileComputerSystem.so")};
};

TEST_P(ProvidedPropertiesTest, AreDeclaredWithTheTypeTheyHave)
{
    const Host::ClassDeclaration& declared =
        *repository_->findClass(GetParam().nameSpace, GetParam().name);
    Host::Request request(manager_.broker());
    const auto answer = manager_.enumerateInstances(
        request.context(), request.makePath(GetParam().nameSpace, GetParam().name), nullptr);
    ASSERT_FALSE(answer.instances().empty());
    for (const Host::Instance* const instance : answer.instances()) {
        ASSERT_NE(instance->properties().size(), 0U);
        for (const Host::NamedValue& each : instance->properties()) {
            const std::string name(*each.name->text());
            const Host::PropertyDeclaration* const property = declared.property(name);
            ASSERT_NE(property, nullptr) << name;
            EXPECT_EQ(property->name, name);
            EXPECT_EQ(Host::nameOfType(property->type), Host::nameOfType(each.value.type()))
                << name;
        }
    }
}

TEST_P(ProvidedPropertiesTest, KeysOfPathsAreThoseOfTheClass)
{
    Host::Request request(manager_.broker());
    const auto answer = manager_.enumerateInstanceNames(
        request.context(), request.makePath(GetParam().nameSpace, GetParam().name));
    ASSERT_FALSE(answer.paths().empty());
    for (const Host::ObjectPath* const path : answer.paths()) {
        std::vector<std::string> keys;
        for (const Host::NamedValue& key : path->keys())
            keys.emplace_back(*key.name->text());
        EXPECT_THAT(keys,
            UnorderedElementsAreArray(*repository_->keysOf(GetParam().nameSpace, GetParam().name)));
    }
}

INSTANTIATE_TEST_SUITE_P(Classes, ProvidedPropertiesTest,
    ::testing::Values(ProvidedClass{"ZUMLO_NumericSensor"},
        ProvidedClass{"ZUMLO_SensorEnabledLogicalElementCapabilities"},
        ProvidedClass{"ZUMLO_SensorElementCapabilities"}, ProvidedClass{"ZUMLO_SensorSystemDevice"},
        ProvidedClass{"ZUMLO_ComputerSystem"},
        ProvidedClass{"ZUMLO_SensorRegisteredProfile", "root/interop"}));

} // namespace ProvidedPropertiesTests
