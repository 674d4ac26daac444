// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorElementCapabilities: each sensor with each capabilities instance.

#include "providers/SensorElementCapabilities.h"
#include "tests/providers/AssociationInstanceTest.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesInstanceTests {

using namespace Testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* Class = "ZUMLO_SensorElementCapabilities";
constexpr const char* provider = "SensorElementCapabilitiesProvider";
constexpr const char* noKeyText = "At least one key should be passed";
const std::string cap = capabilitiesId;

const AssociationClass association = {Class, "ManagedElement", "Capabilities",
    SensorElementCapabilitiesProvider_Create_InstanceMI,
    SensorElementCapabilitiesProvider_Create_AssociationMI};

class ElementCapabilitiesInstanceTest : public AssociationInstanceTest {
protected:
    explicit ElementCapabilitiesInstanceTest(const std::vector<ScriptedNode>& nodes = threeSensors)
        : AssociationInstanceTest(association, nodes, {})
    {
    }
};

class ElementCapabilitiesOfOneSensorTest : public ElementCapabilitiesInstanceTest {
protected:
    ElementCapabilitiesOfOneSensorTest() : ElementCapabilitiesInstanceTest({threeSensors[0]}) {}
};

class ElementCapabilitiesOfNoSensorTest : public ElementCapabilitiesInstanceTest {
protected:
    ElementCapabilitiesOfNoSensorTest() : ElementCapabilitiesInstanceTest({}) {}
};

// ---- EnumInstanceNames ----

