// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests along ZUMLO_SensorSystemDevice, from either end.

#include "tests/providers/AssociationTest.h"

#include <gmock/gmock.h>

namespace SystemDeviceAssociationTests {

using namespace Testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* Class = "ZUMLO_SensorSystemDevice";
constexpr const char* provider = "SensorSystemDeviceProvider";
const BrokerMessage leadsToSensors = {1, provider, "Target Class is PhysicalPackageClass"};
const BrokerMessage leadsToSystems = {1, provider, "Target Class is ComputerSystemClass"};

class SystemDeviceAssociationTest : public AssociationTest {
protected:
    explicit SystemDeviceAssociationTest(const std::vector<ScriptedNode>& nodes = threeSensors,
        const std::vector<std::string>& systems = {"host", "guest"})
        : AssociationTest(SensorSystemDeviceProvider_Create_InstanceMI,
              SensorSystemDeviceProvider_Create_AssociationMI, nodes, systems)
    {
    }

    std::vector<std::string> pairs() const
    {
        return AssociationTest::pairs("GroupComponent", "PartComponent");
    }

    // Returns the number of objects that a request with this result class returns.
    std::size_t countOf(const Host::ObjectPath& source, const char* resultClass, bool wantsPaths)
    {
        Host::CollectedResult found;
        Host::Result into(found);
        const auto& functions = *associationMI_->ft;
        const CMPIStatus status =
            wantsPaths ? functions.associatorNames(associationMI_, context(), into.handle(),
                             source.handle(), Class, resultClass, "Nobody", "Nowhere")
                       : functions.associators(associationMI_, context(), into.handle(),
                             source.handle(), Class, resultClass, "Nobody", "Nowhere", nullptr);
        expectOk(status);
        EXPECT_EQ(found.refused(), 0U);
        EXPECT_FALSE(found.isDone());
        return found.paths().size() + found.instances().size();
    }

