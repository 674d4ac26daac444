// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The results and statuses of the factory's operations on sensors when calls of the broker fail.

#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "tests/support/FaultyBroker.h"
#include "tests/support/ProviderTest.h"

#include <cmpimacs.h>
#include <gmock/gmock.h>

namespace SensorFactoryFaultTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

class SensorFactoryFaultTest : public ProviderTest {
protected:
    SensorFactoryFaultTest()
        : machine_({{NodeType::Temperature, "/t", "A", NodeReading{}},
              {NodeType::Tachometer, "/f", "B", NodeReading{}}})
    {
    }

    int makePaths(CMPIStatus* status)
    {
        return factory_.getAllSensorCMPIObjPaths(
            faulty_.handle(), path("C").handle(), paths_, status);
    }

    CMPIInstance* makeInstance(const char** properties = nullptr)
    {
        return factory_.makeSensorInstance(
            faulty_.handle(), path("C").handle(), Sensor(), properties, false, &rc_);
    }

    ScriptedMachine machine_;
    SensorFactory factory_{true, false};
    Testing::FaultyBroker faulty_{broker_};
    std::vector<CMPIObjectPath*> paths_;
    CMPIStatus rc_ = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
};

class UndeliveredTest : public SensorFactoryFaultTest,
                        public ::testing::WithParamInterface<FaultManner> {};

INSTANTIATE_TEST_SUITE_P(NullOrHandleless, UndeliveredTest,
    ::testing::Values(FaultManner::nullResult, FaultManner::handleless));

// ---- Paths ----

const BrokerMessage pathFailed = {2, "SensorProfileProvider",
    "Create CMPIObjectPath                     failed for RecordLogClass."};

TEST_P(UndeliveredTest, APathThatCannotBeMadeIsAFailureOfTheBroker)
{
    faulty_.plan({BrokerCall::newObjectPath, 1, GetParam()});
    EXPECT_EQ(makePaths(&rc_), 2);
    EXPECT_THAT(paths_, IsEmpty());
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(textOf(rc_.msg), "Create CMPIObjectPath failed.");
    EXPECT_THAT(messages_, ElementsAre(pathFailed));
}

TEST_P(UndeliveredTest, ThePathsBeforeTheOneThatCannotBeMadeStay)
{
    faulty_.plan({BrokerCall::newObjectPath, 2, GetParam()});
    EXPECT_EQ(makePaths(&rc_), 2);
    ASSERT_EQ(paths_.size(), 1U);
    EXPECT_EQ(Host::ObjectPath::of(paths_[0])->key("DeviceID")->text(), "A:/t");
}

TEST_P(UndeliveredTest, AFailureOfPathsNeedsNoStatus)
{
    faulty_.plan({BrokerCall::newObjectPath, 1, GetParam()});
    EXPECT_EQ(makePaths(nullptr), 2);
    EXPECT_EQ(faulty_.count(BrokerCall::newString), 0U);
    EXPECT_THAT(messages_, ElementsAre(pathFailed));
}

TEST_P(UndeliveredTest, AFailureOfPathsHasItsExitingLine)
{
    faulty_.plan({BrokerCall::newObjectPath, 2, GetParam()});
    const LogCapture capture;
    makePaths(&rc_);
    EXPECT_THAT(capture.marksOf("getAllSensorCMPIObjPaths"),
        ElementsAre(::testing::StartsWith("ENTERING"), ::testing::StartsWith("EXITING")));
}

TEST_F(SensorFactoryFaultTest, APathIsGivenItsNamespaceOnceMoreThenItsHostAndItsKeys)
{
    faulty_.watch(path("C").handle());
    EXPECT_EQ(makePaths(&rc_), 0);
    const std::string of = std::string(" ") + SensorClass;
    EXPECT_THAT(
        std::vector<std::string>(faulty_.pathCalls().begin(), faulty_.pathCalls().begin() + 6),
        ElementsAre("setNameSpace" + of, "setHostname" + of, "addKey" + of, "addKey" + of,
            "addKey" + of, "addKey" + of));
}

// ---- Instances ----

TEST_P(UndeliveredTest, AnInstanceWithoutAPathLeavesTheStatusAndHasItsExitingLine)
{
    faulty_.plan({BrokerCall::newObjectPath, 1, GetParam()});
    const LogCapture capture;
    EXPECT_EQ(makeInstance(), nullptr);
    EXPECT_THAT(capture.marksOf("makeSensorInstance"), ElementsAre("ENTERING 269", "EXITING 737"));
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(rc_.msg, nullptr);
    EXPECT_THAT(messages_, IsEmpty());
}

TEST_P(UndeliveredTest, AnInstanceThatCannotBeMadeLeavesTheStatusAndHasItsExitingLine)
{
    faulty_.plan({BrokerCall::newInstance, 1, GetParam()});
    const LogCapture capture;
    EXPECT_EQ(makeInstance() == nullptr, GetParam() == FaultManner::nullResult);
    EXPECT_THAT(capture.marksOf("makeSensorInstance"), ElementsAre("ENTERING 269", "EXITING 737"));
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(rc_.msg, nullptr);
    EXPECT_THAT(messages_, IsEmpty());
}

// The property is alone in the list, so that the broker does not set the status again for a later
// array.
TEST_P(UndeliveredTest, WithoutPossibleStatesTheStatusIsWhatTheBrokerMadeIt)
{
    const char* properties[] = {"PossibleStates", nullptr};
    for (const CMPIrc code : {CMPI_RC_OK, CMPI_RC_ERR_INVALID_PARAMETER}) {
        faulty_.reset();
        faulty_.plan({BrokerCall::newArray, 1, GetParam(), code});
        rc_ = {CMPI_RC_OK, nullptr};
        const Host::Instance* const instance = Host::Instance::of(makeInstance(properties));
        ASSERT_NE(instance, nullptr);
        EXPECT_EQ(property(*instance, "PossibleStates"), "absent");
        EXPECT_EQ(rc_.rc, code);
        EXPECT_EQ(rc_.msg, nullptr);
        EXPECT_THAT(messages_, IsEmpty());
    }
}

// The status is passed to the broker when it reads the key.
TEST_F(SensorFactoryFaultTest, AnUnknownIdentifierLeavesTheStatusAsTheBrokerMadeIt)
{
    CMPIString* const key = CMNewString(faulty_.handle(), "unknown", nullptr);
    faulty_.plan({BrokerCall::getCharPtr, 1, FaultManner::errorStatus, CMPI_RC_ERR_NOT_FOUND});
    std::vector<CMPIInstance*> instances;
    EXPECT_EQ(factory_.getOneSensorCMPIInstance(
                  faulty_.handle(), path("C").handle(), key, nullptr, instances, &rc_),
        1);
    EXPECT_EQ(faulty_.fired(), 1U);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_THAT(instances, IsEmpty());
    EXPECT_THAT(messages_, IsEmpty());
}

} // namespace SensorFactoryFaultTests
