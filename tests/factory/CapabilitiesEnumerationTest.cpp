// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The enumeration of the factory's capabilities as instances and object paths.

#include "factory/SensorFactory.h"
#include "tests/support/FaultyBroker.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace CapabilitiesEnumerationTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* provider = "SensorEnabledLogicalElementCapabilitiesProvider";
constexpr const char* firstIdentifier = "ZUMLO:SensorEnabledLogicalElementCap1";

class CapabilitiesEnumerationTest : public ProviderTest {
protected:
    explicit CapabilitiesEnumerationTest(bool hasCapabilities = true)
        : factory_(false, hasCapabilities)
    {
    }

    int getAll(const char** properties = nullptr, bool isObjPath = false)
    {
        return factory_.getAllSensorEnabledLogicalElementCapCMPIInstances(
            broker(), path("C").handle(), properties, isObjPath, instances_, &rc_);
    }

    int getOne(const char* identifier, const char** properties = nullptr)
    {
        return factory_.getOneSensorEnabledLogicalElementCapCMPIInstance(broker(),
            path("C").handle(), Host::String::make(request_->arena(), identifier).handle(),
            properties, instances_, &rc_);
    }

    int getPaths()
    {
        return factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
            broker(), path("C", {}, "root/other").handle(), paths_, &rc_);
    }

    ScriptedMachine machine_;
    SensorFactory factory_;
    std::vector<CMPIInstance*> instances_;
    std::vector<CMPIObjectPath*> paths_;
    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

class NoCapabilitiesTest : public CapabilitiesEnumerationTest {
protected:
    NoCapabilitiesTest() : CapabilitiesEnumerationTest(false) {}
};

// ---- Instances ----

TEST_F(CapabilitiesEnumerationTest, ThereIsOneInstance)
{
    EXPECT_EQ(getAll(), 0);
    ASSERT_EQ(instances_.size(), 1U);
    EXPECT_EQ(Host::Instance::of(instances_[0])->properties().size(), 3U);
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesEnumerationTest, TheStatesDoNotGrowFromRequestToRequest)
{
    getAll();
    getAll();
    getOne(firstIdentifier);
    getPaths();
    getAll();
    ASSERT_EQ(instances_.size(), 4U);
    for (const CMPIInstance* const instance : instances_)
        EXPECT_EQ(property(*Host::Instance::of(instance), "RequestedStatesSupported"),
            "[uint16 0, uint16 1, uint16 2]");
}

TEST_F(CapabilitiesEnumerationTest, TheListAndTheObjectPathFlagReachTheInstance)
{
    const char* properties[] = {"ElementNameEditSupported", nullptr};
    getAll(properties);
    getAll(nullptr, true);
    for (const CMPIInstance* const instance : instances_)
        EXPECT_EQ(property(*Host::Instance::of(instance), "RequestedStatesSupported"), "absent");
}

TEST_F(CapabilitiesEnumerationTest, WhatIsThereStaysInTheVector)
{
    instances_.push_back(nullptr);
    getAll();
    ASSERT_EQ(instances_.size(), 2U);
    EXPECT_EQ(instances_[0], nullptr);
}

TEST_F(CapabilitiesEnumerationTest, AnInstanceThatCannotBeMadeIsANullEntry)
{
    FaultyBroker faulty(broker_);
    faulty.plan({BrokerCall::newInstance, 1, FaultManner::nullResult});
    EXPECT_EQ(factory_.getAllSensorEnabledLogicalElementCapCMPIInstances(
                  faulty.handle(), path("C").handle(), nullptr, false, instances_, &rc_),
        0);
    EXPECT_THAT(instances_, ElementsAre(nullptr));
}

TEST_F(NoCapabilitiesTest, HaveNoInstancesAndThatIsNoFailure)
{
    EXPECT_EQ(getAll(), 0);
    EXPECT_TRUE(instances_.empty());
    EXPECT_TRUE(messages_.empty());
}

// ---- One instance ----

TEST_F(CapabilitiesEnumerationTest, OneInstanceIsFoundByItsWholeIdentifier)
{
    EXPECT_EQ(getOne(firstIdentifier), 0);
    ASSERT_EQ(instances_.size(), 1U);
    EXPECT_EQ(Host::Instance::of(instances_[0])->properties().size(), 3U);
}

TEST_F(CapabilitiesEnumerationTest, OneInstanceHasTheListedProperties)
{
    const char* properties[] = {"RequestedStatesSupported", nullptr};
    EXPECT_EQ(getOne(firstIdentifier, properties), 0);
    EXPECT_EQ(Host::Instance::of(instances_.at(0))->properties().size(), 2U);
}

