// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_ComputerSystem when calls of the broker fail.

#include "tests/companion/Factory.h"
#include "tests/support/FaultSweep.h"
#include "tests/support/ProviderTest.h"

namespace ComputerSystemFaultTests {

using Testing::BrokerCall;
using Testing::FaultManner;
using Testing::FaultyBroker;

constexpr const char* Class = "ZUMLO_ComputerSystem";

enum class Operation { names, instances, oneInstance };

// Sends one request with a faulty broker, and holds its result and status.
class FaultyRequest {
public:
    FaultyRequest(const Host::Broker& broker, FaultyBroker& faulty, Operation operation)
        : request_(broker)
    {
        CMPIInstanceMI* const mi =
            ComputerSystemProvider_Create_InstanceMI(faulty.handle(), nullptr, nullptr);
        const CMPIContext* const context = request_.context().handle();
        const CMPIResult* const result = faulty.watch(result_.handle());
        Host::ObjectPath& path = request_.makePath("root/cimv2", Class);
        path.addKey("CreationClassName", Host::Value::text(request_.arena(), Class));
        path.addKey("Name", Host::Value::text(request_.arena(), Vorn::getSystemName()));
        const CMPIObjectPath* const ref = faulty.watch(path.handle());
        if (operation == Operation::names)
            status = mi->ft->enumerateInstanceNames(mi, context, result, ref);
        else if (operation == Operation::instances)
            status = mi->ft->enumerateInstances(mi, context, result, ref, nullptr);
        else
            status = mi->ft->getInstance(mi, context, result, ref, nullptr);
    }

    Host::CollectedResult answer;
    CMPIStatus status = {};

private:
    Host::Request request_;
    Host::Result result_{answer};
};

class ComputerSystemFaultSweepTest : public ::testing::TestWithParam<Operation> {
protected:
    Host::Broker broker_;
};

INSTANTIATE_TEST_SUITE_P(EveryRequest, ComputerSystemFaultSweepTest,
    ::testing::Values(Operation::names, Operation::instances, Operation::oneInstance));

TEST_P(ComputerSystemFaultSweepTest, IsSurvivedAndAnswersWithNothingMadeUp)
{
    Testing::sweepFaults(broker_, [&](FaultyBroker& faulty) {
        const FaultyRequest request(broker_, faulty, GetParam());
        EXPECT_EQ(request.answer.refused(), 0U);
        EXPECT_LE(request.answer.paths().size() + request.answer.instances().size(), 1U);
        for (const Host::ObjectPath* const path : request.answer.paths())
            EXPECT_EQ(path->className(), Class);
        for (const Host::Instance* const instance : request.answer.instances())
            EXPECT_EQ(instance->className(), Class);
    });
}

struct Refusal {
    Operation operation;
    BrokerCall call;
    unsigned nth;
};

TEST(ComputerSystemFaultTest, WithoutItsKeysNothingIsDelivered)
{
    const Host::Broker broker;
    for (const Refusal& refusal : {Refusal{Operation::names, BrokerCall::addKey, 1},
             Refusal{Operation::names, BrokerCall::addKey, 2},
             Refusal{Operation::instances, BrokerCall::setProperty, 1},
             Refusal{Operation::oneInstance, BrokerCall::setProperty, 2}}) {
        FaultyBroker faulty(broker);
        faulty.plan({refusal.call, refusal.nth, FaultManner::errorStatus});
        const FaultyRequest request(broker, faulty, refusal.operation);
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_TRUE(request.answer.paths().empty());
        EXPECT_TRUE(request.answer.instances().empty());
    }
}

TEST(ComputerSystemFaultTest, AResultThatRefusesItsDeliveryIsNotClaimedToBeDelivered)
{
    const Host::Broker broker;
    for (const Refusal& refusal : {Refusal{Operation::names, BrokerCall::returnObjectPath, 1},
             Refusal{Operation::instances, BrokerCall::returnInstance, 1},
             Refusal{Operation::oneInstance, BrokerCall::returnDone, 1}}) {
        FaultyBroker faulty(broker);
        faulty.plan(
            {refusal.call, refusal.nth, FaultManner::errorStatus, CMPI_RC_ERR_ACCESS_DENIED});
        const FaultyRequest request(broker, faulty, refusal.operation);
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_ACCESS_DENIED);
        EXPECT_FALSE(request.answer.isDone());
    }
}

TEST(ComputerSystemFaultTest, AFailureWhoseMessageCannotBeMadeHasNone)
{
    const Host::Broker broker;
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        FaultyBroker faulty(broker);
        faulty.plan({BrokerCall::newObjectPath, 1, manner});
        faulty.plan({BrokerCall::newString, 1, manner});
        const FaultyRequest request(broker, faulty, Operation::names);
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request.status.msg, nullptr);
    }
}

TEST(ComputerSystemFaultTest, AnArrayThatCannotBeMadeLeavesItsPropertyOut)
{
    const Host::Broker broker;
    FaultyBroker faulty(broker);
    faulty.plan({BrokerCall::newArray, 1, FaultManner::nullResult});
    const FaultyRequest request(broker, faulty, Operation::instances);
    EXPECT_EQ(request.status.rc, CMPI_RC_OK);
    ASSERT_EQ(request.answer.instances().size(), 1U);
    EXPECT_EQ(Testing::property(*request.answer.instances()[0], "EnabledState"), "uint16 2");
}

// The faulty broker reads whole values, so that AddressSanitizer reports one that is shorter.
TEST(ComputerSystemFaultTest, EveryValueIsWhole)
{
    const Host::Broker broker;
    FaultyBroker faulty(broker);
    const FaultyRequest request(broker, faulty, Operation::instances);
    ASSERT_EQ(request.answer.instances().size(), 1U);
    const Host::Instance& instance = *request.answer.instances()[0];
    EXPECT_EQ(Testing::property(instance, "HealthState"), "uint16 5");
    EXPECT_EQ(Testing::describe(instance.property("OperationalStatus")->array()->elements()[0]),
        "uint16 2");
    EXPECT_GE(faulty.count(BrokerCall::setElementAt), 2U);
}

} // namespace ComputerSystemFaultTests
