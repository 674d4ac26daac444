// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The enumeration of the factory's sensors as instances and object paths.

#include "factory/SensorFactory.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace SensorEnumerationTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

// The sensors in the order of the harvest: Z, X, Y.
const std::vector<ScriptedNode> unsorted = {{NodeType::Temperature, "/p", "Z", NodeReading{}},
    {NodeType::Voltage, "/p", "X", NodeReading{}},
    {NodeType::Tachometer, "/p", "Y", NodeReading{}}};

class SensorEnumerationTest : public ProviderTest {
protected:
    explicit SensorEnumerationTest(std::vector<ScriptedNode> nodes = unsorted)
        : machine_(std::move(nodes)), factory_(true, false)
    {
    }

    int getOne(const char* deviceID)
    {
        return factory_.getOneSensorCMPIInstance(broker(), path("C").handle(),
            Host::String::make(request_->arena(), deviceID).handle(), nullptr, instances_, &rc_);
    }

    ScriptedMachine machine_;
    SensorFactory factory_;
    std::vector<CMPIInstance*> instances_;
    std::vector<CMPIObjectPath*> paths_;
    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

class EmptyMachineTest : public SensorEnumerationTest {
protected:
    EmptyMachineTest() : SensorEnumerationTest({}) {}
};

TEST_F(SensorEnumerationTest, InstancesComeInTheOrderOfTheirIdentifiers)
{
    EXPECT_EQ(factory_.getAllSensorCMPIInstances(
                  broker(), path("C").handle(), nullptr, false, instances_, &rc_),
        0);
    std::vector<std::string> identifiers;
    for (const CMPIInstance* const instance : instances_)
        identifiers.push_back(property(*Host::Instance::of(instance), "DeviceID"));
    EXPECT_THAT(identifiers, ElementsAre("string \"X:/p\"", "string \"Y:/p\"", "string \"Z:/p\""));
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
}

TEST_F(SensorEnumerationTest, InstancesForObjectPathsHaveTheKeysAlone)
{
    factory_.getAllSensorCMPIInstances(
        broker(), path("C").handle(), nullptr, true, instances_, &rc_);
    ASSERT_EQ(instances_.size(), 3U);
    EXPECT_EQ(Host::Instance::of(instances_[0])->properties().size(), 4U);
}

TEST_F(SensorEnumerationTest, WhatIsThereStaysInTheVector)
{
    instances_.push_back(nullptr);
    factory_.getAllSensorCMPIInstances(
        broker(), path("C").handle(), nullptr, false, instances_, &rc_);
    EXPECT_EQ(instances_.size(), 4U);
    EXPECT_EQ(instances_[0], nullptr);
}

TEST_F(EmptyMachineTest, HasNoInstancesAndThatIsNoFailure)
{
    EXPECT_EQ(factory_.getAllSensorCMPIInstances(
                  broker(), path("C").handle(), nullptr, false, instances_, &rc_),
        0);
    EXPECT_TRUE(instances_.empty());
    EXPECT_TRUE(messages_.empty());
}

TEST_F(SensorEnumerationTest, OneInstanceIsFoundByItsWholeIdentifier)
{
    EXPECT_EQ(getOne("Y:/p"), 0);
    ASSERT_EQ(instances_.size(), 1U);
    EXPECT_EQ(property(*Host::Instance::of(instances_[0]), "ElementName"), "string \"Y\"");
}

// Twenty sensors have one identifier.
class DuplicateTest : public SensorEnumerationTest {
protected:
    DuplicateTest() : SensorEnumerationTest(duplicates()) {}

    static std::vector<ScriptedNode> duplicates()
    {
        std::vector<ScriptedNode> nodes(20, {NodeType::Temperature, "/same", "one", {}});
        for (std::size_t i = 0; i < nodes.size(); ++i)
            nodes[i].reading.reading = static_cast<double>(i);
        return nodes;
    }
};

TEST_F(DuplicateTest, TheLastSensorOfOneIdentifierIsTheOnePublished)
{
    EXPECT_EQ(getOne("one:/same"), 0);
    ASSERT_EQ(instances_.size(), 1U);
    EXPECT_EQ(property(*Host::Instance::of(instances_[0]), "CurrentReading"), "sint32 19");
}

// There are more sensors than a 16-bit count can hold.
class ManyTest : public SensorEnumerationTest {
protected:
    explicit ManyTest(std::size_t count = 65537) : SensorEnumerationTest(nodes(count)) {}

