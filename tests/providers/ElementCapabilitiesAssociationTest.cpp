// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests along ZUMLO_SensorElementCapabilities, from either end.

#include "tests/providers/AssociationTest.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesAssociationTests {

using namespace Testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* Class = "ZUMLO_SensorElementCapabilities";
constexpr const char* provider = "SensorElementCapabilitiesProvider";
const std::string cap = capabilitiesId;

class ElementCapabilitiesAssociationTest : public AssociationTest {
protected:
    explicit ElementCapabilitiesAssociationTest(
        const std::vector<ScriptedNode>& nodes = threeSensors)
        : AssociationTest(SensorElementCapabilitiesProvider_Create_InstanceMI,
              SensorElementCapabilitiesProvider_Create_AssociationMI, nodes, {"host"})
    {
    }

    std::vector<std::string> pairs() const
    {
        return AssociationTest::pairs("ManagedElement", "Capabilities");
    }

    // Expects the request to fail for lack of a target with the text of its operation.
    void expectNoTarget(const CMPIStatus& status, const std::string& text)
    {
        expectFailure(status, text);
        expectNothing(false);
        ASSERT_FALSE(messages_.empty());
        EXPECT_EQ(messages_.back(), (BrokerMessage{2, provider, text}));
        messages_.clear();
    }

    void expectNoTargetFrom(const Host::ObjectPath& source, const Filter& filter = {})
    {
        expectNoTarget(associators(source, filter), "Object Path is NULL in Associators.");
        expectNoTarget(associatorNames(source, filter), "Object Path is NULL in AssociatorsNames.");
    }
};

class ElementCapabilitiesWithoutSensorsTest : public ElementCapabilitiesAssociationTest {
protected:
    ElementCapabilitiesWithoutSensorsTest() : ElementCapabilitiesAssociationTest({}) {}
};

// ---- Associators ----

TEST_F(ElementCapabilitiesAssociationTest, ASensorIsAssociatedWithTheCapabilities)
{
    expectOk(associators(sensor("B:/2", "root/other"), {.associationClass = Class}));
    ASSERT_EQ(answer_.instances().size(), 1U);
    const Host::Instance& only = *answer_.instances()[0];
    EXPECT_THAT(describe(only.properties()),
        ElementsAre("InstanceID = string \"" + cap + "\"",
            "RequestedStatesSupported = [uint16 0, uint16 1, uint16 2]",
            "ElementNameEditSupported = false"));
    EXPECT_EQ(only.objectPath().toText(), capabilities("root/other").toText());
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(
        messages_, ElementsAre(BrokerMessage{1, provider, "Target Class is PhysicalPackageClass"}));
}

TEST_F(ElementCapabilitiesAssociationTest, CapabilitiesAreAssociatedWithEverySensor)
{
    expectOk(associators(capabilities(), {.associationClass = Class}));
    EXPECT_THAT(delivered(), ElementsAre("A:/1", "B:/2", "C:/3"));
    EXPECT_EQ(answer_.instances().size(), 3U);
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 22U); // all but the six thresholds
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(
        messages_, ElementsAre(BrokerMessage{1, provider, "Target Class is ComputerSystemClass"}));
}

TEST_F(ElementCapabilitiesAssociationTest, AssociatorsHaveTheListedProperties)
{
    const char* sensorList[] = {"Name", nullptr};
    expectOk(associators(capabilities(), {.properties = sensorList}));
    ASSERT_EQ(answer_.instances().size(), 3U);
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 5U);
    const char* capabilitiesList[] = {"RequestedStatesSupported", nullptr};
    expectOk(associators(sensor("A:/1"), {.properties = capabilitiesList}));
    ASSERT_EQ(answer_.instances().size(), 4U);
    EXPECT_EQ(answer_.instances()[3]->properties().size(), 2U);
}

TEST_F(ElementCapabilitiesAssociationTest, AssociatorsAreWhole)
{
    expectOk(associators(capabilities()));
    ASSERT_EQ(answer_.instances().size(), 3U);
    for (const Host::Instance* const instance : answer_.instances())
        EXPECT_GT(instance->properties().size(), 4U); // more than an object path has
}

TEST_F(ElementCapabilitiesWithoutSensorsTest, AssociatorsOfCapabilitiesAreAnOpenEmptyAnswer)
{
    expectOk(associators(capabilities()));
    expectNothing(false);
    expectOk(associators(sensor("A:/1"))); // the source need not exist
    EXPECT_THAT(delivered(), ElementsAre(cap));
}

// ---- AssociatorNames ----

