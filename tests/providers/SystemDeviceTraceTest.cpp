// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests of ZUMLO_SensorSystemDevice.

#include "tests/providers/AssociationTest.h"
#include "tests/providers/RequestTrace.h"

#include <gmock/gmock.h>

namespace SystemDeviceTraceTests {

using namespace Testing;
using ::testing::ElementsAreArray;

constexpr const char* Class = "ZUMLO_SensorSystemDevice";
const std::string upcallFailed = "Call to CBEnumInstances of target Class Failed.";

HandlerLines handler(const std::string& function)
{
    return {"SenosrSystemDeviceProvider", "SensorSystemDeviceProvider", function};
}

HandlerLines request(const std::string& name)
{
    return handler("SensorSystemDevice_" + name);
}

const HandlerLines builder = handler("sensorSystemDeviceCMPIInstances");
const Lines builtLines = builtFactory({"_createSensorMap"});
const Lines builtWithoutSensors = builtFactory({});
const Lines sensorPaths = operation("getAllSensorCMPIObjPaths");

class SystemDeviceTraceTest : public AssociationTest {
protected:
    explicit SystemDeviceTraceTest(
        const std::vector<ScriptedNode>& nodes = {threeSensors[0], threeSensors[1]})
        : AssociationTest(SensorSystemDeviceProvider_Create_InstanceMI,
              SensorSystemDeviceProvider_Create_AssociationMI, nodes, {"host", "guest"})
    {
    }
};

class SystemDeviceEmptyTraceTest : public SystemDeviceTraceTest {
protected:
    SystemDeviceEmptyTraceTest() : SystemDeviceTraceTest({}) {}
};

// ---- Instances. The sensors are fetched for each of the two systems. ----

const Lines fetched = sequence({counted(), sensorPaths});

TEST_F(SystemDeviceTraceTest, OfEnumeratedNames)
{
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("EnumInstanceNames");
    EXPECT_THAT(traceOf([&] { enumerateNames(ref); }),
        ElementsAreArray(sequence({lines.entry(), builtLines, fetched, fetched, lines.exit()})));
}

TEST_F(SystemDeviceEmptyTraceTest, OfNamesWithoutSensors)
{
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("EnumInstanceNames");
    EXPECT_THAT(traceOf([&] { enumerateNames(ref); }),
        ElementsAreArray(sequence({lines.entry(), builtWithoutSensors, fetched, lines.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfNamesWithoutAnybodyToServeSystemsHasNoExitMark)
{
    systems_.refusal = CMPI_RC_ERR_NOT_SUPPORTED;
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { enumerateNames(ref); }),
        ElementsAreArray(sequence({request("EnumInstanceNames").entry(), builtLines})));
}

TEST_F(SystemDeviceTraceTest, OfEnumeratedInstances)
{
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("EnumInstances");
    EXPECT_THAT(traceOf([&] { enumerate(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtLines, counted(), fetched,
            fetched, builder.exit(), lines.exit()})));
}

// A builder that fails writes no exit mark.
TEST_F(SystemDeviceTraceTest, OfInstancesWithoutAnybodyToServeSystems)
{
    systems_.refusal = CMPI_RC_ERR_NOT_SUPPORTED;
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("EnumInstances");
    EXPECT_THAT(traceOf([&] { enumerate(ref); }),
        ElementsAreArray(
            sequence({lines.entry(), builder.entry(), builtLines, counted(), lines.exit()})));
}

TEST_F(SystemDeviceEmptyTraceTest, OfInstancesWithoutSensors)
{
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("EnumInstances");
    EXPECT_THAT(traceOf([&] { enumerate(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtWithoutSensors, counted(),
            fetched, lines.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfAnInstanceSearched)
{
    const Host::ObjectPath& ref = path(Class, {{"Other", "x"}});
    const HandlerLines lines = request("GetInstance");
    EXPECT_THAT(traceOf([&] { get(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtLines, counted(), fetched,
            fetched, builder.exit(), lines.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfARequestWithoutKeysHasNoFactory)
{
    const Host::ObjectPath& ref = path(Class);
    const HandlerLines lines = request("GetInstance");
    EXPECT_THAT(traceOf([&] { get(ref); }),
        ElementsAreArray(sequence(
            {lines.entry(), lines.failure("At least one key should be passed"), lines.exit()})));
}

// ---- Associated objects ----

TEST_F(SystemDeviceTraceTest, OfTheAssociatorsOfASensor)
{
    const Host::ObjectPath& source = sensor("B:/2");
    const HandlerLines instances = request("Associators");
    EXPECT_THAT(traceOf([&] { associators(source, {.resultClass = "CIM_ComputerSystem"}); }),
        ElementsAreArray(sequence({instances.entry(), builtLines,
            lookedUp(Class, "CIM_ComputerSystem", 1221), instances.exit()})));
    const HandlerLines names = request("AssociatorNames");
    EXPECT_THAT(traceOf([&] { associatorNames(source, {.associationClass = Class}); }),
        ElementsAreArray(
            sequence({names.entry(), builtLines, lookedUp(Class, "(null)", 1221), names.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfTheAssociatorsOfASystem)
{
    const Host::ObjectPath& source = system("host");
    const HandlerLines instances = request("Associators");
    const Lines instance = operation("makeSensorInstance", 269, 737);
    EXPECT_THAT(traceOf([&] { associators(source); }),
        ElementsAreArray(
            sequence({instances.entry(), builtLines, lookedUp(Class, "(null)", 1205), counted(),
                around(operation("getAllSensorCMPIInstances"), sequence({instance, instance})),
                instances.exit()})));
    const HandlerLines names = request("AssociatorNames");
    EXPECT_THAT(traceOf([&] { associatorNames(source); }),
        ElementsAreArray(sequence(
            {names.entry(), builtLines, lookedUp(Class, "(null)", 1205), fetched, names.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfAResultClassThatIsNotServedHasNoExitMark)
{
    const Host::ObjectPath& fromSensor = sensor("B:/2");
    const Host::ObjectPath& fromSystem = system("host");
    EXPECT_THAT(traceOf([&] { associators(fromSensor, {.resultClass = "X"}); }),
        ElementsAreArray(
            sequence({request("Associators").entry(), builtLines, lookedUp(Class, "X", 1221)})));
    EXPECT_THAT(traceOf([&] { associatorNames(fromSystem, {.resultClass = "X"}); }),
        ElementsAreArray(sequence(
            {request("AssociatorNames").entry(), builtLines, lookedUp(Class, "X", 1205)})));
}

TEST_F(SystemDeviceTraceTest, OfASourceWithoutTarget)
{
    const Host::ObjectPath& source = capabilities();
    const Lines lookUp = lookedUp(Class, "(null)", 1259);
    const auto expected = [&](const std::string& name) {
        return sequence({request(name).entry(), builtLines, lookUp, request(name).exit()});
    };
    EXPECT_THAT(traceOf([&] { associators(source); }), ElementsAreArray(expected("Associators")));
    EXPECT_THAT(
        traceOf([&] { associatorNames(source); }), ElementsAreArray(expected("AssociatorNames")));
    for (const std::string name : {"References", "ReferenceNames"}) {
        const HandlerLines lines = request(name);
        EXPECT_THAT(
            traceOf([&] { name == "References" ? references(source) : referenceNames(source); }),
            ElementsAreArray(sequence({lines.entry(), builtLines, counted(), lookUp,
                lines.failure("Object Path is NULL in " + name), lines.exit()})));
    }
}

TEST_F(SystemDeviceTraceTest, OfATargetThatNobodyHereLeadsTo)
{
    const Host::ObjectPath& source = sensor("B:/2");
    const char* const other = "ZUMLO_SensorElementCapabilities";
    const auto expected = [&](const std::string& name) {
        return sequence({request(name).entry(), builtLines, lookedUp(other, "(null)", 1236),
            request(name).exit()});
    };
    EXPECT_THAT(traceOf([&] { associators(source, {.associationClass = other}); }),
        ElementsAreArray(expected("Associators")));
    EXPECT_THAT(traceOf([&] { associatorNames(source, {.associationClass = other}); }),
        ElementsAreArray(expected("AssociatorNames")));
}

TEST_F(SystemDeviceEmptyTraceTest, OfSensorsThatAreNotThere)
{
    const Host::ObjectPath& source = system("host");
    const Lines lookUp = lookedUp(Class, "(null)", 1205);
    const std::string failed = "getAllSensorCMPIObjPaths failed";
    const HandlerLines names = request("AssociatorNames");
    EXPECT_THAT(traceOf([&] { associatorNames(source); }),
        ElementsAreArray(sequence({names.entry(), builtWithoutSensors, lookUp, fetched,
            names.failure(failed), names.exit()})));
    const HandlerLines instances = request("References");
    EXPECT_THAT(traceOf([&] { references(source); }),
        ElementsAreArray(sequence({instances.entry(), builtWithoutSensors, counted(), lookUp,
            sensorPaths, instances.failure(failed), instances.exit()})));
    const HandlerLines paths = request("ReferenceNames");
    EXPECT_THAT(traceOf([&] { referenceNames(source); }),
        ElementsAreArray(sequence({paths.entry(), builtWithoutSensors, counted(), lookUp,
            sensorPaths, paths.failure(failed), paths.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfReferences)
{
    const Host::ObjectPath& source = sensor("B:/2");
    const Lines lookUp = lookedUp(Class, "(null)", 1221);
    const HandlerLines instances = request("References");
    EXPECT_THAT(traceOf([&] { references(source, {.resultClass = "not passed on"}); }),
        ElementsAreArray(
            sequence({instances.entry(), builtLines, counted(), lookUp, instances.exit()})));
    const HandlerLines names = request("ReferenceNames");
    EXPECT_THAT(traceOf([&] { referenceNames(source, {.resultClass = "not passed on"}); }),
        ElementsAreArray(sequence({names.entry(), builtLines, counted(), lookUp, names.exit()})));
}

TEST_F(SystemDeviceTraceTest, OfARefusedUpcallHasNoExitMark)
{
    systems_.refusal = CMPI_RC_ERR_ACCESS_DENIED;
    const Host::ObjectPath& source = sensor("B:/2");
    const auto expected = [](const std::string& name) {
        return sequence({request(name).entry(), request(name).failure(upcallFailed)});
    };
    EXPECT_EQ(ownLines(traceOf([&] { associators(source); })), expected("Associators"));
    EXPECT_EQ(ownLines(traceOf([&] { associatorNames(source); })), expected("AssociatorNames"));
    EXPECT_EQ(ownLines(traceOf([&] { references(source); })), expected("References"));
    EXPECT_EQ(ownLines(traceOf([&] { referenceNames(source); })), expected("ReferenceNames"));
}

} // namespace SystemDeviceTraceTests
