// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instances of ZUMLO_SensorElementCapabilities when calls of the broker fail.

#include "tests/providers/ElementCapabilitiesFaultTest.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesInstanceFaultTests {

using namespace Testing;
using namespace Testing::ElementCapabilities;
using namespace ::testing;

const std::string Gap(21, ' ');

class ElementCapabilitiesInstanceFaultTest : public ElementCapabilitiesFaultTest {
protected:
    // Expects this report of a failure by the builder, and an empty result with status OK.
    void expectBuilderFailure(const Fault& fault, const std::string& statusText,
        const std::string& traceText, const std::string& messageText)
    {
        for (const RequestKind& kind : {Instances, OneInstance}) {
            const auto [request, lines] = runTraced(kind, fault);
            expectEmptyAnswer(*request, statusText, {2, Provider, traceText});
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
        const auto [request, lines] = runTraced(Names, fault);
        expectBrokenOff(*request, statusText);
        EXPECT_THAT(request->messages, ElementsAre(BrokerMessage{2, Provider, traceText}));
        const HandlerLines names = handler("SensorElementCapabilities_EnumInstanceNames");
        EXPECT_THAT(lines,
            ElementsAreArray(sequence({names.entry(), names.failure(statusText), names.exit()})));
    }
};

// ---- The iteration over all pairs. Paths are made in this order: both sensors, then for each
// ---- sensor the capabilities and the association. A sensor has four keys, capabilities one. ----

constexpr unsigned FirstSensor = 1;
constexpr unsigned FirstCapabilities = 3;
constexpr unsigned FirstAssociation = 4;
constexpr unsigned SecondAssociation = 6;
constexpr unsigned LastKeyOfFirstSensor = 4;
constexpr unsigned KeyOfFirstCapabilities = 9;

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesWithoutSensorPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : Undelivered) {
        const auto [request, lines] =
            runTraced(Names, {BrokerCall::newObjectPath, FirstSensor, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed.");
        EXPECT_EQ(request->messages.size(), 1U); // the factory's
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesWithoutCapabilitiesPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : Undelivered) {
        const auto [request, lines] =
            runTraced(Names, {BrokerCall::newObjectPath, FirstCapabilities, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed");
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed" + Gap + "for ElementCapabilities";
    for (const FaultManner manner : Undelivered)
        expectNamesFailure({BrokerCall::newObjectPath, FirstAssociation, manner}, text, text + ".");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesBeforeAFailureAreDelivered)
{
    const auto request =
        run(Names, {BrokerCall::newObjectPath, SecondAssociation, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->answer.paths().size(), 1U);
    EXPECT_FALSE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtASensorPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for Sensor class";
    expectNamesFailure(
        {BrokerCall::addKey, LastKeyOfFirstSensor, FaultManner::lostHandle}, text, text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, NamesEndAtACapabilitiesPathThatIsGone)
{
    expectNamesFailure({BrokerCall::addKey, KeyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + Gap + "NULL for SensorEnabledLogicalElementCap",
        "CMPIObjectPath is NULL for" + Gap + "EnabledLogicalElementCap");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsSensorPathsThatCannotBeMade)
{
    for (const FaultManner manner : Undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, FirstSensor, manner},
            "Create CMPIObjectPath failed.",
            "***Can't get Sensor ObjectPaths." + std::string(13, ' ') +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsCapabilitiesPathsThatCannotBeMade)
{
    const std::string gap(17, ' ');
    for (const FaultManner manner : Undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, FirstCapabilities, manner},
            "Create CMPIObjectPath failed",
            "***Can't get ObjectPaths for" + gap + "EnabledLogicalElementCap" + gap +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed for ElementCapabilities";
    for (const FaultManner manner : Undelivered)
        for (const unsigned nth : {FirstAssociation, SecondAssociation})
            expectBuilderFailure({BrokerCall::newObjectPath, nth, manner}, text, text + ".", text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsASensorPathThatIsGone)
{
    expectBuilderFailure({BrokerCall::addKey, LastKeyOfFirstSensor, FaultManner::lostHandle},
        "CMPIObjectPath is" + std::string(17, ' ') + "NULL for Sensor",
        "CMPIObjectPath is NULL for Sensor", "CMPIObjectPath is NULL for Sensor");
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheBuilderReportsACapabilitiesPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for EnabledLogicalElementCap";
    expectBuilderFailure({BrokerCall::addKey, KeyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + Gap + "NULL for EnabledLogicalElementCap", text, text);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, AnInstanceThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : Undelivered) {
        const auto request = run(Instances, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.refused(), 1U);
        EXPECT_EQ(request->answer.instances().size(), 1U);
        EXPECT_TRUE(request->answer.isDone());
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, AnInstanceThatCannotBeMadeIsPassedOverInASearch)
{
    for (const FaultManner manner : Undelivered) {
        const auto request = run(OneInstance, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.instances().size(), 1U); // the pair is the second one
        EXPECT_EQ(request->answer.refused(), 0U);
    }
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheFilterIsSetBeforeTheReferences)
{
    run(Instances, {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus});
    const std::vector<BrokerCall>& calls = faulty_->calls();
    EXPECT_LT(std::find(calls.begin(), calls.end(), BrokerCall::setPropertyFilter),
        std::find(calls.begin(), calls.end(), BrokerCall::setProperty));
}

TEST_F(ElementCapabilitiesInstanceFaultTest, APathThatCannotCountItsKeysHasNone)
{
    const auto request = run(OneInstance, {BrokerCall::getKeyCount, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(), "At least one key should be passed");
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesInstanceFaultTest, APathWhoseKeyCountReportsAFailureLeavesTheStatus)
{
    const auto request = run(OneInstance, {BrokerCall::getKeyCount, 1, FaultManner::errorStatus});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_EQ(request->answer.instances().size(), 1U);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, TheCapabilitiesAreGivenTheirNamespaceBeforeTheSensor)
{
    expectNameSpacesInOrder(Names, Class, CapabilitiesClass, SensorClass);
}

TEST_F(ElementCapabilitiesInstanceFaultTest, EveryValueIsWhole)
{
    expectWholeValues(Names, Instances, {"Capabilities", CapabilitiesClass});
}

} // namespace ElementCapabilitiesInstanceFaultTests
