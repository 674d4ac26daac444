// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorSystemDevice: each computer system with each sensor.

#include "providers/SensorSystemDevice.h"
#include "tests/providers/AssociationInstanceTest.h"

#include <gmock/gmock.h>

namespace SystemDeviceInstanceTests {

using namespace Testing;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr const char* Class = "ZUMLO_SensorSystemDevice";
constexpr const char* provider = "SensorSystemDeviceProvider";
constexpr const char* noKeyText = "At least one key should be passed";

const AssociationClass association = {Class, "GroupComponent", "PartComponent",
    SensorSystemDeviceProvider_Create_InstanceMI, SensorSystemDeviceProvider_Create_AssociationMI};

class SystemDeviceInstanceTest : public AssociationInstanceTest {
protected:
    explicit SystemDeviceInstanceTest(const std::vector<ScriptedNode>& nodes = threeSensors,
        const std::vector<std::string>& systems = {"host", "guest"})
        : AssociationInstanceTest(association, nodes, systems)
    {
    }

    // Expects one up-call, with the request's context, for the class of systems.
    void expectUpcall(const std::string& path)
    {
        ASSERT_EQ(systems_.calls.size(), 1U);
        EXPECT_EQ(systems_.calls[0].operation, "enumerateInstanceNames");
        EXPECT_EQ(systems_.calls[0].path, path);
        EXPECT_EQ(systems_.calls[0].context, context());
    }
};

class SystemDeviceOfNoSystemTest : public SystemDeviceInstanceTest {
protected:
    SystemDeviceOfNoSystemTest() : SystemDeviceInstanceTest(threeSensors, {}) {}
};

class SystemDeviceOfNoSensorTest : public SystemDeviceInstanceTest {
protected:
    SystemDeviceOfNoSensorTest() : SystemDeviceInstanceTest({}) {}
};

class SystemDeviceOfOnePairTest : public SystemDeviceInstanceTest {
protected:
    SystemDeviceOfOnePairTest() : SystemDeviceInstanceTest({threeSensors[0]}, {"host"}) {}
};

const std::vector<std::string> allPairs = {
    "host A:/1", "host B:/2", "host C:/3", "guest A:/1", "guest B:/2", "guest C:/3"};

// ---- EnumInstanceNames ----

TEST_F(SystemDeviceInstanceTest, NamesArePairsSystemBySystem)
{
    expectOk(enumerateNames(path(Class)));
    EXPECT_EQ(pairs(), allPairs);
    EXPECT_TRUE(answer_.isDone());
    EXPECT_THAT(messages_, IsEmpty());
    expectUpcall("root/cimv2:ZUMLO_ComputerSystem");
}

TEST_F(SystemDeviceInstanceTest, ANameIsAPathInTheRequestsNamespaceOnThisSystem)
{
    systems_.nameSpace = "root/elsewhere";
    expectOk(enumerateNames(path(Class, {}, "root/other")));
    expectUpcall("root/other:ZUMLO_ComputerSystem");
    ASSERT_EQ(answer_.paths().size(), 6U);
    const Host::ObjectPath& fifth = *answer_.paths()[4];
    EXPECT_EQ(fifth.className(), Class);
    EXPECT_EQ(fifth.nameSpace(), "root/other");
    EXPECT_EQ(fifth.host(), systemName_);
    EXPECT_THAT(describe(fifth.keys()), // the system is in the request's namespace, too
        ElementsAre("GroupComponent = ref " + system("guest", "root/other").toText(),
            "PartComponent = ref " + sensor("B:/2", "root/other").toText()));
}

TEST_F(SystemDeviceOfOnePairTest, HasOneName)
{
    expectOk(enumerateNames(path(Class)));
    EXPECT_THAT(pairs(), ElementsAre("host C:/3"));
}

TEST_F(SystemDeviceOfNoSystemTest, NamesAreAClosedEmptyAnswer)
{
    expectOk(enumerateNames(path(Class)));
    expectNothing(true);
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(SystemDeviceOfNoSensorTest, NamesAreAClosedEmptyAnswer)
{
    expectOk(enumerateNames(path(Class)));
    expectNothing(true);
}

TEST_F(SystemDeviceInstanceTest, SystemsThatNobodyServesAreAnOpenEmptyAnswerThatSaysSo)
{
    for (const CMPIrc refusal : {CMPI_RC_ERR_NOT_SUPPORTED, CMPI_RC_ERR_FAILED}) {
        systems_.refusal = refusal;
        const CMPIStatus status = enumerateNames(path(Class));
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(textOf(status.msg), "CBEnumInstanceNames Failed for the ZUMLO_ComputerSystem");
        expectNothing(false);
        EXPECT_THAT(messages_, IsEmpty());
    }
}

TEST_F(SystemDeviceInstanceTest, WithoutABrokerNamesFailWithoutAMessage)
{
    SensorSystemDeviceProvider_Create_AssociationMI(nullptr, nullptr, nullptr);
    const CMPIStatus status = enumerateNames(path(Class));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    expectNothing(false);
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceInstanceTest, ElementsThatAreNoPathsArePassedOverInNames)
{
    systems_.isMixed = true;
    expectOk(enumerateNames(path(Class)));
    EXPECT_EQ(pairs(), allPairs);
    EXPECT_TRUE(answer_.isDone());
}

// ---- EnumInstances ----

TEST_F(SystemDeviceInstanceTest, InstancesArePairsSystemBySystem)
{
    systems_.nameSpace = "root/elsewhere";
    expectOk(enumerate(path(Class, {}, "root/other")));
    EXPECT_EQ(pairs(), allPairs);
    EXPECT_TRUE(answer_.isDone());
    EXPECT_THAT(messages_, IsEmpty());
    expectUpcall("root/other:ZUMLO_ComputerSystem");
    const Host::Instance& last = *answer_.instances().back();
    EXPECT_EQ(last.className(), Class);
    EXPECT_EQ(last.objectPath().nameSpace(), "root/other");
    EXPECT_EQ(last.objectPath().host(), systemName_);
    EXPECT_THAT(describe(last.properties()),
        ElementsAre("GroupComponent = ref " + system("guest", "root/other").toText(),
            "PartComponent = ref " + sensor("C:/3", "root/other").toText()));
}

TEST_F(SystemDeviceInstanceTest, TheFilterKeepsBothReferencesWhateverTheListNames)
{
    broker_.setClassInformation(nullptr); // so that only the keys of the filter are known
    const char* properties[] = {"Nothing", nullptr};
    expectOk(enumerate(path(Class), properties));
    ASSERT_EQ(answer_.instances().size(), 6U);
    for (const Host::Instance* const instance : answer_.instances())
        EXPECT_THAT(
            namesOf(instance->properties()), ElementsAre("GroupComponent", "PartComponent"));
}

TEST_F(SystemDeviceOfNoSystemTest, InstancesAreAClosedEmptyAnswer)
{
    expectOk(enumerate(path(Class)));
    expectNothing(true);
}

TEST_F(SystemDeviceOfNoSensorTest, InstancesAreAClosedEmptyAnswer)
{
    expectOk(enumerate(path(Class)));
    expectNothing(true);
}

TEST_F(SystemDeviceInstanceTest, SystemsThatNobodyServesHaveNoInstancesInAClosedResult)
{
    systems_.refusal = CMPI_RC_ERR_NOT_SUPPORTED;
    expectOk(enumerate(path(Class)));
    expectNothing(true);
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_F(SystemDeviceInstanceTest, ElementsThatAreNoPathsArePassedOverInInstances)
{
    systems_.isMixed = true;
    expectOk(enumerate(path(Class)));
    EXPECT_EQ(pairs(), allPairs);
}

TEST_F(SystemDeviceInstanceTest, TheBuilderKeepsWhatIsThereAndSaysWhetherItFailed)
{
    using Vorn::SensorProfileProvider::sensorSystemDeviceCMPIInstances;
    std::vector<CMPIInstance*> instances = {nullptr};
    const CMPIObjectPath* const ref = path(Class).handle();
    EXPECT_EQ(sensorSystemDeviceCMPIInstances(ref, nullptr, context(), instances), 0);
    EXPECT_EQ(instances.size(), 7U);
    EXPECT_EQ(instances[0], nullptr);
    systems_.refusal = CMPI_RC_ERR_FAILED;
    EXPECT_EQ(sensorSystemDeviceCMPIInstances(ref, nullptr, context(), instances), 1);
    systems_.refusal = CMPI_RC_OK;
    const ScriptedMachine empty;
    EXPECT_EQ(sensorSystemDeviceCMPIInstances(ref, nullptr, context(), instances), 1);
    systems_.names.clear();
    EXPECT_EQ(sensorSystemDeviceCMPIInstances(ref, nullptr, context(), instances), 0);
    EXPECT_EQ(instances.size(), 7U);
}

// ---- GetInstance ----

TEST_F(SystemDeviceInstanceTest, AnInstanceIsFoundByItsReferences)
{
    expectOk(get(pairPath(system("guest"), sensor("B:/2"))));
    EXPECT_THAT(pairs(), ElementsAre("guest B:/2"));
    EXPECT_TRUE(answer_.isDone());
    expectUpcall("root/cimv2:ZUMLO_ComputerSystem");
}

TEST_F(SystemDeviceInstanceTest, TheFirstOfEqualInstancesIsReturnedAlone)
{
    systems_.names = {"host", "host"};
    EXPECT_THAT(got(pairPath(system("host"), sensor("A:/1"))), ElementsAre("host A:/1"));
}

TEST_F(SystemDeviceInstanceTest, NeitherOrderNorLetterCaseNorHostsMatter)
{
    Host::ObjectPath& group = path("zumlo_computersystem",
        {{"name", "guest"}, {"creationclassname", SystemClass}}, "ROOT/CIMV2");
    group.setHost("elsewhere");
    Host::ObjectPath& part = path("ZUMLO_NUMERICSENSOR",
        {{"SYSTEMNAME", systemName_}, {"SYSTEMCREATIONCLASSNAME", SystemClass},
            {"DEVICEID", "C:/3"}, {"CREATIONCLASSNAME", SensorClass}});
    part.setNameSpace(nullptr);
    Host::ObjectPath& ref = path("zumlo_sensorsystemdevice");
    ref.addKey("partcomponent", Host::Value::of(part));
    ref.addKey("groupcomponent", Host::Value::of(group));
    EXPECT_THAT(got(ref), ElementsAre("guest C:/3"));
}

TEST_F(SystemDeviceInstanceTest, OtherValuesAreAClosedEmptyAnswer)
{
    EXPECT_THAT(got(pairPath(system("other"), sensor("A:/1"))), IsEmpty());
    EXPECT_THAT(got(pairPath(system("Guest"), sensor("A:/1"))), IsEmpty());
    EXPECT_THAT(got(pairPath(system("host"), sensor("D:/4"))), IsEmpty());
    EXPECT_THAT(got(pairPath(system("host", "root/other"), sensor("A:/1"))), IsEmpty());
    EXPECT_THAT(got(pairPath(sensor("A:/1"), system("host"))), IsEmpty());
    EXPECT_THAT(got(path(Class, {{"Other", "x"}})), IsEmpty());
}

TEST_F(SystemDeviceInstanceTest, AReferenceOfAnotherTypeFindsNothing)
{
    Host::Arena& arena = request_->arena();
    for (const Host::Value& value : {Host::Value::text(arena, system("host").toText()),
             Host::Value::integer(CMPI_uint64, 1), Host::Value::integer(CMPI_sint64, 1),
             Host::Value::boolean(false), Host::Value::null(CMPI_ref), Host::Value::absent()}) {
        EXPECT_THAT(got(pairPath(value, Host::Value::of(sensor("A:/1")))), IsEmpty());
        EXPECT_THAT(got(pairPath(Host::Value::of(system("host")), value)), IsEmpty());
    }
    Host::ObjectPath& part = path(
        SensorClass, {{"CreationClassName", SensorClass}, {"SystemCreationClassName", SystemClass},
                         {"SystemName", systemName_}});
    part.addKey("DeviceID", Host::Value::integer(CMPI_uint64, 1));
    EXPECT_THAT(got(pairPath(system("host"), part)), IsEmpty());
}

TEST_F(SystemDeviceInstanceTest, APathWithoutKeysIsRefusedInAClosedResult)
{
    expectFailure(get(path(Class)), noKeyText);
    expectNothing(true);
    EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, provider, noKeyText}));
    EXPECT_TRUE(systems_.calls.empty());
}

TEST_F(SystemDeviceInstanceTest, AFailedUpcallFindsNothingAndIsOk)
{
    systems_.refusal = CMPI_RC_ERR_FAILED;
    EXPECT_THAT(got(pairPath(system("host"), sensor("A:/1"))), IsEmpty());
}

} // namespace SystemDeviceInstanceTests