TEST_F(CapabilitiesEnumerationTest, AnIdentifierIsNeitherFoldedNorTrimmed)
{
    const std::string identifier = firstIdentifier;
    for (const std::string& other : {std::string("zumlo:sensorenabledlogicalelementcap1"),
             std::string("ZUMLO:SensorEnabledLogicalElementCAP1"), identifier + " ",
             " " + identifier, identifier + "1", identifier.substr(0, identifier.size() - 1),
             std::string("ZUMLO:SensorEnabledLogicalElementCap2"), std::string()})
        EXPECT_EQ(getOne(other.c_str()), 1) << other;
    EXPECT_TRUE(instances_.empty());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesEnumerationTest, AnUnknownIdentifierLeavesTheStatusAsItWas)
{
    rc_ = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(factory_.getOneSensorEnabledLogicalElementCapCMPIInstance(
                  broker(), path("C").handle(), nullptr, nullptr, instances_, &rc_),
        1);
    EXPECT_EQ(getOne("unknown"), 1);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_TRUE(instances_.empty());
}

TEST_F(NoCapabilitiesTest, AreNotFoundByTheirIdentifier)
{
    EXPECT_EQ(getOne(firstIdentifier), 1);
    EXPECT_TRUE(instances_.empty());
}

// ---- Object paths ----

TEST_F(CapabilitiesEnumerationTest, AnObjectPathHasItsOneKey)
{
    EXPECT_EQ(getPaths(), 0);
    ASSERT_EQ(paths_.size(), 1U);
    const Host::ObjectPath& only = *Host::ObjectPath::of(paths_[0]);
    EXPECT_THAT(describe(only.keys()),
        ElementsAre("InstanceID = string \"ZUMLO:SensorEnabledLogicalElementCap1\""));
    EXPECT_EQ(only.className(), Class);
    EXPECT_EQ(only.nameSpace(), "root/other");
    EXPECT_EQ(only.host(), systemName_);
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(NoCapabilitiesTest, HaveNoObjectPathsAndSayThatToTheBroker)
{
    rc_ = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(getPaths(), 1);
    EXPECT_TRUE(paths_.empty());
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, provider, "***No instance found***"}));
}

TEST_F(CapabilitiesEnumerationTest, AnObjectPathThatCannotBeMadeEndsTheEnumeration)
{
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        FaultyBroker faulty(broker_);
        faulty.plan({BrokerCall::newObjectPath, 1, manner, CMPI_RC_OK});
        messages_.clear();
        EXPECT_EQ(factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
                      faulty.handle(), path("C").handle(), paths_, &rc_),
            2);
        EXPECT_TRUE(paths_.empty());
        EXPECT_EQ(rc_.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(Testing::textOf(rc_.msg), "Create CMPIObjectPath failed");
        EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, provider,
                                   "Create CMPIObjectPath failed for" + std::string(21, ' ') +
                                       "SensorEnabledLogicalElementCapabilities class"}));
    }
}

TEST_F(CapabilitiesEnumerationTest, WithoutAStatusAMissingPathIsTracedOnly)
{
    FaultyBroker faulty(broker_);
    faulty.plan({BrokerCall::newObjectPath, 1, FaultManner::nullResult});
    EXPECT_EQ(factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
                  faulty.handle(), path("C").handle(), paths_, nullptr),
        2);
    EXPECT_EQ(messages_.size(), 1U);
}

// ---- Trace lines of operations that end early ----

TEST_F(CapabilitiesEnumerationTest, AnUnknownIdentifierLeavesTheExitingLineOut)
{
    const LogCapture capture;
    getOne("unknown");
    EXPECT_THAT(capture.marksOf("getOneSensorEnabledLogicalElementCapCMPIInstance"),
        ElementsAre("ENTERING 1134"));
}

TEST_F(NoCapabilitiesTest, HaveAnExitingLineOfTheirOwn)
{
    const LogCapture capture;
    getPaths();
    EXPECT_THAT(capture.marksOf("getAllSensorEnabledLogicalElementCapCMPIObjPaths"),
        ElementsAre("ENTERING 1041", "EXITING 1104"));
}

TEST_F(CapabilitiesEnumerationTest, AnObjectPathThatCannotBeMadeLeavesTheExitingLineOut)
{
    const LogCapture capture;
    FaultyBroker faulty(broker_);
    faulty.plan({BrokerCall::newObjectPath, 1, FaultManner::nullResult});
    factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
        faulty.handle(), path("C").handle(), paths_, &rc_);
    EXPECT_THAT(capture.marksOf("getAllSensorEnabledLogicalElementCapCMPIObjPaths"),
        ElementsAre("ENTERING 1041"));
}

} // namespace CapabilitiesEnumerationTests
