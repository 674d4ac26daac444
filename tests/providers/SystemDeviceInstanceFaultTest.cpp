// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorSystemDevice when calls of the broker fail.

#include "tests/providers/SystemDeviceFaultTest.h"

#include <gmock/gmock.h>

namespace SystemDeviceInstanceFaultTests {

using namespace Testing;
using namespace Testing::SystemDevice;
using namespace ::testing;

const std::string columnGap(21, ' ');

class SystemDeviceInstanceFaultTest : public SystemDeviceFaultTest {
protected:
    // Expects this report of a failure by the builder, and an empty result with status OK.
    void expectBuilderFailure(const Fault& fault, const std::string& statusText,
        const std::string& traceText, bool hasExitMark)
    {
        for (const RequestKind& kind : {instanceRequest, oneInstance}) {
            const auto [request, lines] = runTraced(kind, fault);
            expectEmptyAnswer(*request, statusText, {2, provider, traceText});
            const HandlerLines builder = {
                "SenosrSystemDeviceProvider", provider, "sensorSystemDeviceCMPIInstances"};
            const HandlerLines outer =
                handler(kind.name == "instances" ? "EnumInstances" : "GetInstance");
            EXPECT_THAT(lines, ElementsAreArray(sequence({outer.entry(), builder.entry(),
                                   hasExitMark ? builder.exit() : Lines(), outer.exit()})));
        }
    }

