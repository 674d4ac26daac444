// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What becomes of a request of the capabilities class when the broker fails it.

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyRequest.h"

#include <gmock/gmock.h>

namespace CapabilitiesProviderFaultTests {

using ::testing::ElementsAre;
using namespace Testing;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* Provider = "SensorEnabledLogicalElementCapabilitiesProvider";

CMPIInstanceMI* provider(const CMPIBroker* broker)
{
    return SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
        broker, nullptr, nullptr);
}

CMPIStatus runNames(const CMPIBroker* broker, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* ref)
{
    CMPIInstanceMI* const mi = provider(broker);
    return mi->ft->enumerateInstanceNames(mi, context, result, ref);
}

CMPIStatus runInstances(const CMPIBroker* broker, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* ref)
{
    CMPIInstanceMI* const mi = provider(broker);
    return mi->ft->enumerateInstances(mi, context, result, ref, nullptr);
}

CMPIStatus runOne(const CMPIBroker* broker, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* ref)
{
    CMPIInstanceMI* const mi = provider(broker);
    return mi->ft->getInstance(mi, context, result, ref, nullptr);
}

Host::ObjectPath& keyless(const Host::Request& request)
{
    return request.makePath("root/cimv2", Class);
}

std::function<Host::ObjectPath&(const Host::Request&)> keyed(const char* key)
{
    return [key](const Host::Request& request) -> Host::ObjectPath& {
        Host::ObjectPath& made = keyless(request);
        made.addKey(
            key, Host::Value::text(request.arena(), "ZUMLO:SensorEnabledLogicalElementCap1"));
        return made;
    };
}

const RequestKind Names = {"names", keyless, runNames};
const RequestKind Instances = {"instances", keyless, runInstances};
const RequestKind OneInstance = {"oneInstance", keyed("InstanceID"), runOne};
const RequestKind InstanceByPath = {"instanceByPath", keyed("Other"), runOne};
const RequestKind InstanceWithoutKeys = {"instanceWithoutKeys", keyless, runOne};

class CapabilitiesProviderFaultTest : public FaultTest {
protected:
    ScriptedMachine machine_;
};

class CapabilitiesProviderFaultSweep : public CapabilitiesProviderFaultTest,
                                       public ::testing::WithParamInterface<RequestKind> {};

INSTANTIATE_TEST_SUITE_P(EveryRequest, CapabilitiesProviderFaultSweep,
    ::testing::Values(Names, Instances, OneInstance, InstanceByPath, InstanceWithoutKeys),
    ::testing::PrintToStringParamName());

TEST_P(CapabilitiesProviderFaultSweep, isSurvivedAndAnswersWithNothingMadeUp)
{
    sweepFaults(broker_, [&](FaultyBroker& faulty) {
        const FaultyRequest request(broker_, faulty, GetParam());
        EXPECT_TRUE(request.status.rc == CMPI_RC_OK || request.status.rc == CMPI_RC_ERR_FAILED)
            << request.status.rc;
        EXPECT_LE(request.answer.paths().size(), 1U);
        EXPECT_LE(request.answer.instances().size(), 1U);
        for (const Host::Instance* const instance : request.answer.instances())
            EXPECT_EQ(instance->className(), Class);
        for (const Host::ObjectPath* const path : request.answer.paths()) {
            EXPECT_EQ(path->className(), Class);
            EXPECT_EQ(path->nameSpace(), "root/cimv2");
        }
    });
}

TEST_F(CapabilitiesProviderFaultTest, namesThatCannotBeMadeEndInTheFactorysStatusAndAnOpenResult)
{
    for (const FaultManner manner : Undelivered)
        for (const BrokerCall call : {BrokerCall::newObjectPath, BrokerCall::getNameSpace}) {
            const auto request = run(Names, {call, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(request->message(), "Create CMPIObjectPath failed");
            EXPECT_TRUE(request->answer.paths().empty());
            EXPECT_FALSE(request->answer.isDone());
            EXPECT_THAT(
                request->messages, ElementsAre(BrokerMessage{2, Provider,
                                       "Create CMPIObjectPath failed for" + std::string(21, ' ') +
                                           "SensorEnabledLogicalElementCapabilities class"}));
        }
}

TEST_F(CapabilitiesProviderFaultTest, aNameThatLostItsHandleIsPassedOver)
{
    const auto request = run(Names, {BrokerCall::addKey, 1, FaultManner::lostHandle});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_TRUE(request->answer.paths().empty());
    EXPECT_EQ(request->answer.refused(), 0U);
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(CapabilitiesProviderFaultTest, anInstanceThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const RequestKind& kind : {Instances, OneInstance})
        for (const FaultManner manner : Undelivered)
            for (const BrokerCall call : {BrokerCall::newInstance, BrokerCall::newObjectPath}) {
                const auto request = run(kind, {call, 1, manner, CMPI_RC_OK});
                EXPECT_EQ(request->status.rc, CMPI_RC_OK);
                EXPECT_EQ(request->answer.refused(), 1U);
                EXPECT_TRUE(request->answer.isDone());
                EXPECT_TRUE(request->messages.empty());
            }
}

TEST_F(CapabilitiesProviderFaultTest, aMissingArrayStandsInTheStatusBesideTheInstance)
{
    for (const RequestKind& kind : {Instances, OneInstance}) {
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

TEST_F(CapabilitiesProviderFaultTest, aKeyReportedMissingThroughTheStatusIsAbsentAndTheAnswerIsOk)
{
    for (const FaultManner manner : Undelivered) {
        const auto request =
            run(OneInstance, {BrokerCall::getKey, 1, manner, CMPI_RC_ERR_NO_SUCH_PROPERTY});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->status.msg, nullptr);
        EXPECT_TRUE(request->answer.instances().empty());
        EXPECT_TRUE(request->answer.isDone());
    }
}

TEST_F(CapabilitiesProviderFaultTest, theFilterIsSetBeforeTheProperties)
{
    run(OneInstance, {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus});
    const std::vector<BrokerCall>& calls = faulty_->calls();
    EXPECT_LT(std::find(calls.begin(), calls.end(), BrokerCall::setPropertyFilter),
        std::find(calls.begin(), calls.end(), BrokerCall::setProperty));
}

TEST_F(CapabilitiesProviderFaultTest, aPathThatCannotCountItsKeysHasNone)
{
    const auto request = run(OneInstance, {BrokerCall::getKeyCount, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(), "At least one key should be passed");
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(CapabilitiesProviderFaultTest, aFailureWhoseMessageCannotBeMadeHasNone)
{
    const auto request =
        run(InstanceWithoutKeys, {BrokerCall::newString, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->status.msg, nullptr);
}

} // namespace CapabilitiesProviderFaultTests