TEST_F(ElementCapabilitiesAssociationTest, NamesOfAssociatorsAreThePathsOfTheFarEnds)
{
    expectOk(associatorNames(sensor("A:/1", "root/other"), {.associationClass = Class}));
    ASSERT_EQ(answer_.paths().size(), 1U);
    EXPECT_EQ(answer_.paths()[0]->toText(), capabilities("root/other").toText());
    expectOk(associatorNames(capabilities("root/other"), {.associationClass = Class}));
    ASSERT_EQ(answer_.paths().size(), 4U);
    EXPECT_THAT(delivered(), ElementsAre(cap, "A:/1", "B:/2", "C:/3"));
    EXPECT_EQ(answer_.paths()[2]->toText(), sensor("B:/2", "root/other").toText());
    EXPECT_FALSE(answer_.isDone());
}

TEST_F(ElementCapabilitiesWithoutSensorsTest, NamesOfAssociatorsAreAnOpenEmptyAnswer)
{
    expectOk(associatorNames(capabilities()));
    expectNothing(false);
}

// ---- Parameters that restrict a result and those that do not ----

TEST_F(ElementCapabilitiesAssociationTest, NoFilterButTheAssociationClassTakesPart)
{
    const Filter filter = {Class, "NOT_AClass", "Nobody", "Nowhere", nullptr};
    expectOk(associators(sensor("A:/1"), filter));
    expectOk(associatorNames(sensor("A:/1"), filter));
    expectOk(associators(
        sensor("A:/1"), {Class, CapabilitiesClass, "Capabilities", "ManagedElement", nullptr}));
    EXPECT_THAT(delivered(), ElementsAre(cap, cap, cap));
    expectOk(references(sensor("A:/1"), filter));
    expectOk(referenceNames(sensor("A:/1"), filter));
    EXPECT_EQ(answer_.instances().size(), 3U);
    EXPECT_EQ(answer_.paths().size(), 2U);
}

TEST_F(ElementCapabilitiesAssociationTest, TheSourcesKeysDoNotMatter)
{
    expectOk(associatorNames(path(SensorClass)));
    expectOk(associatorNames(path(CapabilitiesClass, {{"InstanceID", "other"}})));
    EXPECT_THAT(delivered(), ElementsAre(cap, "A:/1", "B:/2", "C:/3"));
}

TEST_F(ElementCapabilitiesAssociationTest, KeysOfOtherTypesDoNotMatterEither)
{
    Host::ObjectPath& element = path(SensorClass);
    element.addKey("DeviceID", Host::Value::integer(CMPI_uint64, 7));
    Host::ObjectPath& capability = path(CapabilitiesClass);
    capability.addKey("InstanceID", Host::Value::of(element));
    expectOk(associators(element));
    expectOk(associatorNames(capability));
    EXPECT_EQ(answer_.instances().size(), 1U);
    EXPECT_EQ(answer_.paths().size(), 3U);
    expectOk(references(element));
    expectOk(referenceNames(capability));
    EXPECT_EQ(answer_.instances().size(), 2U);
    EXPECT_EQ(answer_.paths().size(), 6U);
}

TEST_F(ElementCapabilitiesAssociationTest, AnAbsentAssociationClassIsTheProvidersOwn)
{
    expectOk(associators(sensor("A:/1")));
    expectOk(associatorNames(capabilities()));
    EXPECT_EQ(answer_.instances().size(), 1U);
    EXPECT_EQ(answer_.paths().size(), 3U);
}

// The class of the target is not that of the far end.
TEST_F(ElementCapabilitiesAssociationTest, TheOtherAssociationOfASensorLeadsNowhere)
{
    expectOk(associators(sensor("A:/1"), {.associationClass = "ZUMLO_SensorSystemDevice"}));
    expectOk(associatorNames(sensor("A:/1"), {.associationClass = "ZUMLO_SensorSystemDevice"}));
    expectNothing(false);
    EXPECT_TRUE(systems_.calls.empty());
    EXPECT_THAT(messages_,
        ElementsAre(
            BrokerMessage{1, "SensorSystemDeviceProvider", "Target Class is ComputerSystemClass"},
            BrokerMessage{1, "SensorSystemDeviceProvider", "Target Class is ComputerSystemClass"}));
}

TEST_F(ElementCapabilitiesAssociationTest, TheOtherAssociationOfASystemLeadsToTheSensors)
{
    expectOk(associatorNames(system("host"), {.associationClass = "ZUMLO_SensorSystemDevice"}));
    EXPECT_THAT(delivered(), ElementsAre("A:/1", "B:/2", "C:/3"));
}

TEST_F(ElementCapabilitiesAssociationTest, AnotherAssociationClassHasNoTarget)
{
    for (const char* const other : {"zumlo_sensorelementcapabilities",
             "ZUMLO_SENSORELEMENTCAPABILITIES", "CIM_ElementCapabilities", ""})
        expectNoTargetFrom(sensor("A:/1"), {.associationClass = other});
}

