// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorSystemDevice when any call of the broker fails, and those for
// associated objects in detail.

#include "tests/providers/SystemDeviceFaultTest.h"

#include <gmock/gmock.h>

namespace SystemDeviceAssociationFaultTests {

using namespace Testing;
using namespace Testing::SystemDevice;

// ---- Every call in every manner ----

class SystemDeviceFaultSweepTest : public SystemDeviceFaultTest,
                                   public ::testing::WithParamInterface<RequestKind> {};

INSTANTIATE_TEST_SUITE_P(Instances, SystemDeviceFaultSweepTest,
    ::testing::Values(
        nameRequest, instanceRequest, oneInstance, kinds.one("instanceWithoutKeys", keylessSource)),
    ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromSensor, SystemDeviceFaultSweepTest,
    ::testing::ValuesIn(requestsFromSensor), ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromSystem, SystemDeviceFaultSweepTest,
    ::testing::ValuesIn(requestsFromSystem), ::testing::PrintToStringParamName());

TEST_P(SystemDeviceFaultSweepTest, IsSurvivedAndAnswersWithNothingMadeUp)
{
    sweepFaults(broker_, [&](FaultyBroker& faulty) {
        const FaultyRequest request(broker_, faulty, GetParam());
        EXPECT_LE(request.answer.paths().size() + request.answer.instances().size(), 4U);
        expectWellFormed(
            request, Class, {{"GroupComponent", SystemClass}, {"PartComponent", SensorClass}});
    });
}

class SystemDeviceAssociationFaultTest : public SystemDeviceFaultTest {};

// ---- Associated objects. The first path that is made is the target, the second one of references
// ---- is the association's. ----

TEST_F(SystemDeviceAssociationFaultTest, ATargetThatCannotBeMadeIsNoTarget)
{
    for (const FaultManner manner : undelivered)
        for (const auto& kinds : {requestsFromSensor, requestsFromSystem})
            for (const Which which : {Associators, AssociatorNames, References, ReferenceNames}) {
                const auto request = run(kinds[which], {BrokerCall::newObjectPath, 1, manner});
                EXPECT_EQ(countOf(*request), 0U);
                EXPECT_FALSE(request->answer.isDone());
                if (which == Associators || which == AssociatorNames) {
                    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
                    EXPECT_EQ(request->status.msg, nullptr);
                    continue;
                }
                const std::string text = "Object Path is NULL in " + requests[which] + ".";
                EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
                EXPECT_EQ(request->message(), text);
                EXPECT_EQ(request->lastMessage(), (BrokerMessage{2, provider, text}));
            }
}

// The broker may report a failure for the last text that the provider reads.
TEST_F(SystemDeviceAssociationFaultTest, AResultClassThatIsNotServedIsAnsweredWithOk)
{
    for (const SourceMaker& source : {sensorSource, systemSource}) {
        const RequestKind kind = {
            "", source, [](auto* broker, auto* context, auto* result, auto* path) {
                CMPIAssociationMI* const mi = kinds.associationFactory(broker, nullptr, nullptr);
                return mi->ft->associatorNames(
                    mi, context, result, path, Class, "CIM_LogicalDevice", nullptr, nullptr);
            }};
        faulty_.reset();
        unsigned last = 0;
        {
            FaultyBroker counting(broker_);
            const FaultyRequest counted(broker_, counting, kind);
            last = counting.count(BrokerCall::getCharPtr);
        }
        const auto request = run(kind, {BrokerCall::getCharPtr, last, FaultManner::errorStatus});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(countOf(*request), 0U);
    }
}

TEST_F(SystemDeviceAssociationFaultTest, SensorPathsThatCannotBeMadeEndInTheFactorysStatus)
{
    for (const Which which : {AssociatorNames, References, ReferenceNames}) {
        const unsigned nth = which == AssociatorNames ? 2 : 3;
        const Fault fault = {BrokerCall::newObjectPath, nth, FaultManner::nullResult};
        const auto [request, lines] = runTraced(requestsFromSystem[which], fault);
        EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request->message(), "Create CMPIObjectPath failed.");
        EXPECT_EQ(countOf(*request), 0U);
        const HandlerLines expected = handler(requests[which]);
        EXPECT_EQ(
            lines, sequence({expected.entry(), expected.failure("getAllSensorCMPIObjPaths failed"),
                       expected.exit()}));
    }
}

TEST_F(SystemDeviceAssociationFaultTest, WithoutAnAssociationPathThereAreNoReferences)
{
    for (const auto& kinds : {requestsFromSensor, requestsFromSystem})
        for (const Which which : {References, ReferenceNames}) {
            const Fault fault = {BrokerCall::newObjectPath, 2, FaultManner::nullResult};
            const auto [request, lines] = runTraced(kinds[which], fault);
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED); // as the broker left it
            EXPECT_EQ(countOf(*request), 0U);
            const HandlerLines expected = handler(requests[which]);
            EXPECT_EQ(lines, sequence({expected.entry(), expected.exit()}));
        }
}

