// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests for which the factory fails to enumerate instances.

#include "tests/providers/AssociationTest.h"
#include "tests/providers/Factories.h"
#include "tests/providers/FailingEnumerations.h"
#include "tests/providers/RequestTrace.h"

#include <gmock/gmock.h>

namespace EnumerationFailureTests {

using ::testing::ElementsAreArray;
using namespace Testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

const char* const sensorsFailed = "getAllSensorCMPIInstances failed";
const char* const capabilitiesFailed = "getAllSensorEnabledLogicalElementCapCMPIInstances failed";

class EnumerationFailureTest : public ProviderTest {
protected:
    Lines traceOfEnumeration(CMPIInstanceMI* mi)
    {
        const CMPIObjectPath* const ref = path("ANY_Class").handle();
        return traceOf(
            [&] { status_ = mi->ft->enumerateInstances(mi, context(), result(), ref, nullptr); });
    }

    // Returns the trace of GetInstance for a path without the key of the record.
    Lines traceOfSearch(CMPIInstanceMI* mi)
    {
        const CMPIObjectPath* const ref = path("ANY_Class", {{"Other", "x"}}).handle();
        return traceOf(
            [&] { status_ = mi->ft->getInstance(mi, context(), result(), ref, nullptr); });
    }

    // Expects an open result and the status that the factory set.
    void expectGivenUp() const
    {
        EXPECT_EQ(status_.rc, failedEnumeration);
        EXPECT_EQ(status_.msg, nullptr);
        EXPECT_TRUE(answer_.instances().empty());
        EXPECT_EQ(answer_.refused(), 0U);
        EXPECT_FALSE(answer_.isDone());
        EXPECT_TRUE(messages_.empty());
    }

    const ScriptedMachine machine_{{{NodeType::Tachometer, "/f", "Fan", NodeReading{}}}};
    CMPIInstanceMI* sensors_ = SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr);
    CMPIInstanceMI* capabilities_ =
        SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
            broker(), nullptr, nullptr);
    CMPIStatus status_ = {CMPI_RC_OK, nullptr};
};

HandlerLines sensorHandler(const std::string& request)
{
    return {"SensorProfileProvider", "SensorProvider", "Sensor_" + request};
}

HandlerLines capabilitiesHandler(const std::string& request)
{
    const std::string module = "SensorEnabledLogicalElementCapabilitiesProvider";
    return {module, module, "SensorEnabledLogicalElementCapabilities_" + request};
}

TEST_F(EnumerationFailureTest, EndsAnEnumerationOfSensors)
{
    const HandlerLines lines = sensorHandler("EnumInstances");
    EXPECT_THAT(traceOfEnumeration(sensors_),
        ElementsAreArray(sequence({lines.entry(136), builtFactory({"_createSensorMap"}), counted(),
            lines.failure(sensorsFailed, 155), lines.exit(157)})));
    expectGivenUp();
}

TEST_F(EnumerationFailureTest, EndsTheSearchForASensor)
{
    const HandlerLines lines = sensorHandler("GetInstance");
    EXPECT_THAT(traceOfSearch(sensors_),
        ElementsAreArray(sequence({lines.entry(192), builtFactory({"_createSensorMap"}), counted(),
            lines.failure(sensorsFailed, 251), lines.exit(253)})));
    expectGivenUp();
}

TEST_F(EnumerationFailureTest, EndsAnEnumerationOfCapabilities)
{
    const HandlerLines lines = capabilitiesHandler("EnumInstances");
    EXPECT_THAT(traceOfEnumeration(capabilities_),
        ElementsAreArray(
            sequence({lines.entry(137), builtFactory({"_createEnabledLogicalElementCapMap"}),
                lines.failure(capabilitiesFailed, 153), lines.exit(155)})));
    expectGivenUp();
}

TEST_F(EnumerationFailureTest, EndsTheSearchForCapabilities)
{
    const HandlerLines lines = capabilitiesHandler("GetInstance");
    EXPECT_THAT(traceOfSearch(capabilities_),
        ElementsAreArray(sequence({lines.entry(191), builtFactory({"_createSensorMap"}),
            lines.failure(capabilitiesFailed, 243), lines.exit(245)})));
    expectGivenUp();
}

// ---- Associations ----

class FailingAssociationTest : public AssociationTest {
protected:
    FailingAssociationTest(InstanceFactory instances, AssociationFactory associations)
        : AssociationTest(instances, associations, {threeSensors[0]}, {"host"})
    {
    }

    // Expects the association's provider to end with the text that both failures have.
    void expectGivenUp(const Host::ObjectPath& source, const HandlerLines& handler)
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        EXPECT_THAT(ownLines(traceOf([&] { status = associators(source); })),
            ElementsAreArray(
                sequence({handler.entry(), handler.failure(sensorsFailed), handler.exit()})));
        EXPECT_EQ(status.rc, failedEnumeration);
        expectNothing(false);
    }
};

class FailingElementCapabilitiesTest : public FailingAssociationTest {
protected:
    FailingElementCapabilitiesTest()
        : FailingAssociationTest(SensorElementCapabilitiesProvider_Create_InstanceMI,
              SensorElementCapabilitiesProvider_Create_AssociationMI)
    {
    }
};

class FailingSystemDeviceTest : public FailingAssociationTest {
protected:
    FailingSystemDeviceTest()
        : FailingAssociationTest(SensorSystemDeviceProvider_Create_InstanceMI,
              SensorSystemDeviceProvider_Create_AssociationMI)
    {
    }
};

TEST_F(FailingElementCapabilitiesTest, EndsTheAssociatorsOfEitherEnd)
{
    const HandlerLines handler = {"SensorElementCapabilities", "SensorElementCapabilitiesProvider",
        "SensorElementCapabilities_Associators"};
    expectGivenUp(capabilities(), handler);
    expectGivenUp(sensor("A"), handler);
}

TEST_F(FailingSystemDeviceTest, EndsTheAssociatorsOfASystem)
{
    expectGivenUp(system("host"), {"SenosrSystemDeviceProvider", "SensorSystemDeviceProvider",
                                      "SensorSystemDevice_Associators"});
}

const auto allPairsInOrder = ::testing::ElementsAre("A 1", "A 2", "B 1", "B 2");

TEST_F(FailingElementCapabilitiesTest, NamesAreOrderedByCapabilitiesInsideSensors)
{
    expectOk(enumerateNames(path("ZUMLO_SensorElementCapabilities")));
    EXPECT_THAT(pairs("ManagedElement", "Capabilities"), allPairsInOrder);
}

TEST_F(FailingElementCapabilitiesTest, NamesWithoutCapabilitiesEndWithoutAnExitMarkInAnOpenResult)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    for (const int result : {1, 2}) {
        capabilitiesPathsResult = result;
        const Lines lines = ownLines(
            traceOf([&] { status = enumerateNames(path("ZUMLO_SensorElementCapabilities")); }));
        capabilitiesPathsResult = 0;
        const HandlerLines handler = {"SensorElementCapabilities",
            "SensorElementCapabilitiesProvider", "SensorElementCapabilities_EnumInstanceNames"};
        EXPECT_EQ(lines, handler.entry());
        expectOk(status);
        expectNothing(false);
    }
}

TEST_F(FailingElementCapabilitiesTest, InstancesAreOrderedByCapabilitiesInsideSensors)
{
    expectOk(enumerate(path("ZUMLO_SensorElementCapabilities")));
    EXPECT_THAT(pairs("ManagedElement", "Capabilities"), allPairsInOrder);
}

} // namespace EnumerationFailureTests
