// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorElementCapabilities when calls of the broker fail.

#include "tests/providers/ElementCapabilitiesFaultTest.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesInstanceFaultTests {

using namespace Testing;
using namespace Testing::ElementCapabilities;
using namespace ::testing;

const std::string columnGap(21, ' ');

class ElementCapabilitiesInstanceFaultTest : public ElementCapabilitiesFaultTest {
protected:
    // Expects this report of a failure by the builder, and an empty result with status OK.
    void expectBuilderFailure(const Fault& fault, const std::string& statusText,
        const std::string& traceText, const std::string& messageText)
    {
        for (const RequestKind& kind : {instanceRequest, oneInstance}) {
            const auto [request, lines] = runTraced(kind, fault);
            expectEmptyAnswer(*request, statusText, {2, provider, traceText});
            const HandlerLines builder = handler("sensorElementCapabilitiesCMPIInstances");
            const HandlerLines outer =
                handler(kind.name == "instances" ? "SensorElementCapabilities_EnumInstances"
                                                 : "SensorElementCapabilities_GetInstance");
            EXPECT_THAT(lines, ElementsAreArray(sequence({outer.entry(), builder.entry(),
                                   builder.failure(messageText), builder.exit(), outer.exit()})));
        }
    }

    // Expects the enumeration of names to end with this status.
    void expectNamesFailure(
        const Fault& fault, const std::string& statusText, const std::string& traceText)
    {
        const auto [request, lines] = runTraced(nameRequest, fault);
        expectBrokenOff(*request, statusText);
        EXPECT_THAT(request->messages, ElementsAre(BrokerMessage{2, provider, traceText}));
        const HandlerLines names = handler("SensorElementCapabilities_EnumInstanceNames");
        EXPECT_THAT(lines,
            ElementsAreArray(sequence({names.entry(), names.failure(statusText), names.exit()})));
    }
};

// ---- The iteration over all pairs. Paths are made in this order: both sensors, then for each
// ---- sensor the capabilities and the association. A sensor has four keys, capabilities one. ----

constexpr unsigned firstSensor = 1;
constexpr unsigned firstCapabilities = 3;
constexpr unsigned firstAssociation = 4;
constexpr unsigned secondAssociation = 6;
constexpr unsigned lastKeyOfFirstSensor = 4;
constexpr unsigned keyOfFirstCapabilities = 9;

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesWithoutSensorPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : undelivered) {
        const auto [request, lines] =
            runTraced(nameRequest, {BrokerCall::newObjectPath, firstSensor, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed.");
        EXPECT_EQ(request->messages.size(), 1U); // the factory's
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesWithoutCapabilitiesPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : undelivered) {
        const auto [request, lines] =
            runTraced(nameRequest, {BrokerCall::newObjectPath, firstCapabilities, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed");
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed" + columnGap + "for ElementCapabilities";
    for (const FaultManner manner : undelivered)
        expectNamesFailure({BrokerCall::newObjectPath, firstAssociation, manner}, text, text + ".");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesBeforeAFailureAreDelivered)
{
    const auto request =
        run(nameRequest, {BrokerCall::newObjectPath, secondAssociation, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->answer.paths().size(), 1U);
    EXPECT_FALSE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtASensorPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for Sensor class";
    expectNamesFailure(
        {BrokerCall::addKey, lastKeyOfFirstSensor, FaultManner::lostHandle}, text, text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtACapabilitiesPathThatIsGone)
{
    expectNamesFailure({BrokerCall::addKey, keyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + columnGap + "NULL for SensorEnabledLogicalElementCap",
        "CMPIObjectPath is NULL for" + columnGap + "EnabledLogicalElementCap");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsSensorPathsThatCannotBeMade)
{
    for (const FaultManner manner : undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, firstSensor, manner},
            "Create CMPIObjectPath failed.",
            "***Can't get Sensor ObjectPaths." + std::string(13, ' ') +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsCapabilitiesPathsThatCannotBeMade)
{
    const std::string gap(17, ' ');
    for (const FaultManner manner : undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, firstCapabilities, manner},
            "Create CMPIObjectPath failed",
            "***Can't get ObjectPaths for" + gap + "EnabledLogicalElementCap" + gap +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed for ElementCapabilities";
    for (const FaultManner manner : undelivered)
        for (const unsigned nth : {firstAssociation, secondAssociation})
            expectBuilderFailure({BrokerCall::newObjectPath, nth, manner}, text, text + ".", text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsASensorPathThatIsGone)
{
    expectBuilderFailure({BrokerCall::addKey, lastKeyOfFirstSensor, FaultManner::lostHandle},
        "CMPIObjectPath is" + std::string(17, ' ') + "NULL for Sensor",
        "CMPIObjectPath is NULL for Sensor", "CMPIObjectPath is NULL for Sensor");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsACapabilitiesPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for EnabledLogicalElementCap";
    expectBuilderFailure({BrokerCall::addKey, keyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + columnGap + "NULL for EnabledLogicalElementCap", text, text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, AnInstanceThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : undelivered) {
        const auto request = run(instanceRequest, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.refused(), 1U);
        EXPECT_EQ(request->answer.instances().size(), 1U);
        EXPECT_TRUE(request->answer.isDone());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, AnInstanceThatCannotBeMadeIsPassedOverInASearch)
{
    for (const FaultManner manner : undelivered) {
        const auto request = run(oneInstance, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.instances().size(), 1U); // the pair is the second one
        EXPECT_EQ(request->answer.refused(), 0U);
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheFilterIsSetBeforeTheReferences)
{
    run(instanceRequest, {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus});
    const std::vector<BrokerCall>& calls = faulty_->calls();
    EXPECT_LT(std::find(calls.begin(), calls.end(), BrokerCall::setPropertyFilter),
        std::find(calls.begin(), calls.end(), BrokerCall::setProperty));
}

TEST_F(ElementCapabilitiesInstanceFaultTest, APathThatCannotCountItsKeysHasNone)
{
    const auto request = run(oneInstance, {BrokerCall::getKeyCount, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(), "At least one key should be passed");
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesInstanceFaultTest, APathWhoseKeyCountReportsAFailureLeavesTheStatus)
{
    const auto request = run(oneInstance, {BrokerCall::getKeyCount, 1, FaultManner::errorStatus});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_EQ(request->answer.instances().size(), 1U);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheCapabilitiesAreGivenTheirNamespaceBeforeTheSensor)
{
    expectNameSpacesInOrder(nameRequest, Class, CapabilitiesClass, SensorClass);
    // Three times for each of two sensors: by its provider, before the capabilities are read and
    // after that.
    EXPECT_EQ(timesCalled("setNameSpace", SensorClass), 6);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, EveryValueIsWhole)
{
    expectWholeValues(nameRequest, instanceRequest, {"Capabilities", CapabilitiesClass});
}

} // namespace ElementCapabilitiesInstanceFaultTests
