// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_NumericSensor, as an object manager sends them.

#include "tests/providers/InstanceRequestsTest.h"

#include <gmock/gmock.h>

namespace SensorProviderTests {

using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_NumericSensor";
constexpr const char* noKeyText = "At least one key should be passed";

const std::vector<ScriptedNode> machine = {{NodeType::Temperature, "/p/b", "CPU", NodeReading{}},
    {NodeType::Temperature, "/p/a", "CPU", NodeReading{}},
    {NodeType::Tachometer, "/p", "Fan", NodeReading{}}};

class SensorProviderTest : public InstanceRequestsTest {
protected:
    explicit SensorProviderTest(const std::vector<ScriptedNode>& nodes = machine)
        : InstanceRequestsTest(Class, SensorProfileProvider_Create_InstanceMI, nodes)
    {
    }

    std::vector<std::string> deliveredIdentifiers() const
    {
        std::vector<std::string> identifiers;
        for (const Host::ObjectPath* const each : answer_.paths())
            identifiers.emplace_back(*each->key("DeviceID")->text());
        for (const Host::Instance* const each : answer_.instances())
            identifiers.emplace_back(*each->property("DeviceID")->text());
        return identifiers;
    }
};

class SensorlessProviderTest : public SensorProviderTest {
protected:
    SensorlessProviderTest() : SensorProviderTest({}) {}
};

// ---- EnumInstanceNames ----

TEST_F(SensorProviderTest, NamesComeOrderedAndTheResultIsClosed)
{
    expectOk(enumerateNames());
    EXPECT_THAT(deliveredIdentifiers(), ElementsAre("CPU:/p/a", "CPU:/p/b", "Fan:/p"));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(SensorProviderTest, EveryNameHasTheRequestsNamespace)
{
    expectOk(enumerateNames("root/other"));
    ASSERT_EQ(answer_.paths().size(), 3U);
    for (const Host::ObjectPath* const each : answer_.paths())
        EXPECT_EQ(each->nameSpace(), "root/other");
}

TEST_F(SensorlessProviderTest, NamesAreAnOpenEmptyAnswer)
{
    expectOk(enumerateNames());
    EXPECT_TRUE(answer_.paths().empty());
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(messages_,
        ElementsAre(BrokerMessage{1, "SensorProfileProvider", "***No instance found***"}));
}

// ---- EnumInstances ----

TEST_F(SensorProviderTest, InstancesComeOrderedAndTheResultIsClosed)
{
    expectOk(enumerate());
    EXPECT_THAT(deliveredIdentifiers(), ElementsAre("CPU:/p/a", "CPU:/p/b", "Fan:/p"));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 22U); // all but the six thresholds
}

TEST_F(SensorProviderTest, InstancesHaveTheListedPropertiesAndTheKeys)
{
    const char* properties[] = {"Name", nullptr};
    expectOk(enumerate(properties));
    ASSERT_EQ(answer_.instances().size(), 3U);
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 5U);
}

TEST_F(SensorlessProviderTest, InstancesAreAClosedEmptyAnswer)
{
    expectOk(enumerate());
    EXPECT_TRUE(answer_.instances().empty());
    EXPECT_TRUE(answer_.isDone());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(SensorProviderTest, EveryRequestHarvestsAfresh)
{
    expectOk(enumerate());
    const ScriptedMachine changed({{NodeType::Voltage, "/v", "New", NodeReading{}}});
    Host::CollectedResult second;
    Host::Result result(second);
    mi_->ft->enumerateInstances(mi_, context(), result.handle(), path(Class).handle(), nullptr);
    ASSERT_EQ(second.instances().size(), 1U);
    EXPECT_EQ(property(*second.instances()[0], "Name"), "string \"New\"");
}

// ---- GetInstance ----

TEST_F(SensorProviderTest, ADeviceIDAloneFindsItsInstance)
{
    expectOk(get({{"DeviceID", "CPU:/p/b"}}));
    EXPECT_THAT(deliveredIdentifiers(), ElementsAre("CPU:/p/b"));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 22U);
}

TEST_F(SensorProviderTest, TheOtherKeysAreNotLookedAtBesideADeviceID)
{
    expectOk(get({{"SystemName", "elsewhere"}, {"DeviceID", "Fan:/p"}}));
    EXPECT_THAT(deliveredIdentifiers(), ElementsAre("Fan:/p"));
}

TEST_F(SensorProviderTest, AnInstanceHasTheListedProperties)
{
    const char* properties[] = {"CurrentReading", nullptr};
    expectOk(get(path(Class, {{"DeviceID", "Fan:/p"}}), properties));
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 5U);
}

TEST_F(SensorProviderTest, APathWithoutADeviceIDEqualsThatOfNoInstance)
{
    // The path of an instance has all four keys, so that no path without a device identifier equals
    // it.
    expectOk(get({{"CreationClassName", Class}, {"SystemCreationClassName", "ZUMLO_ComputerSystem"},
        {"SystemName", systemName_}}));
    EXPECT_TRUE(answer_.instances().empty());
    EXPECT_TRUE(answer_.isDone());
}

} // namespace SensorProviderTests