TEST_F(ElementCapabilitiesInstanceTest, NamesArePairsOfEachSensorInOrder)
{
    expectOk(enumerateNames(path(Class)));
    EXPECT_THAT(pairs(), ElementsAre("A:/1 " + cap, "B:/2 " + cap, "C:/3 " + cap));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(ElementCapabilitiesInstanceTest, ANameIsAPathInTheRequestsNamespaceOnThisSystem)
{
    expectOk(enumerateNames(path(Class, {}, "root/other")));
    ASSERT_EQ(answer_.paths().size(), 3U);
    const Host::ObjectPath& second = *answer_.paths()[1];
    EXPECT_EQ(second.className(), Class);
    EXPECT_EQ(second.nameSpace(), "root/other");
    EXPECT_EQ(second.host(), systemName_);
    EXPECT_THAT(describe(second.keys()),
        ElementsAre("ManagedElement = ref " + sensor("B:/2", "root/other").toText(),
            "Capabilities = ref " + capabilities("root/other").toText()));
}

TEST_F(ElementCapabilitiesOfOneSensorTest, HasOneName)
{
    expectOk(enumerateNames(path(Class)));
    EXPECT_THAT(pairs(), ElementsAre("C:/3 " + cap));
}

TEST_F(ElementCapabilitiesOfNoSensorTest, HasNoNamesInAClosedResult)
{
    expectOk(enumerateNames(path(Class)));
    expectNothing(true);
    EXPECT_THAT(messages_,
        ElementsAre(BrokerMessage{1, "SensorProfileProvider", "***No instance found***"}));
}

TEST_F(ElementCapabilitiesInstanceTest, WithoutABrokerNamesFailWithoutAMessage)
{
    SensorElementCapabilitiesProvider_Create_AssociationMI(nullptr, nullptr, nullptr);
    const CMPIStatus status = enumerateNames(path(Class));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    expectNothing(false);
}

// ---- EnumInstances ----

TEST_F(ElementCapabilitiesInstanceTest, InstancesArePairsOfEachSensorInOrder)
{
    expectOk(enumerate(path(Class, {}, "root/other")));
    EXPECT_THAT(pairs(), ElementsAre("A:/1 " + cap, "B:/2 " + cap, "C:/3 " + cap));
    const Host::Instance& third = *answer_.instances()[2];
    EXPECT_EQ(third.className(), Class);
    EXPECT_EQ(third.objectPath().nameSpace(), "root/other");
    EXPECT_EQ(third.objectPath().host(), systemName_);
    EXPECT_THAT(describe(third.properties()),
        ElementsAre("ManagedElement = ref " + sensor("C:/3", "root/other").toText(),
            "Capabilities = ref " + capabilities("root/other").toText()));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(ElementCapabilitiesOfNoSensorTest, HasNoInstancesInAClosedResult)
{
    expectOk(enumerate(path(Class)));
    expectNothing(true);
    EXPECT_THAT(
        messages_, ElementsAre(BrokerMessage{1, "SensorProfileProvider", "***No instance found***"},
                       BrokerMessage{2, provider,
                           "***Can't get Sensor ObjectPaths." + std::string(13, ' ') +
                               "Exiting EnumerateInstanceNames***"}));
}

// A broker that has the class keeps its keys whatever the filter.
TEST_F(ElementCapabilitiesInstanceTest, APropertyListKeepsTheKeysOfAClassThatIsKnown)
{
    const char* properties[] = {"Characteristics", nullptr};
    expectOk(enumerate(path(Class), properties));
    ASSERT_EQ(answer_.instances().size(), 3U);
    EXPECT_THAT(namesOf(answer_.instances()[0]->properties()),
        ElementsAre("ManagedElement", "Capabilities"));
}

// The keys of the filter are no properties of the class.
TEST_F(ElementCapabilitiesInstanceTest, APropertyListDecidesWhereTheClassIsNotKnown)
{
    broker_.setClassInformation(nullptr);
    const char* properties[] = {"Capabilities", nullptr};
    expectOk(enumerate(path(Class), properties));
    ASSERT_EQ(answer_.instances().size(), 3U);
    for (const Host::Instance* const instance : answer_.instances())
        EXPECT_THAT(namesOf(instance->properties()), ElementsAre("Capabilities"));
}

TEST_F(ElementCapabilitiesInstanceTest, TheFilterNamesAntecedentAndDependentAsKeys)
{
    static std::vector<std::string> keys;
    keys.clear();
    CMPIInstanceFT functions = Host::Instance::functions;
    functions.setPropertyFilter = [](const CMPIInstance*, const char**, const char** names) {
        for (; *names != nullptr; ++names)
            keys.emplace_back(*names);
        return CMPIStatus{CMPI_RC_OK, nullptr};
    };
    const BrokerWithInstances watched(broker(), functions);
    SensorElementCapabilitiesProvider_Create_InstanceMI(watched.handle(), nullptr, nullptr);
    expectOk(enumerate(path(Class)));
    EXPECT_THAT(keys, ElementsAre("Antecedent", "Dependent", "Antecedent", "Dependent",
                          "Antecedent", "Dependent"));
}

TEST_F(ElementCapabilitiesInstanceTest, TheBuilderKeepsWhatIsThereAndSaysWhetherItFailed)
{
    std::vector<CMPIInstance*> instances = {nullptr};
    using Vorn::SensorProfileProvider::sensorElementCapabilitiesCMPIInstances;
    EXPECT_EQ(sensorElementCapabilitiesCMPIInstances(path(Class).handle(), nullptr, instances), 0);
    EXPECT_EQ(instances.size(), 4U);
    EXPECT_EQ(instances[0], nullptr);
    const ScriptedMachine empty;
    EXPECT_EQ(sensorElementCapabilitiesCMPIInstances(path(Class).handle(), nullptr, instances), 1);
    EXPECT_EQ(instances.size(), 4U);
}

// ---- GetInstance ----

TEST_F(ElementCapabilitiesInstanceTest, AnInstanceIsFoundByItsReferences)
{
    expectOk(get(pairPath(sensor("B:/2"), capabilities())));
    EXPECT_THAT(pairs(), ElementsAre("B:/2 " + cap));
    EXPECT_TRUE(answer_.isDone());
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(ElementCapabilitiesInstanceTest, AnInstanceIsFoundWithAPropertyListToo)
{
    const char* properties[] = {"Capabilities", nullptr};
    expectOk(get(pairPath(sensor("B:/2"), capabilities()), properties));
    EXPECT_THAT(pairs(), ElementsAre("B:/2 " + cap));
}

TEST_F(ElementCapabilitiesInstanceTest, TheOrderOfTheKeysDoesNotMatter)
{
    Host::ObjectPath& ref = path(Class);
    ref.addKey("Capabilities", Host::Value::of(capabilities()));
    ref.addKey("ManagedElement",
        Host::Value::of(path(SensorClass,
            {{"SystemName", systemName_}, {"DeviceID", "C:/3"},
                {"SystemCreationClassName", SystemClass}, {"CreationClassName", SensorClass}})));
    EXPECT_THAT(got(ref), ElementsAre("C:/3 " + cap));
}

TEST_F(ElementCapabilitiesInstanceTest, TheLetterCaseOfNamesDoesNotMatter)
{
    Host::ObjectPath& ref = path("zumlo_sensorelementcapabilities");
    ref.addKey("MANAGEDELEMENT",
        Host::Value::of(path("zumlo_numericsensor",
            {{"creationclassname", SensorClass}, {"deviceid", "A:/1"},
                {"systemcreationclassname", SystemClass}, {"systemname", systemName_}})));
    ref.addKey("capabilities", Host::Value::of(path("ZUMLO_SENSORENABLEDLOGICALELEMENTCAPABILITIES",
                                   {{"INSTANCEID", capabilitiesId}}, "ROOT/CIMV2")));
    EXPECT_THAT(got(ref), ElementsAre("A:/1 " + cap));
}

TEST_F(ElementCapabilitiesInstanceTest, HostsAndAbsentNamespacesDoNotMatter)
{
    for (const char* const host : {static_cast<const char*>(nullptr), "elsewhere"})
        for (const char* const nameSpace : {static_cast<const char*>(nullptr), testNameSpace}) {
            Host::ObjectPath& element = sensor("A:/1");
            Host::ObjectPath& capability = capabilities();
            for (Host::ObjectPath* const end : {&element, &capability}) {
                end->setHost(host);
                end->setNameSpace(nameSpace);
            }
            Host::ObjectPath& ref = pairPath(element, capability);
            ref.setHost(host);
            EXPECT_THAT(got(ref), ElementsAre("A:/1 " + cap));
        }
}

TEST_F(ElementCapabilitiesInstanceTest, OtherValuesAreAClosedEmptyAnswer)
{
    EXPECT_THAT(got(pairPath(sensor("a:/1"), capabilities())), IsEmpty());
    EXPECT_THAT(got(pairPath(sensor("D:/4"), capabilities())), IsEmpty());
    EXPECT_THAT(got(pairPath(sensor("A:/1", "root/other"), capabilities())), IsEmpty());
    EXPECT_THAT(got(pairPath(sensor("A:/1"), path(CapabilitiesClass, {{"InstanceID", "other"}}))),
        IsEmpty());
    EXPECT_THAT(got(pairPath(capabilities(), sensor("A:/1"))), IsEmpty());
    EXPECT_THAT(got(path(Class, {{"Other", "x"}})), IsEmpty());
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(ElementCapabilitiesInstanceTest, OneReferenceAloneOrOneTooManyFindsNothing)
{
    Host::ObjectPath& half = path(Class);
    half.addKey("ManagedElement", Host::Value::of(sensor("A:/1")));
    EXPECT_THAT(got(half), IsEmpty());
    Host::ObjectPath& more = pairPath(sensor("A:/1"), capabilities());
    more.addKey("Other", Host::Value::text(request_->arena(), "x"));
    EXPECT_THAT(got(more), IsEmpty());
}

TEST_F(ElementCapabilitiesInstanceTest, AReferenceOfAnotherTypeFindsNothing)
{
    Host::Arena& arena = request_->arena();
    const Host::Value good = Host::Value::of(capabilities());
    for (const Host::Value& value : {Host::Value::text(arena, sensor("A:/1").toText()),
             Host::Value::integer(CMPI_uint64, 1), Host::Value::integer(CMPI_sint64, 1),
             Host::Value::boolean(true), Host::Value::null(CMPI_ref), Host::Value::absent()})
        EXPECT_THAT(got(pairPath(value, good)), IsEmpty());
    Host::ObjectPath& element = path(
        SensorClass, {{"CreationClassName", SensorClass}, {"SystemCreationClassName", SystemClass},
                         {"SystemName", systemName_}});
    element.addKey("DeviceID", Host::Value::integer(CMPI_uint64, 1));
    EXPECT_THAT(got(pairPath(element, capabilities())), IsEmpty());
}

TEST_F(ElementCapabilitiesInstanceTest, APathWithoutKeysIsRefusedInAClosedResult)
{
    expectFailure(get(path(Class)), noKeyText);
    expectNothing(true);
    EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, provider, noKeyText}));
}

TEST_F(ElementCapabilitiesInstanceTest, ARefusalHasNoMessageWithoutABroker)
{
    SensorElementCapabilitiesProvider_Create_AssociationMI(nullptr, nullptr, nullptr);
    const CMPIStatus status = get(path(Class));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_THAT(messages_, IsEmpty());
    EXPECT_TRUE(answer_.isDone());
}

TEST_F(ElementCapabilitiesOfNoSensorTest, FindsNoInstance)
{
    EXPECT_THAT(got(pairPath(sensor("A:/1"), capabilities())), IsEmpty());
}

} // namespace ElementCapabilitiesInstanceTests
