// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorEnabledLogicalElementCapabilities, as an object manager sends them.

#include "tests/providers/InstanceRequestsTest.h"
#include "tests/providers/ProfileClasses.h"

#include <gmock/gmock.h>

namespace CapabilitiesProviderTests {

using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* provider = "SensorEnabledLogicalElementCapabilitiesProvider";
constexpr const char* firstIdentifier = "ZUMLO:SensorEnabledLogicalElementCap1";
constexpr const char* noKeyText = "At least one key should be passed";

class CapabilitiesProviderTest : public InstanceRequestsTest {
protected:
    CapabilitiesProviderTest()
        : InstanceRequestsTest(Class,
              SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI,
              {{NodeType::Tachometer, "/f", "Fan", NodeReading{}}})
    {
    }

    void expectNothing(bool isDone)
    {
        EXPECT_TRUE(answer_.instances().empty());
        EXPECT_EQ(answer_.refused(), 0U);
        EXPECT_EQ(answer_.isDone(), isDone);
        EXPECT_TRUE(messages_.empty());
    }
};

// ---- EnumInstanceNames ----

TEST_F(CapabilitiesProviderTest, ThereIsOneNameAndTheResultIsClosed)
{
    expectOk(enumerateNames("root/other"));
    ASSERT_EQ(answer_.paths().size(), 1U);
    const Host::ObjectPath& only = *answer_.paths()[0];
    EXPECT_EQ(only.className(), Class);
    EXPECT_EQ(only.nameSpace(), "root/other");
    EXPECT_EQ(only.host(), systemName_);
    EXPECT_THAT(describe(only.keys()),
        ElementsAre("InstanceID = string \"ZUMLO:SensorEnabledLogicalElementCap1\""));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesProviderTest, AMachineWithoutSensorsOrWithABrokenOneHasItsCapabilities)
{
    const ScriptedMachine empty;
    expectOk(enumerateNames());
    EXPECT_EQ(answer_.paths().size(), 1U);
    ScriptedMachine broken;
    broken.failConstruction();
    Host::CollectedResult second;
    Host::Result into(second);
    expectOk(mi_->ft->enumerateInstanceNames(mi_, context(), into.handle(), path(Class).handle()));
    EXPECT_EQ(second.paths().size(), 1U);
}

// ---- EnumInstances ----

TEST_F(CapabilitiesProviderTest, ThereIsOneInstanceAndTheResultIsClosed)
{
    expectOk(enumerate());
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(describe(answer_.instances()[0]->properties()),
        ElementsAre("InstanceID = string \"ZUMLO:SensorEnabledLogicalElementCap1\"",
            "RequestedStatesSupported = [uint16 0, uint16 1, uint16 2]",
            "ElementNameEditSupported = false"));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesProviderTest, AnInstanceHasTheListedPropertiesAndTheKey)
{
    const char* properties[] = {"RequestedStatesSupported", nullptr};
    expectOk(enumerate(properties));
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(namesOf(answer_.instances()[0]->properties()),
        ElementsAre("InstanceID", "RequestedStatesSupported"));
}

TEST_F(CapabilitiesProviderTest, AnEmptyListLeavesTheKeyAlone)
{
    const char* properties[] = {nullptr};
    expectOk(enumerate(properties));
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(namesOf(answer_.instances()[0]->properties()), ElementsAre("InstanceID"));
}

// ---- GetInstance ----

TEST_F(CapabilitiesProviderTest, AnInstanceIsFoundByItsIdentifier)
{
    const char* properties[] = {"ElementNameEditSupported", nullptr};
    for (const char** const list : {static_cast<const char**>(nullptr), properties}) {
        Host::CollectedResult found;
        Host::Result into(found);
        expectOk(mi_->ft->getInstance(mi_, context(), into.handle(),
            path(Class, {{"InstanceID", firstIdentifier}}).handle(), list));
        ASSERT_EQ(found.instances().size(), 1U);
        EXPECT_EQ(found.instances()[0]->properties().size(), list ? 2U : 3U);
        EXPECT_TRUE(found.isDone());
    }
    EXPECT_TRUE(messages_.empty());
}

// ---- Keys that are no text, which find nothing although the machine has a sensor ----

TEST_F(CapabilitiesProviderTest, ASensorsOwnPathFindsNothingHere)
{
    broker_.setClassInformation(&Testing::profileClasses());
    expectOk(get(path("ZUMLO_NumericSensor",
        {{"CreationClassName", "ZUMLO_NumericSensor"}, {"DeviceID", "Fan:/f"},
            {"SystemCreationClassName", "ZUMLO_ComputerSystem"}, {"SystemName", systemName_}})));
    expectNothing(true);
}

} // namespace CapabilitiesProviderTests
