// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of the capabilities class when calls of the broker fail.

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"

#include <gmock/gmock.h>

namespace CapabilitiesProviderFaultTests {

using ::testing::ElementsAre;
using namespace Testing;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* provider = "SensorEnabledLogicalElementCapabilitiesProvider";

const RequestKinds kinds = {
    SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI, nullptr};
const RequestKind nameRequest = kinds.names(pathMaker(Class));
const RequestKind instanceRequest = kinds.instances(pathMaker(Class));
const RequestKind oneInstance = kinds.one(
    "oneInstance", pathMaker(Class, "InstanceID", "ZUMLO:SensorEnabledLogicalElementCap1"));

class CapabilitiesProviderFaultTest : public FaultTest {
protected:
    ScriptedMachine machine_;
};

TEST_F(CapabilitiesProviderFaultTest, NamesThatCannotBeMadeEndInTheFactorysStatusAndAnOpenResult)
{
    for (const FaultManner manner : undelivered)
        for (const BrokerCall call : {BrokerCall::newObjectPath, BrokerCall::getNameSpace}) {
            const auto request = run(nameRequest, {call, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(request->message(), "Create CMPIObjectPath failed");
            EXPECT_TRUE(request->answer.paths().empty());
            EXPECT_FALSE(request->answer.isDone());
            EXPECT_THAT(
                request->messages, ElementsAre(BrokerMessage{2, provider,
                                       "Create CMPIObjectPath failed for" + std::string(21, ' ') +
                                           "SensorEnabledLogicalElementCapabilities class"}));
        }
}

TEST_F(CapabilitiesProviderFaultTest, ANameThatLostItsHandleIsPassedOver)
{
    const auto request = run(nameRequest, {BrokerCall::addKey, 1, FaultManner::lostHandle});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_TRUE(request->answer.paths().empty());
    EXPECT_EQ(request->answer.refused(), 0U);
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(CapabilitiesProviderFaultTest, AMissingArrayStandsInTheStatusBesideTheInstance)
{
    for (const RequestKind& kind : {instanceRequest, oneInstance}) {
        const auto request =
            run(kind, {BrokerCall::newArray, 1, FaultManner::nullResult, CMPI_RC_OK});
        EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request->message(), "Creating array for Property" + std::string(25, ' ') +
                                          "RequestedStatesSupported failed.");
        ASSERT_EQ(request->answer.instances().size(), 1U);
        EXPECT_THAT(namesOf(request->answer.instances()[0]->properties()),
            ElementsAre("InstanceID", "ElementNameEditSupported"));
        EXPECT_TRUE(request->answer.isDone());
        EXPECT_EQ(request->messages.size(), 1U);
    }
}

TEST_F(CapabilitiesProviderFaultTest, EveryRequestReturnsTheStatusThatTheBrokerLeft)
{
    for (const auto& [call, manner] : std::initializer_list<std::pair<BrokerCall, FaultManner>>{
             {BrokerCall::getNameSpace, FaultManner::nullResult},
             {BrokerCall::getCharPtr, FaultManner::errorStatus}}) {
        const auto names = runWithLast(nameRequest, call, manner);
        EXPECT_EQ(names->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
        EXPECT_EQ(names->answer.paths().size(), 1U);
        EXPECT_TRUE(names->answer.isDone());
    }
    const auto instances = run(instanceRequest,
        {BrokerCall::newObjectPath, 1, FaultManner::nullResult, CMPI_RC_ERR_ACCESS_DENIED});
    EXPECT_EQ(instances->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(instances->answer.refused(), 1U); // the null instance is passed to the result
    EXPECT_TRUE(instances->answer.isDone());
}

// The faulty broker reads whole values, so that AddressSanitizer reports one that is shorter.
TEST_F(CapabilitiesProviderFaultTest, EveryValueIsWhole)
{
    const auto request = run(instanceRequest, std::vector<Fault>{});
    ASSERT_EQ(request->answer.instances().size(), 1U);
    const Host::Instance& instance = *request->answer.instances()[0];
    EXPECT_EQ(property(instance, "ElementNameEditSupported"), "false");
    EXPECT_EQ(describe(instance.property("RequestedStatesSupported")->array()->elements()[2]),
        "uint16 2");
}

} // namespace CapabilitiesProviderFaultTests
