// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests of ZUMLO_SensorElementCapabilities.

#include "tests/providers/AssociationTest.h"
#include "tests/providers/RequestTrace.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesTraceTests {

using namespace Testing;
using ::testing::ElementsAreArray;

constexpr const char* Class = "ZUMLO_SensorElementCapabilities";

HandlerLines handler(const std::string& function)
{
    return {"SensorElementCapabilities", "SensorElementCapabilitiesProvider", function};
}

const HandlerLines builder = handler("sensorElementCapabilitiesCMPIInstances");
const Lines builtLines = builtFactory({"_createSensorMap", "_createEnabledLogicalElementCapMap"});
const Lines builtWithoutSensors = builtFactory({"_createEnabledLogicalElementCapMap"});
const Lines sensorPaths = operation("getAllSensorCMPIObjPaths");
const Lines capPaths = operation("getAllSensorEnabledLogicalElementCapCMPIObjPaths", 1041, 1093);

class ElementCapabilitiesTraceTest : public AssociationTest {
protected:
    explicit ElementCapabilitiesTraceTest(
        const std::vector<ScriptedNode>& nodes = {threeSensors[0], threeSensors[1]})
        : AssociationTest(SensorElementCapabilitiesProvider_Create_InstanceMI,
              SensorElementCapabilitiesProvider_Create_AssociationMI, nodes, {})
    {
    }
};

class ElementCapabilitiesEmptyTraceTest : public ElementCapabilitiesTraceTest {
protected:
    ElementCapabilitiesEmptyTraceTest() : ElementCapabilitiesTraceTest({}) {}
};

// ---- Instances ----

// The capabilities are fetched for each of the two sensors.
TEST_F(ElementCapabilitiesTraceTest, OfEnumeratedNames)
{
    const HandlerLines lines = handler("SensorElementCapabilities_EnumInstanceNames");
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { enumerateNames(ref); }),
        ElementsAreArray(sequence({lines.entry(), builtLines, counted(), sensorPaths, capPaths,
            capPaths, lines.exit()})));
}

TEST_F(ElementCapabilitiesEmptyTraceTest, OfNamesWithoutSensors)
{
    const HandlerLines lines = handler("SensorElementCapabilities_EnumInstanceNames");
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { enumerateNames(ref); }),
        ElementsAreArray(
            sequence({lines.entry(), builtWithoutSensors, counted(), sensorPaths, lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfEnumeratedInstances)
{
    const HandlerLines lines = handler("SensorElementCapabilities_EnumInstances");
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { enumerate(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtLines, counted(), counted(),
            sensorPaths, capPaths, capPaths, builder.exit(), lines.exit()})));
}

