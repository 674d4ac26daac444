// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorElementCapabilities when any call of the broker fails, and those for
// associated objects in detail.

#include "tests/providers/ElementCapabilitiesFaultTest.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesAssociationFaultTests {

using namespace Testing;
using namespace Testing::ElementCapabilities;
using namespace ::testing;

// ---- Every call in every manner ----

class ElementCapabilitiesFaultSweepTest : public ElementCapabilitiesFaultTest,
                                          public ::testing::WithParamInterface<RequestKind> {};

INSTANTIATE_TEST_SUITE_P(Instances, ElementCapabilitiesFaultSweepTest,
    ::testing::Values(
        nameRequest, instanceRequest, oneInstance, kinds.one("instanceWithoutKeys", keylessSource)),
    ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromSensor, ElementCapabilitiesFaultSweepTest,
    ::testing::ValuesIn(requestsFromSensor), ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromCapabilities, ElementCapabilitiesFaultSweepTest,
    ::testing::ValuesIn(requestsFromCapabilities), ::testing::PrintToStringParamName());

TEST_P(ElementCapabilitiesFaultSweepTest, IsSurvivedAndAnswersWithNothingMadeUp)
{
    sweepFaults(broker_, [&](FaultyBroker& faulty) {
        const FaultyRequest request(broker_, faulty, GetParam());
        EXPECT_LE(request.answer.paths().size() + request.answer.instances().size(), 2U);
        expectWellFormed(
            request, Class, {{"ManagedElement", SensorClass}, {"Capabilities", CapabilitiesClass}});
    });
}

class ElementCapabilitiesAssociationFaultTest : public ElementCapabilitiesFaultTest {};

// ---- Associated objects. The first path that is made is the target; for references the
// ---- association's follows, and then come the far ends. ----

TEST_F(ElementCapabilitiesAssociationFaultTest, ATargetThatCannotBeMadeIsNoTarget)
{
    const std::string names[] = {"Associators", "AssociatorsNames", "References", "ReferenceNames"};
    for (const FaultManner manner : undelivered)
        for (const auto& kinds : {requestsFromSensor, requestsFromCapabilities})
            for (const Which which : {Associators, AssociatorNames, References, ReferenceNames}) {
                const auto request =
                    run(kinds[which], {BrokerCall::newObjectPath, 1, manner, CMPI_RC_OK});
                const std::string text = "Object Path is NULL in " + names[which] + ".";
                expectBrokenOff(*request, text);
                EXPECT_EQ(request->lastMessage(), (BrokerMessage{2, provider, text}));
            }
}

// Each fetch of the paths ends with its own trace line.
TEST_F(ElementCapabilitiesAssociationFaultTest, FarEndsThatCannotBeMadeEndInTheFactorysStatus)
{
    const std::string functions[] = {"", "SensorElementCapabilities_AssociatorNames",
        "SensorElementCapabilities_References", "SensorElementCapabilities_ReferenceNames"};
    for (const Which which : {AssociatorNames, References, ReferenceNames})
        for (const bool fromSensor : {true, false}) {
            const auto [request, lines] =
                runTraced((fromSensor ? requestsFromSensor : requestsFromCapabilities)[which],
                    {BrokerCall::newObjectPath, which == AssociatorNames ? 2U : 3U,
                        FaultManner::nullResult});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(request->message(),
                fromSensor ? "Create CMPIObjectPath failed" : "Create CMPIObjectPath failed.");
            EXPECT_THAT(request->answer.paths(), IsEmpty());
            EXPECT_THAT(request->answer.instances(), IsEmpty());
            const HandlerLines expected = handler(functions[which]);
            EXPECT_THAT(lines,
                ElementsAreArray(sequence({expected.entry(),
                    expected.failure(fromSensor
                                         ? "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed"
                                         : "getAllSensorCMPIObjPaths failed"),
                    expected.exit()})));
        }
}

TEST_F(ElementCapabilitiesAssociationFaultTest, WithoutAnAssociationPathThereAreNoReferences)
{
    for (const FaultManner manner : undelivered)
        for (const Which which : {References, ReferenceNames}) {
            const auto [request, lines] = runTraced(requestsFromSensor[which],
                {BrokerCall::newObjectPath, 2, manner, CMPI_RC_ERR_FAILED});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED); // as the broker left it
            const HandlerLines expected =
                handler(which == References ? "SensorElementCapabilities_References"
                                            : "SensorElementCapabilities_ReferenceNames");
            EXPECT_EQ(lines, sequence({expected.entry(), expected.exit()}));
            EXPECT_THAT(request->answer.paths(), IsEmpty());
            EXPECT_THAT(request->answer.instances(), IsEmpty());
            EXPECT_EQ(request->answer.refused(), 0U);
        }
}