TEST_F(ElementCapabilitiesAssociationTest, AnotherSourceHasNoTarget)
{
    for (Host::ObjectPath* const source :
        {&system("host"), &path("zumlo_numericsensor"), &path(Class)}) {
        expectNoTargetFrom(*source);
        expectNoTarget(references(*source), "Object Path is NULL in References.");
        expectNoTarget(referenceNames(*source), "Object Path is NULL in ReferenceNames.");
    }
}

TEST_F(ElementCapabilitiesAssociationTest, AMissingTargetHasNoMessageWithoutABroker)
{
    SensorElementCapabilitiesProvider_Create_InstanceMI(nullptr, nullptr, nullptr);
    for (const CMPIStatus& status : {associators(sensor("A:/1")), associatorNames(sensor("A:/1")),
             references(sensor("A:/1")), referenceNames(sensor("A:/1"))}) {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(status.msg, nullptr);
    }
    EXPECT_THAT(messages_, IsEmpty());
}

// ---- References ----

TEST_F(ElementCapabilitiesAssociationTest, ReferencesOfASensorPairItWithTheCapabilities)
{
    const Host::ObjectPath& source = sensor("B:/2", "root/other");
    const char* properties[] = {"Nothing", nullptr};
    expectOk(references(source, {.properties = properties}));
    ASSERT_EQ(answer_.instances().size(), 1U);
    const Host::Instance& only = *answer_.instances()[0];
    EXPECT_THAT(describe(only.properties()), // the property list does not restrict it
        ElementsAre("ManagedElement = ref " + source.toText(),
            "Capabilities = ref " + capabilities("root/other").toText()));
    EXPECT_EQ(only.className(), Class);
    EXPECT_EQ(only.objectPath().nameSpace(), "root/other");
    EXPECT_EQ(only.objectPath().host(), systemName_);
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(
        messages_, ElementsAre(BrokerMessage{1, provider, "Target Class is PhysicalPackageClass"}));
}

TEST_F(ElementCapabilitiesAssociationTest, ReferencesOfCapabilitiesPairThemWithEverySensor)
{
    const Host::ObjectPath& source = path(CapabilitiesClass, {{"InstanceID", "as it came"}});
    expectOk(references(source));
    EXPECT_THAT(pairs(), ElementsAre("A:/1 as it came", "B:/2 as it came", "C:/3 as it came"));
    ASSERT_EQ(answer_.instances().size(), 3U);
    EXPECT_THAT(describe(answer_.instances()[0]->properties()),
        ElementsAre("ManagedElement = ref " + sensor("A:/1").toText(),
            "Capabilities = ref " + source.toText()));
    EXPECT_FALSE(answer_.isDone());
}

TEST_F(ElementCapabilitiesAssociationTest, NamesOfReferencesAreThePathsOfTheSamePairs)
{
    expectOk(referenceNames(capabilities("root/other")));
    expectOk(referenceNames(sensor("D:/4", "root/other")));
    EXPECT_THAT(pairs(), ElementsAre("A:/1 " + cap, "B:/2 " + cap, "C:/3 " + cap, "D:/4 " + cap));
    expectAssociationPaths(Class, "root/other");
    EXPECT_FALSE(answer_.isDone());
}

// Some brokers return an instance's path without its namespace.
TEST_F(ElementCapabilitiesAssociationTest, NamesOfReferencesAreGivenTheRequestsNamespace)
{
    CMPIInstanceFT functions = Host::Instance::functions;
    functions.getObjectPath = [](const CMPIInstance* instance, CMPIStatus* rc) {
        CMPIObjectPath* const path = Host::Instance::functions.getObjectPath(instance, rc);
        Host::ObjectPath::of(path)->setNameSpace(nullptr);
        return path;
    };
    const BrokerWithInstances forgetful(broker(), functions);
    SensorElementCapabilitiesProvider_Create_AssociationMI(forgetful.handle(), nullptr, nullptr);
    expectOk(referenceNames(sensor("A:/1", "root/other")));
    ASSERT_EQ(answer_.paths().size(), 1U);
    EXPECT_EQ(answer_.paths()[0]->nameSpace(), "root/other");
}

TEST_F(ElementCapabilitiesWithoutSensorsTest, ReferencesOfCapabilitiesAreAnOpenEmptyAnswer)
{
    expectOk(references(capabilities()));
    expectOk(referenceNames(capabilities()));
    expectNothing(false);
    expectOk(referenceNames(sensor("A:/1")));
    EXPECT_THAT(pairs(), ElementsAre("A:/1 " + cap));
}

} // namespace ElementCapabilitiesAssociationTests