    void expectCount(const Host::ObjectPath& source, const char* resultClass, std::size_t expected)
    {
        for (const bool wantsPaths : {false, true})
            EXPECT_EQ(countOf(source, resultClass, wantsPaths), expected)
                << (resultClass ? resultClass : "(null)");
    }
};

class SystemDeviceWithoutSensorsTest : public SystemDeviceAssociationTest {
protected:
    SystemDeviceWithoutSensorsTest() : SystemDeviceAssociationTest({}) {}
};

class SystemDeviceWithoutSystemsTest : public SystemDeviceAssociationTest {
protected:
    SystemDeviceWithoutSystemsTest() : SystemDeviceAssociationTest(threeSensors, {}) {}
};

// ---- Associators ----

TEST_F(SystemDeviceAssociationTest, ASensorIsAssociatedWithEverySystem)
{
    systems_.nameSpace = "root/elsewhere";
    const char* properties[] = {"Name", nullptr};
    expectOk(associators(
        sensor("B:/2", "root/other"), {.associationClass = Class, .properties = properties}));
    EXPECT_THAT(delivered(), ElementsAre("host", "guest"));
    ASSERT_EQ(answer_.instances().size(), 2U);
    EXPECT_EQ(answer_.instances()[0]->className(), SystemClass);
    EXPECT_EQ(answer_.instances()[0]->objectPath().nameSpace(), "root/elsewhere"); // unchanged
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(messages_, ElementsAre(leadsToSystems));
    ASSERT_EQ(systems_.calls.size(), 1U);
    EXPECT_EQ(systems_.calls[0].operation, "enumerateInstances");
    EXPECT_EQ(systems_.calls[0].path, "//" + systemName_ + "/root/other:ZUMLO_ComputerSystem");
    EXPECT_EQ(systems_.calls[0].context, context());
    EXPECT_FALSE(systems_.calls[0].hasPropertyList);
}

TEST_F(SystemDeviceAssociationTest, ASystemIsAssociatedWithEverySensor)
{
    const char* properties[] = {"Name", nullptr};
    expectOk(associators(system("any", "root/other"), {.associationClass = Class}));
    expectOk(associators(path(SystemClass), {.properties = properties}));
    EXPECT_THAT(delivered(), ElementsAre("A:/1", "B:/2", "C:/3", "A:/1", "B:/2", "C:/3"));
    ASSERT_EQ(answer_.instances().size(), 6U);
    EXPECT_EQ(answer_.instances()[0]->properties().size(), 22U); // all but the six thresholds
    EXPECT_EQ(answer_.instances()[0]->objectPath().toText(), sensor("A:/1", "root/other").toText());
    EXPECT_EQ(answer_.instances()[3]->properties().size(), 5U);
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(messages_, ElementsAre(leadsToSensors, leadsToSensors));
    EXPECT_TRUE(systems_.calls.empty());
}

// ---- AssociatorNames ----

TEST_F(SystemDeviceAssociationTest, NamesOfASensorsAssociatorsAreTheSystemsAsTheyCame)
{
    systems_.nameSpace = "root/elsewhere";
    expectOk(associatorNames(sensor("B:/2"), {.associationClass = Class}));
    ASSERT_EQ(answer_.paths().size(), 2U);
    EXPECT_EQ(answer_.paths()[0]->toText(), system("host", "root/elsewhere").toText());
    EXPECT_EQ(answer_.paths()[1]->toText(), system("guest", "root/elsewhere").toText());
    EXPECT_FALSE(answer_.isDone());
    ASSERT_EQ(systems_.calls.size(), 1U);
    EXPECT_EQ(systems_.calls[0].operation, "enumerateInstanceNames");
    EXPECT_EQ(systems_.calls[0].path, "//" + systemName_ + "/root/cimv2:ZUMLO_ComputerSystem");
    EXPECT_EQ(systems_.calls[0].context, context());
}

TEST_F(SystemDeviceAssociationTest, NamesOfASystemsAssociatorsAreTheSensors)
{
    expectOk(associatorNames(system("any", "root/other")));
    ASSERT_EQ(answer_.paths().size(), 3U);
    EXPECT_THAT(delivered(), ElementsAre("A:/1", "B:/2", "C:/3"));
    EXPECT_EQ(answer_.paths()[0]->toText(), sensor("A:/1", "root/other").toText());
    EXPECT_FALSE(answer_.isDone());
}

TEST_F(SystemDeviceWithoutSensorsTest, ASystemsAssociatorsAreAnOpenEmptyAnswer)
{
    expectOk(associators(system("host")));
    expectOk(associatorNames(system("host")));
    expectNothing(false);
}

TEST_F(SystemDeviceWithoutSystemsTest, ASensorsAssociatorsAreAnOpenEmptyAnswer)
{
    expectOk(associators(sensor("A:/1")));
    expectOk(associatorNames(sensor("A:/1")));
    expectNothing(false);
}

// ---- The result class ----

TEST_F(SystemDeviceAssociationTest, TheResultClassIsThatOfSystemsOrTheStandardOne)
{
    for (const char* const wanted :
        {static_cast<const char*>(nullptr), "ZUMLO_ComputerSystem", "CIM_ComputerSystem",
            "zumlo_computersystem", "cim_computersystem", "CIM_COMPUTERSYSTEM"})
        expectCount(sensor("A:/1"), wanted, 2);
    systems_.calls.clear();
    for (const char* const other : {"", "CIM_LogicalDevice", "CIM_System", "CIM_NumericSensor",
             "ZUMLO_NumericSensor", "CIM_ComputerSystem ", "CIM_ComputerSyste"})
        expectCount(sensor("A:/1"), other, 0);
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceAssociationTest, TheResultClassIsThatOfSensorsOrTheStandardOne)
{
    for (const char* const wanted : {static_cast<const char*>(nullptr), "ZUMLO_NumericSensor",
             "CIM_NumericSensor", "zumlo_numericsensor", "cim_numericsensor", "CIM_NUMERICSENSOR"})
        expectCount(system("host"), wanted, 3);
    for (const char* const other : {"", "CIM_Sensor", "CIM_LogicalDevice", "CIM_ComputerSystem",
             "ZUMLO_ComputerSystem", "CIM_NumericSensor ", "CIM_NumericSenso"})
        expectCount(system("host"), other, 0);
}

// ---- The source and the association class ----

TEST_F(SystemDeviceAssociationTest, KeysOfOtherTypesDoNotMatter)
{
    Host::ObjectPath& part = path(SensorClass);
    part.addKey("DeviceID", Host::Value::integer(CMPI_uint64, 7));
    Host::ObjectPath& group = path(SystemClass);
    group.addKey("Name", Host::Value::of(part));
    for (const bool wantsPaths : {false, true}) {
        EXPECT_EQ(countOf(part, nullptr, wantsPaths), 2U);
        EXPECT_EQ(countOf(group, nullptr, wantsPaths), 3U);
    }
    expectOk(references(part));
    expectOk(referenceNames(group));
    EXPECT_EQ(answer_.instances().size(), 2U);
    EXPECT_EQ(answer_.paths().size(), 3U);
}

TEST_F(SystemDeviceAssociationTest, WithoutATargetTheAnswerIsEmptyOpenAndOk)
{
    for (const char* const other : {"zumlo_sensorsystemdevice", "CIM_SystemDevice", ""}) {
        expectOk(associators(sensor("A:/1"), {.associationClass = other}));
        expectOk(associatorNames(system("host"), {.associationClass = other}));
    }
    for (Host::ObjectPath* const source : {&capabilities(), &path("zumlo_numericsensor")}) {
        expectOk(associators(*source));
        expectOk(associatorNames(*source));
    }
    expectNothing(false);
    EXPECT_THAT(messages_, IsEmpty());
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceAssociationTest, TheOtherAssociationOfASensorLeadsNowhere)
{
    const Filter other = {.associationClass = "ZUMLO_SensorElementCapabilities"};
    expectOk(associators(sensor("A:/1"), other));
    expectOk(associatorNames(sensor("A:/1"), other));
    expectNothing(false);
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceAssociationTest, TheOtherAssociationOfCapabilitiesLeadsToTheSensors)
{
    expectOk(
        associatorNames(capabilities(), {.associationClass = "ZUMLO_SensorElementCapabilities"}));
    EXPECT_THAT(delivered(), ElementsAre("A:/1", "B:/2", "C:/3"));
}

// ---- References ----

TEST_F(SystemDeviceAssociationTest, ReferencesOfASystemPairItWithEverySensor)
{
    const Host::ObjectPath& source = system("as it came", "root/other");
    const char* properties[] = {"Nothing", nullptr};
    expectOk(references(
        source, {.resultClass = "NOT_AClass", .role = "Nobody", .properties = properties}));
    EXPECT_THAT(pairs(), ElementsAre("as it came A:/1", "as it came B:/2", "as it came C:/3"));
    ASSERT_EQ(answer_.instances().size(), 3U);
    const Host::Instance& second = *answer_.instances()[1];
    EXPECT_THAT(describe(second.properties()),
        ElementsAre("GroupComponent = ref " + source.toText(),
            "PartComponent = ref " + sensor("B:/2", "root/other").toText()));
    EXPECT_EQ(second.className(), Class);
    EXPECT_EQ(second.objectPath().nameSpace(), "root/other");
    EXPECT_EQ(second.objectPath().host(), systemName_);
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(messages_, ElementsAre(leadsToSensors));
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceAssociationTest, ReferencesOfASensorPairItWithEverySystem)
{
    systems_.nameSpace = "root/elsewhere";
    const Host::ObjectPath& source = sensor("D:/4", "root/other");
    expectOk(references(source));
    EXPECT_THAT(pairs(), ElementsAre("host D:/4", "guest D:/4"));
    ASSERT_EQ(answer_.instances().size(), 2U);
    EXPECT_THAT(describe(answer_.instances()[0]->properties()), // the unchanged system
        ElementsAre("GroupComponent = ref " + system("host", "root/elsewhere").toText(),
            "PartComponent = ref " + source.toText()));
    EXPECT_FALSE(answer_.isDone());
    EXPECT_THAT(messages_, ElementsAre(leadsToSystems));
    ASSERT_EQ(systems_.calls.size(), 1U);
    EXPECT_EQ(systems_.calls[0].operation, "enumerateInstanceNames");
    EXPECT_EQ(systems_.calls[0].path, "//" + systemName_ + "/root/other:ZUMLO_ComputerSystem");
    EXPECT_EQ(systems_.calls[0].context, context());
}

TEST_F(SystemDeviceAssociationTest, NamesOfReferencesAreThePathsOfTheSamePairs)
{
    expectOk(referenceNames(system("host", "root/other"), {.resultClass = "NOT_AClass"}));
    expectOk(referenceNames(sensor("A:/1", "root/other"), {.role = "Nobody"}));
    EXPECT_THAT(
        pairs(), ElementsAre("host A:/1", "host B:/2", "host C:/3", "host A:/1", "guest A:/1"));
    expectAssociationPaths(Class, "root/other");
    EXPECT_FALSE(answer_.isDone());
}

TEST_F(SystemDeviceWithoutSensorsTest, ReferencesOfASystemAreAnOpenEmptyAnswer)
{
    expectOk(references(system("host")));
    expectOk(referenceNames(system("host")));
    expectNothing(false);
}

TEST_F(SystemDeviceWithoutSystemsTest, ReferencesOfASensorAreAnOpenEmptyAnswer)
{
    expectOk(references(sensor("A:/1")));
    expectOk(referenceNames(sensor("A:/1")));
    expectNothing(false);
}

TEST_F(SystemDeviceAssociationTest, ReferencesOfAnotherSourceHaveNoTarget)
{
    for (Host::ObjectPath* const source :
        {&capabilities(), &path("zumlo_computersystem"), &path(Class)}) {
        messages_.clear();
        expectFailure(references(*source), "Object Path is NULL in References.");
        expectFailure(referenceNames(*source), "Object Path is NULL in ReferenceNames.");
        EXPECT_THAT(
            messages_, ElementsAre(BrokerMessage{2, provider, "Object Path is NULL in References."},
                           BrokerMessage{2, provider, "Object Path is NULL in ReferenceNames."}));
    }
    expectNothing(false);
}

// ---- Up-calls that fail or return unusual elements ----

TEST_F(SystemDeviceAssociationTest, ARefusedUpcallIsTheAnswer)
{
    systems_.refusal = CMPI_RC_ERR_ACCESS_DENIED;
    const Host::ObjectPath& source = sensor("A:/1");
    for (const CMPIStatus& status : {associators(source), associatorNames(source),
             references(source), referenceNames(source)}) {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
        EXPECT_EQ(textOf(status.msg), "no systems today");
    }
    expectNothing(false);
}

TEST_F(SystemDeviceAssociationTest, ElementsOfAnotherTypeAreLeftOut)
{
    systems_.isMixed = true;
    expectOk(associators(sensor("A:/1")));
    EXPECT_EQ(answer_.instances().size(), 2U);
    EXPECT_THAT(answer_.paths(), IsEmpty());
    expectOk(references(sensor("A:/1")));
    EXPECT_EQ(answer_.instances().size(), 4U);
    EXPECT_EQ(answer_.refused(), 0U);
}

TEST_F(SystemDeviceAssociationTest, ElementsOfAnotherTypeAreLeftOutOfNames)
{
    systems_.isMixed = true;
    expectOk(associatorNames(sensor("A:/1")));
    EXPECT_EQ(answer_.paths().size(), 2U);
    EXPECT_THAT(answer_.instances(), IsEmpty());
    expectOk(referenceNames(sensor("A:/1")));
    EXPECT_EQ(answer_.paths().size(), 4U);
    EXPECT_EQ(answer_.refused(), 0U);
}

} // namespace SystemDeviceAssociationTests