TEST_F(ElementCapabilitiesAssociationFaultTest, EveryAssociatorNameIsGivenItsNamespaceOnceMore)
{
    run(requestsFromCapabilities[AssociatorNames], std::vector<Fault>{});
    EXPECT_EQ(timesCalled("setNameSpace", SensorClass), 1 + 2 * 2); // and the target's
    run(requestsFromSensor[AssociatorNames], std::vector<Fault>{});
    EXPECT_EQ(timesCalled("setNameSpace", CapabilitiesClass), 1 + 2);
}

TEST_F(ElementCapabilitiesAssociationFaultTest, AssociatorsEndInTheStatusThatTheBrokerLeft)
{
    const auto capabilities = run(requestsFromSensor[Associators],
        {BrokerCall::newObjectPath, 2, FaultManner::nullResult, CMPI_RC_ERR_ACCESS_DENIED});
    EXPECT_EQ(capabilities->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    const auto sensors = runWithLast(requestsFromCapabilities[Associators], BrokerCall::newArray);
    EXPECT_EQ(sensors->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(sensors->answer.instances().size(), 2U);
}

TEST_F(ElementCapabilitiesAssociationFaultTest, AReferenceThatCannotBeMadeIsLeftOut)
{
    for (const FaultManner manner : undelivered)
        for (const Which which : {References, ReferenceNames}) {
            const auto request =
                run(requestsFromCapabilities[which], {BrokerCall::newInstance, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(request->answer.paths().size() + request->answer.instances().size(), 1U);
            EXPECT_EQ(request->answer.refused(), 0U);
        }
}

TEST_F(ElementCapabilitiesAssociationFaultTest, AReferenceWhosePathIsNotReturnedIsLeftOutOfTheNames)
{
    for (const FaultManner manner : undelivered) {
        const auto request =
            run(requestsFromCapabilities[ReferenceNames], {BrokerCall::getObjectPath, 1, manner});
        EXPECT_EQ(request->answer.paths().size(), 1U);
        EXPECT_EQ(request->answer.refused(), 0U);
    }
}

TEST_F(ElementCapabilitiesAssociationFaultTest, AMissingArrayStandsInTheStatusBesideTheAssociator)
{
    const auto request = run(requestsFromSensor[Associators],
        {BrokerCall::newArray, 1, FaultManner::nullResult, CMPI_RC_OK});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(),
        "Creating array for Property" + std::string(25, ' ') + "RequestedStatesSupported failed.");
    EXPECT_EQ(request->lastMessage().component, "SensorEnabledLogicalElementCapabilitiesProvider");
    ASSERT_EQ(request->answer.instances().size(), 1U);
    EXPECT_EQ(request->answer.instances()[0]->properties().size(), 2U);
}

TEST_F(ElementCapabilitiesAssociationFaultTest, AnAssociatorThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : undelivered)
        for (const auto& kinds : {requestsFromSensor, requestsFromCapabilities}) {
            const auto request = run(kinds[Associators], {BrokerCall::newInstance, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(request->answer.refused(), 1U);
        }
}

// The status of the request is not passed to the call that returns the path of an instance.
TEST_F(ElementCapabilitiesAssociationFaultTest, APathThatIsNotReturnedLeavesTheStatus)
{
    const Fault fault = {BrokerCall::getObjectPath, 2, FaultManner::nullResult}; // the last
    for (const RequestKind& kind : {oneInstance, requestsFromCapabilities[ReferenceNames]})
        EXPECT_EQ(run(kind, fault)->status.rc, CMPI_RC_OK) << kind;
}

TEST_F(ElementCapabilitiesAssociationFaultTest, NamespacesAndClassNamesLeaveTheStatus)
{
    const RequestKind alongAnother = {
        "alongAnother", sensorSource, [](auto* broker, auto* context, auto* result, auto* path) {
            CMPIAssociationMI* const mi = kinds.associationFactory(broker, nullptr, nullptr);
            return mi->ft->associators(mi, context, result, path, "ZUMLO_SensorSystemDevice",
                nullptr, nullptr, nullptr, nullptr);
        }};
    EXPECT_EQ(runWithLast(alongAnother, BrokerCall::getCharPtr)->status.rc, CMPI_RC_OK);
    const auto unnamed =
        runWithLast(alongAnother, BrokerCall::getClassName, FaultManner::nullResult);
    EXPECT_EQ(unnamed->status.rc, CMPI_RC_OK);
    expectNamespacesLeaveTheStatus(nameRequest);
    for (const auto& kinds : {requestsFromSensor, requestsFromCapabilities})
        for (const Which which : {Associators, AssociatorNames, References, ReferenceNames})
            expectNamespacesLeaveTheStatus(kinds[which]);
}

} // namespace ElementCapabilitiesAssociationFaultTests