TEST_F(SystemDeviceAssociationFaultTest, AnAssociatorThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : undelivered) {
        const auto request =
            run(requestsFromSystem[Associators], {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.refused(), 1U);
    }
}

// The status of the request is not passed to the call that returns the path of an instance.
TEST_F(SystemDeviceAssociationFaultTest, APathThatIsNotReturnedLeavesTheStatus)
{
    const Fault fault = {BrokerCall::getObjectPath, 2, FaultManner::nullResult}; // the last
    for (const RequestKind& kind : {oneInstance, requestsFromSystem[ReferenceNames]})
        EXPECT_EQ(run(kind, fault)->status.rc, CMPI_RC_OK) << kind;
}

TEST_F(SystemDeviceAssociationFaultTest, APathWhoseKeyCountReportsAFailureLeavesTheStatus)
{
    const auto request = run(oneInstance, {BrokerCall::getKeyCount, 1, FaultManner::errorStatus});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_EQ(countOf(*request), 1U);
}

TEST_F(SystemDeviceAssociationFaultTest, NamespacesLeaveTheStatus)
{
    expectNamespacesLeaveTheStatus(nameRequest);
    for (const auto& kinds : {requestsFromSensor, requestsFromSystem})
        for (const Which which : {Associators, AssociatorNames, References, ReferenceNames})
            expectNamespacesLeaveTheStatus(kinds[which]);
}

TEST_F(SystemDeviceAssociationFaultTest, TheSensorIsGivenItsNamespaceBeforeTheSystem)
{
    expectNameSpacesInOrder(nameRequest, Class, SensorClass, SystemClass);
}

TEST_F(SystemDeviceAssociationFaultTest, EveryValueIsWhole)
{
    expectWholeValues(nameRequest, instanceRequest, {"GroupComponent", SystemClass});
}

TEST_F(SystemDeviceAssociationFaultTest, EveryAssociatorNameIsGivenItsNamespaceOnceMore)
{
    run(requestsFromSystem[AssociatorNames], std::vector<Fault>{});
    EXPECT_EQ(timesCalled("setNameSpace", SensorClass), 1 + 2 * 2); // and the target's
}

TEST_F(SystemDeviceAssociationFaultTest, AnAbsentEnumerationHasNoFarEnds)
{
    for (const FaultManner manner : undelivered)
        for (const Which which : {Associators, AssociatorNames, References, ReferenceNames}) {
            const BrokerCall call = which == Associators ? BrokerCall::enumerateInstances
                                                         : BrokerCall::enumerateInstanceNames;
            const auto request = run(requestsFromSensor[which], {call, 1, manner, CMPI_RC_OK});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(countOf(*request), 0U);
        }
}

TEST_F(SystemDeviceAssociationFaultTest, AssociatorsBeforeABreakAreDeliveredWithItsStatus)
{
    for (const Which which : {Associators, AssociatorNames})
        for (const BrokerCall call : {BrokerCall::hasNext, BrokerCall::getNext}) {
            const auto request =
                run(requestsFromSensor[which], {call, 2, FaultManner::errorStatus});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(countOf(*request), 1U);
        }
}

TEST_F(SystemDeviceAssociationFaultTest, ABreakBetweenFarEndsLeavesNoReferences)
{
    for (const Which which : {References, ReferenceNames})
        for (const BrokerCall call : {BrokerCall::hasNext, BrokerCall::getNext}) {
            const Fault fault = {call, 2, FaultManner::errorStatus};
            const auto [request, lines] = runTraced(requestsFromSensor[which], fault);
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(countOf(*request), 0U);
            const HandlerLines expected = handler(requests[which]);
            EXPECT_EQ(
                lines, sequence({expected.entry(),
                           expected.failure("Call to CBEnumInstances of target Class Failed.")}));
        }
}

TEST_F(SystemDeviceAssociationFaultTest, AnElementWithoutHandleIsLeftOut)
{
    for (const Which which : {Associators, AssociatorNames, References, ReferenceNames}) {
        const auto request = run(requestsFromSensor[which],
            {BrokerCall::getNext, 1, FaultManner::handleless, CMPI_RC_OK});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(countOf(*request), 1U);
    }
}

TEST_F(SystemDeviceAssociationFaultTest, AReferenceThatCannotBeMadeIsLeftOut)
{
    for (const FaultManner manner : undelivered)
        for (const auto& kinds : {requestsFromSensor, requestsFromSystem})
            for (const Which which : {References, ReferenceNames}) {
                const auto request = run(kinds[which], {BrokerCall::newInstance, 1, manner});
                EXPECT_EQ(request->status.rc, CMPI_RC_OK);
                EXPECT_EQ(countOf(*request), 1U);
            }
}

} // namespace SystemDeviceAssociationFaultTests