TEST_F(ElementCapabilitiesEmptyTraceTest, OfInstancesWithoutSensors)
{
    const HandlerLines lines = handler("SensorElementCapabilities_EnumInstances");
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { enumerate(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtWithoutSensors, counted(),
            counted(), sensorPaths, builder.failure("getAllSensorCMPIObjPaths failed"),
            builder.exit(), lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfAnInstanceSearched)
{
    const HandlerLines lines = handler("SensorElementCapabilities_GetInstance");
    const Host::ObjectPath& ref = path(Class, {{"Other", "x"}});
    EXPECT_THAT(traceOf([&] { get(ref); }),
        ElementsAreArray(sequence({lines.entry(), builder.entry(), builtLines, counted(), counted(),
            sensorPaths, capPaths, capPaths, builder.exit(), lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfARequestWithoutKeysHasNoFactory)
{
    const HandlerLines lines = handler("SensorElementCapabilities_GetInstance");
    const Host::ObjectPath& ref = path(Class);
    EXPECT_THAT(traceOf([&] { get(ref); }),
        ElementsAreArray(sequence(
            {lines.entry(), lines.failure("At least one key should be passed"), lines.exit()})));
}

// ---- Associated objects ----

TEST_F(ElementCapabilitiesTraceTest, OfTheAssociatorsOfCapabilities)
{
    const HandlerLines lines = handler("SensorElementCapabilities_Associators");
    const Host::ObjectPath& source = capabilities();
    const Lines instance = operation("makeSensorInstance", 269, 737);
    EXPECT_THAT(traceOf([&] { associators(source, {.resultClass = "Result"}); }),
        ElementsAreArray(
            sequence({lines.entry(), builtLines, counted(), lookedUp(Class, "Result", 1252),
                around(operation("getAllSensorCMPIInstances"), sequence({instance, instance})),
                lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfTheAssociatorsOfASensor)
{
    const HandlerLines lines = handler("SensorElementCapabilities_Associators");
    const Host::ObjectPath& source = sensor("B:/2");
    EXPECT_THAT(traceOf([&] { associators(source, {.associationClass = Class}); }),
        ElementsAreArray(
            sequence({lines.entry(), builtLines, counted(), lookedUp(Class, "(null)", 1236),
                around(operation("getAllSensorEnabledLogicalElementCapCMPIInstances", 996, 1017),
                    operation("makeSensorEnabledLogicalElementCapInstance", 863, 965)),
                lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfTheNamesOfAssociators)
{
    const HandlerLines lines = handler("SensorElementCapabilities_AssociatorNames");
    const Host::ObjectPath& source = sensor("B:/2");
    EXPECT_THAT(traceOf([&] { associatorNames(source, {.resultClass = "Result"}); }),
        ElementsAreArray(sequence({lines.entry(), builtLines, counted(),
            lookedUp(Class, "Result", 1236), capPaths, lines.exit()})));
}

TEST_F(ElementCapabilitiesTraceTest, OfATargetThatNobodyHereLeadsTo)
{
    const Host::ObjectPath& source = sensor("B:/2");
    const char* const other = "ZUMLO_SensorSystemDevice";
    const auto expected = [&](const std::string& function) {
        const HandlerLines lines = handler(function);
        return sequence(
            {lines.entry(), builtLines, counted(), lookedUp(other, "(null)", 1221), lines.exit()});
    };
    EXPECT_THAT(traceOf([&] { associators(source, {.associationClass = other}); }),
        ElementsAreArray(expected("SensorElementCapabilities_Associators")));
    EXPECT_THAT(traceOf([&] { associatorNames(source, {.associationClass = other}); }),
        ElementsAreArray(expected("SensorElementCapabilities_AssociatorNames")));
}

TEST_F(ElementCapabilitiesTraceTest, OfReferences)
{
    const HandlerLines instances = handler("SensorElementCapabilities_References");
    const HandlerLines names = handler("SensorElementCapabilities_ReferenceNames");
    const Host::ObjectPath& source = capabilities();
    EXPECT_THAT(traceOf([&] { references(source, {.resultClass = "not passed on"}); }),
        ElementsAreArray(sequence({instances.entry(), builtLines, counted(),
            lookedUp(Class, "(null)", 1252), sensorPaths, instances.exit()})));
    EXPECT_THAT(traceOf([&] { referenceNames(source, {.resultClass = "not passed on"}); }),
        ElementsAreArray(sequence({names.entry(), builtLines, counted(),
            lookedUp(Class, "(null)", 1252), sensorPaths, names.exit()})));
}

TEST_F(ElementCapabilitiesEmptyTraceTest, OfSensorsThatAreNotThere)
{
    const Host::ObjectPath& source = capabilities();
    const auto expected = [](const std::string& function) {
        const HandlerLines lines = handler(function);
        return sequence(
            {lines.entry(), builtWithoutSensors, counted(), lookedUp(Class, "(null)", 1252),
                sensorPaths, lines.failure("getAllSensorCMPIObjPaths failed"), lines.exit()});
    };
    EXPECT_THAT(traceOf([&] { associatorNames(source); }),
        ElementsAreArray(expected("SensorElementCapabilities_AssociatorNames")));
    EXPECT_THAT(traceOf([&] { references(source); }),
        ElementsAreArray(expected("SensorElementCapabilities_References")));
    EXPECT_THAT(traceOf([&] { referenceNames(source); }),
        ElementsAreArray(expected("SensorElementCapabilities_ReferenceNames")));
}

TEST_F(ElementCapabilitiesTraceTest, OfASourceWithoutTarget)
{
    const Host::ObjectPath& source = system("host");
    const auto expected = [](const std::string& request, const std::string& text) {
        const HandlerLines lines = handler("SensorElementCapabilities_" + request);
        return sequence({lines.entry(), builtLines, counted(), lookedUp(Class, "(null)", 1259),
            lines.failure("Object Path is NULL in " + text), lines.exit()});
    };
    EXPECT_THAT(traceOf([&] { associators(source); }),
        ElementsAreArray(expected("Associators", "Associators")));
    EXPECT_THAT(traceOf([&] { associatorNames(source); }),
        ElementsAreArray(expected("AssociatorNames", "AssociatorsNames")));
    EXPECT_THAT(traceOf([&] { references(source); }),
        ElementsAreArray(expected("References", "References")));
    EXPECT_THAT(traceOf([&] { referenceNames(source); }),
        ElementsAreArray(expected("ReferenceNames", "ReferenceNames")));
}

} // namespace ElementCapabilitiesTraceTests