    // The first one harvested is not the first in the order of identifiers.
    static std::vector<ScriptedNode> nodes(std::size_t count)
    {
        std::vector<ScriptedNode> made;
        for (std::size_t i = 0; i < count; ++i)
            made.push_back({NodeType::Temperature, "/" + std::to_string(count - i), "many", {}});
        return made;
    }
};

TEST_F(ManyTest, AsManyAreServedAsTheirCountCutTo16BitsSaysFromTheFirstHarvested)
{
    EXPECT_EQ(factory_.getNumberOfInstances(), 1);
    EXPECT_EQ(factory_.getAllSensorCMPIObjPaths(broker(), path("C").handle(), paths_, &rc_), 0);
    ASSERT_EQ(paths_.size(), 1U);
    EXPECT_EQ(Host::ObjectPath::of(paths_[0])->key("DeviceID")->text(), "many:/65537");
}

class ThousandTest : public ManyTest {
protected:
    ThousandTest() : ManyTest(1000) {}
};

TEST_F(ThousandTest, EachIsFoundByItsIdentifierAndNoneByAnother)
{
    for (int i = 1; i <= 1000; ++i) {
        const std::string deviceID = "many:/" + std::to_string(i);
        ASSERT_EQ(getOne(deviceID.c_str()), 0) << deviceID;
        EXPECT_EQ(property(*Host::Instance::of(instances_.back()), "DeviceID"),
            "string \"" + deviceID + "\"");
        EXPECT_EQ(getOne(("other:/" + std::to_string(i)).c_str()), 1);
    }
    EXPECT_EQ(factory_.getNumberOfInstances(), 1000);
}

class FullCountTest : public ManyTest {
protected:
    FullCountTest() : ManyTest(65536) {}
};

TEST_F(FullCountTest, ExactlyAFull16BitCountOfSensorsIsNone)
{
    EXPECT_EQ(factory_.getNumberOfInstances(), 0);
    EXPECT_EQ(factory_.getAllSensorCMPIObjPaths(broker(), path("C").handle(), paths_, &rc_), 1);
    EXPECT_TRUE(paths_.empty());
}

TEST_F(SensorEnumerationTest, AnIdentifierIsNeitherFoldedNorTrimmed)
{
    for (const char* const other : {"y:/p", "Y:/P", " Y:/p", "Y:/p ", "Y:/", "Y:/p2", ""})
        EXPECT_EQ(getOne(other), 1) << other;
    EXPECT_TRUE(instances_.empty());
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(SensorEnumerationTest, AnAbsentKeyFindsNothing)
{
    EXPECT_EQ(factory_.getOneSensorCMPIInstance(
                  broker(), path("C").handle(), nullptr, nullptr, instances_, &rc_),
        1);
}

TEST_F(SensorEnumerationTest, AnObjectPathHasTheFourKeysInOrder)
{
    EXPECT_EQ(factory_.getAllSensorCMPIObjPaths(
                  broker(), path("C", {}, "root/other").handle(), paths_, &rc_),
        0);
    ASSERT_EQ(paths_.size(), 3U);
    const Host::ObjectPath& first = *Host::ObjectPath::of(paths_[0]);
    EXPECT_THAT(
        describe(first.keys()), ElementsAre("CreationClassName = string \"ZUMLO_NumericSensor\"",
                                    "DeviceID = string \"X:/p\"",
                                    "SystemCreationClassName = string \"ZUMLO_ComputerSystem\"",
                                    "SystemName = string \"" + systemName_ + "\""));
    EXPECT_EQ(first.className(), "ZUMLO_NumericSensor");
    EXPECT_EQ(first.nameSpace(), "root/other");
    EXPECT_EQ(first.host(), systemName_);
    EXPECT_EQ(Host::ObjectPath::of(paths_[1])->key("DeviceID")->text(), "Y:/p");
    EXPECT_EQ(Host::ObjectPath::of(paths_[2])->key("DeviceID")->text(), "Z:/p");
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
}

TEST_F(EmptyMachineTest, HasNoObjectPathsAndSaysSoToTheBroker)
{
    EXPECT_EQ(factory_.getAllSensorCMPIObjPaths(broker(), path("C").handle(), paths_, &rc_), 1);
    EXPECT_TRUE(paths_.empty());
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_THAT(messages_,
        ElementsAre(BrokerMessage{1, "SensorProfileProvider", "***No instance found***"}));
}

TEST_F(EmptyMachineTest, LeavesAStatusThatWasSetAsItIs)
{
    rc_ = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    EXPECT_EQ(factory_.getAllSensorCMPIObjPaths(broker(), path("C").handle(), paths_, &rc_), 1);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(rc_.msg, nullptr);
}

// ---- Trace lines of operations that end early ----

TEST_F(SensorEnumerationTest, AnUnknownIdentifierLeavesTheExitingLineOut)
{
    const LogCapture capture;
    getOne("unknown");
    EXPECT_EQ(capture.marksOf("getOneSensorCMPIInstance").size(), 1U);
}

TEST_F(EmptyMachineTest, HasItsObjectPathsTracedToo)
{
    const LogCapture capture;
    factory_.getAllSensorCMPIObjPaths(broker(), path("C").handle(), paths_, &rc_);
    EXPECT_EQ(capture.marksOf("getAllSensorCMPIObjPaths").size(), 2U);
}

} // namespace SensorEnumerationTests