    // Expects the enumeration of names to end with this status and an open result.
    std::unique_ptr<FaultyRequest> expectNamesFailure(const Fault& fault,
        const std::string& statusText, const std::string& traceText, bool hasExitMark)
    {
        auto [request, lines] = runTraced(nameRequest, fault);
        expectBrokenOff(*request, statusText);
        EXPECT_THAT(request->messages, ElementsAre(BrokerMessage{2, provider, traceText}));
        const HandlerLines names = handler("EnumInstanceNames");
        EXPECT_THAT(lines,
            ElementsAreArray(sequence({names.entry(), hasExitMark ? names.exit() : Lines()})));
        return std::move(request);
    }
};

// ---- The iteration over all pairs. Paths are made in this order: the class of systems, then for
// ---- each system both sensors and their associations. ----

constexpr unsigned systemPath = 1;
constexpr unsigned firstSensor = 2;
constexpr unsigned firstAssociation = 4;
constexpr unsigned lastAssociation = 9;
constexpr unsigned lastKeyOfFirstSensor = 4;

TEST_F(SystemDeviceInstanceFaultTest, NamesEndAtASystemPathThatCannotBeMade)
{
    for (const FaultManner manner : undelivered)
        for (const BrokerCall call : {BrokerCall::newObjectPath, BrokerCall::getNameSpace})
            expectNamesFailure({call, systemPath, manner}, "Create CMPIObjectPath failed.",
                "Create CMPIObjectPath failed for ComputerSystemClass.", true);
    EXPECT_THAT(systems_.calls, IsEmpty());
}

TEST_F(SystemDeviceInstanceFaultTest, NamesEndAtASensorPathThatIsGone)
{
    expectNamesFailure({BrokerCall::addKey, lastKeyOfFirstSensor, FaultManner::lostHandle},
        "CMPIObjectPath is NULL for Sensor", "CMPIObjectPath is NULL for Sensor Class", false);
}

TEST_F(SystemDeviceInstanceFaultTest, NamesEndAtAnAssociationPathThatCannotBeMade)
{
    for (const FaultManner manner : undelivered)
        for (const unsigned nth : {firstAssociation, lastAssociation}) {
            const auto request = expectNamesFailure({BrokerCall::newObjectPath, nth, manner},
                "Create CMPIObjectPath failed" + columnGap + "for SensorSystemDeviceProvider.",
                "Create CMPIObjectPath failed for" + columnGap + "SensorSystemDeviceClass.", false);
            EXPECT_EQ(request->answer.paths().size(), nth == firstAssociation ? 0U : 3U);
        }
}

TEST_F(SystemDeviceInstanceFaultTest, NamesWithoutSensorPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : undelivered) {
        const auto [request, lines] =
            runTraced(nameRequest, {BrokerCall::newObjectPath, firstSensor, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed.");
        EXPECT_EQ(request->messages.size(), 1U); // the factory's
        EXPECT_EQ(lines, handler("EnumInstanceNames").entry());
    }
}

TEST_F(SystemDeviceInstanceFaultTest, NamesAnswerAFailedUpcallWithOkAndAMessage)
{
    for (const FaultManner manner :
        {FaultManner::nullResult, FaultManner::handleless, FaultManner::errorStatus}) {
        const auto request = run(nameRequest, {BrokerCall::enumerateInstanceNames, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->message(), "CBEnumInstanceNames Failed for the ZUMLO_ComputerSystem");
        EXPECT_EQ(countOf(*request), 0U);
        EXPECT_FALSE(request->answer.isDone());
        EXPECT_THAT(request->messages, IsEmpty());
    }
}

TEST_F(SystemDeviceInstanceFaultTest, AnAbsentEnumerationHasNoSystems)
{
    for (const FaultManner manner : undelivered)
        for (const RequestKind& kind : {nameRequest, instanceRequest, oneInstance}) {
            const auto request =
                run(kind, {BrokerCall::enumerateInstanceNames, 1, manner, CMPI_RC_OK});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(request->status.msg, nullptr);
            EXPECT_EQ(countOf(*request), 0U);
            EXPECT_TRUE(request->answer.isDone());
        }
}

TEST_F(SystemDeviceInstanceFaultTest, NamesEndWhereTheEnumerationBreaks)
{
    for (const BrokerCall call : {BrokerCall::hasNext, BrokerCall::getNext})
        for (const FaultManner manner : {FaultManner::nullResult, FaultManner::errorStatus}) {
            const Fault fault = {call, 2, manner, CMPI_RC_ERR_FAILED};
            const auto [request, lines] = runTraced(nameRequest, fault);
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED); // as the broker left it
            EXPECT_EQ(countOf(*request), 2U);                  // of the first system
            EXPECT_FALSE(request->answer.isDone());
            EXPECT_EQ(lines, handler("EnumInstanceNames").entry());
        }
}

TEST_F(SystemDeviceInstanceFaultTest, TheBuilderReportsASystemPathThatCannotBeMade)
{
    for (const FaultManner manner : undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, systemPath, manner},
            "Create CMPIObjectPath" + std::string(12, ' ') + "failed.",
            "Create CMPIObjectPath failed for" + std::string(13, ' ') + "ComputerSystemClass.",
            true);
}

TEST_F(SystemDeviceInstanceFaultTest, TheBuilderReportsASensorPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for Sensor Provider";
    expectBuilderFailure(
        {BrokerCall::addKey, lastKeyOfFirstSensor, FaultManner::lostHandle}, text, text, false);
}

TEST_F(SystemDeviceInstanceFaultTest, TheBuilderReportsAnAssociationPathThatCannotBeMade)
{
    for (const FaultManner manner : undelivered)
        for (const unsigned nth : {firstAssociation, lastAssociation})
            expectBuilderFailure({BrokerCall::newObjectPath, nth, manner},
                "Create CMPIObjectPath failed for HostedAccessPoint",
                "Create CMPIObjectPath failed for" + columnGap + "HostedAccessPoint.", false);
}

TEST_F(SystemDeviceInstanceFaultTest, TheBuilderEndsSilentlyAtAnUpcallAnElementOrSensorsThatFail)
{
    for (const Fault& fault :
        {Fault{BrokerCall::enumerateInstanceNames, 1, FaultManner::nullResult},
            Fault{BrokerCall::hasNext, 2, FaultManner::errorStatus},
            Fault{BrokerCall::getNext, 2, FaultManner::errorStatus},
            Fault{BrokerCall::newObjectPath, firstSensor, FaultManner::nullResult}}) {
        const auto [request, lines] = runTraced(instanceRequest, fault);
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(countOf(*request), 0U);
        EXPECT_TRUE(request->answer.isDone());
        const HandlerLines builder = {
            "SenosrSystemDeviceProvider", provider, "sensorSystemDeviceCMPIInstances"};
        const HandlerLines outer = handler("EnumInstances");
        EXPECT_EQ(lines, sequence({outer.entry(), builder.entry(), outer.exit()}));
    }
}

TEST_F(SystemDeviceInstanceFaultTest, AnInstanceThatCannotBeMadeIsPassedOnButPassedOverInASearch)
{
    for (const FaultManner manner : undelivered) {
        const auto all = run(instanceRequest, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(all->status.rc, CMPI_RC_OK);
        EXPECT_EQ(all->answer.refused(), 1U);
        EXPECT_EQ(all->answer.instances().size(), 3U);
        const auto one = run(oneInstance, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(one->status.rc, CMPI_RC_OK);
        EXPECT_EQ(countOf(*one), 1U); // the pair is the second one
    }
}

} // namespace SystemDeviceInstanceFaultTests
