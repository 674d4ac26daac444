// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The class at the far end of an association, for each end of each association and for sources that
// are no end.

#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "tests/support/FaultyBroker.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace AssociationTargetTests {

using Vorn::SensorProfileProvider::SensorFactory;
using namespace ::testing;
using namespace Testing;

constexpr const char* numericSensor = "ZUMLO_NumericSensor";
constexpr const char* computerSystem = "ZUMLO_ComputerSystem";
constexpr const char* capabilities = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* systemDevice = "ZUMLO_SensorSystemDevice";
constexpr const char* elementCapabilities = "ZUMLO_SensorElementCapabilities";

struct Row {
    const char* name;
    const char* source;
    const char* association;
    const char* target;
    const char* component;
    const char* text;
    int exitLine;
};

const Row rows[] = {
    {"fromASystemToItsSensors", computerSystem, systemDevice, numericSensor,
        "SensorSystemDeviceProvider", "Target Class is PhysicalPackageClass", 1205},
    {"fromASensorToItsSystem", numericSensor, systemDevice, computerSystem,
        "SensorSystemDeviceProvider", "Target Class is ComputerSystemClass", 1221},
    {"fromASensorToItsCapabilities", numericSensor, elementCapabilities, capabilities,
        "SensorElementCapabilitiesProvider", "Target Class is PhysicalPackageClass", 1236},
    {"fromCapabilitiesToTheirSensors", capabilities, elementCapabilities, numericSensor,
        "SensorElementCapabilitiesProvider", "Target Class is ComputerSystemClass", 1252},
};

class AssociationTargetTest : public ProviderTest {
protected:
    const char* nameFrom(
        const char* source, const char* association, const char* resultClass = nullptr)
    {
        return SensorFactory::get_assoc_targetClass_Name(
            broker(), path(source).handle(), association, resultClass, &rc_);
    }

    const Host::ObjectPath* pathFrom(
        const char* source, const char* association, const char* resultClass = nullptr)
    {
        return Host::ObjectPath::of(SensorFactory::get_assoc_targetClass_ObjectPath(broker(),
            path(source, {{"DeviceID", "x"}}, "root/other").handle(), association, resultClass,
            &rc_));
    }

    void expectNoTarget(const char* source, const char* association)
    {
        EXPECT_EQ(nameFrom(source, association), nullptr) << source;
        EXPECT_EQ(pathFrom(source, association), nullptr) << source;
        EXPECT_TRUE(messages_.empty());
        EXPECT_EQ(rc_.rc, CMPI_RC_OK);
        EXPECT_EQ(rc_.msg, nullptr);
    }

    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

class AssociationRowTest : public AssociationTargetTest, public WithParamInterface<Row> {
protected:
    BrokerMessage message() const { return {1, GetParam().component, GetParam().text}; }
};

INSTANTIATE_TEST_SUITE_P(All, AssociationRowTest, ValuesIn(rows),
    [](const TestParamInfo<Row>& row) { return row.param.name; });

// ---- The four ends ----

TEST_P(AssociationRowTest, NamesTheTargetAndTracesToTheBroker)
{
    EXPECT_STREQ(nameFrom(GetParam().source, GetParam().association), GetParam().target);
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_THAT(messages_, ElementsAre(message()));
}

TEST_P(AssociationRowTest, MakesAKeylessPathInTheSourcesNamespaceOnThisSystem)
{
    const Host::ObjectPath* const target = pathFrom(GetParam().source, GetParam().association);
    ASSERT_NE(target, nullptr);
    EXPECT_EQ(target->className(), GetParam().target);
    EXPECT_EQ(target->nameSpace(), "root/other");
    EXPECT_EQ(target->host(), systemName_);
    EXPECT_EQ(target->keys().size(), 0U);
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_THAT(messages_, ElementsAre(message()));
}

TEST_P(AssociationRowTest, DoesNotLookAtTheResultClass)
{
    for (const char* const resultClass : {"", "CIM_ComputerSystem", numericSensor, "NOT_AClass"}) {
        EXPECT_STREQ(
            nameFrom(GetParam().source, GetParam().association, resultClass), GetParam().target);
        EXPECT_NE(pathFrom(GetParam().source, GetParam().association, resultClass), nullptr);
    }
}

TEST_P(AssociationRowTest, ComparesLetterForLetter)
{
    const auto lower = [](std::string name) {
        for (char& letter : name)
            letter = static_cast<char>(std::tolower(static_cast<unsigned char>(letter)));
        return name;
    };
    const Row& row = GetParam();
    expectNoTarget(lower(row.source).c_str(), row.association);
    expectNoTarget(row.source, lower(row.association).c_str());
    expectNoTarget((row.source + std::string("2")).c_str(), row.association);
    expectNoTarget(row.source, (row.association + std::string(" ")).c_str());
}

TEST_P(AssociationRowTest, WithoutAnAssociationClassHasNoTarget)
{
    expectNoTarget(GetParam().source, nullptr);
    expectNoTarget(GetParam().source, "");
}

std::string traced(
    const std::string& function, const char* mark, int line, const std::string& parameters)
{
    const std::string number = std::to_string(line);
    return function + "(SensorFactory:" + number + ") 3000 " + mark + ": " + function +
           "() in SensorFactory [Line: " + number + "],Parameters List:  " + parameters;
}

TEST_P(AssociationRowTest, IsTracedWithItsParameters)
{
    const LogCapture capture;
    pathFrom(GetParam().source, GetParam().association, "Result");
    const std::string parameters = std::string("broker=PTR ref=PTR _RefLeftClass=") +
                                   GetParam().association + " _RefRightClass=Result rc=PTR";
    const std::string name = "get_assoc_targetClass_Name";
    const std::string objectPath = "get_assoc_targetClass_ObjectPath";
    EXPECT_THAT(Testing::withoutPointers(capture.log()),
        ElementsAre(traced(objectPath, "ENTERING", 1288, parameters),
            traced(name, "ENTERING", 1185, parameters),
            traced(name, "EXITING", GetParam().exitLine, parameters),
            traced(objectPath, "EXITING", 1316, parameters)));
}

TEST_P(AssociationRowTest, APathTheBrokerDoesNotMakeIsNoTarget)
{
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        const LogCapture capture;
        FaultyBroker faulty(broker_);
        faulty.plan({BrokerCall::newObjectPath, 1, manner, CMPI_RC_ERR_INVALID_NAMESPACE});
        EXPECT_EQ(SensorFactory::get_assoc_targetClass_ObjectPath(faulty.handle(),
                      faulty.watch(path(GetParam().source).handle()), GetParam().association,
                      nullptr, &rc_),
            nullptr);
        EXPECT_EQ(rc_.rc, CMPI_RC_ERR_INVALID_NAMESPACE); // as the broker left it
        ASSERT_EQ(capture.log().size(), 4U);
        EXPECT_EQ(capture.log().back().line, 1316U);
    }
}

// ---- Sources that are no end ----

TEST_F(AssociationTargetTest, AnotherProvidersEndHasNoTarget)
{
    expectNoTarget(computerSystem, elementCapabilities);
    expectNoTarget(capabilities, systemDevice);
    expectNoTarget(systemDevice, systemDevice);
    expectNoTarget(elementCapabilities, elementCapabilities);
    expectNoTarget("CIM_NumericSensor", systemDevice);
    expectNoTarget("CIM_ComputerSystem", systemDevice);
    expectNoTarget(numericSensor, "CIM_SystemDevice");
    expectNoTarget(numericSensor, numericSensor);
    expectNoTarget("OTHER_Class", elementCapabilities);
}

TEST_F(AssociationTargetTest, NoTargetLeavesTheTextOfTheStatusToTheCaller)
{
    // The broker's calls succeed and set the status to OK; the factory does not set it.
    CMPIStatus* const none = nullptr;
    EXPECT_EQ(SensorFactory::get_assoc_targetClass_Name(
                  broker(), path(computerSystem).handle(), elementCapabilities, nullptr, none),
        nullptr);
    EXPECT_STREQ(SensorFactory::get_assoc_targetClass_Name(
                     broker(), path(computerSystem).handle(), systemDevice, nullptr, none),
        numericSensor);
}

TEST_F(AssociationTargetTest, ASourceThatIsNoPathHasNoTarget)
{
    const CMPIObjectPath handleless = {nullptr, &Host::ObjectPath::functions};
    for (const CMPIObjectPath* const source :
        {static_cast<const CMPIObjectPath*>(nullptr), &handleless}) {
        EXPECT_EQ(SensorFactory::get_assoc_targetClass_Name(
                      broker(), source, systemDevice, nullptr, &rc_),
            nullptr);
        EXPECT_EQ(SensorFactory::get_assoc_targetClass_ObjectPath(
                      broker(), source, systemDevice, nullptr, &rc_),
            nullptr);
    }
    EXPECT_TRUE(messages_.empty());
}

TEST_F(AssociationTargetTest, ASourceWhoseClassIsNotReturnedHasNoTarget)
{
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        FaultyBroker faulty(broker_);
        faulty.plan({BrokerCall::getClassName, 1, manner});
        EXPECT_EQ(SensorFactory::get_assoc_targetClass_Name(faulty.handle(),
                      faulty.watch(path(numericSensor).handle()), systemDevice, nullptr, &rc_),
            nullptr);
        EXPECT_EQ(rc_.rc, CMPI_RC_ERR_FAILED);
    }
}

TEST_F(AssociationTargetTest, ASourceWhoseNamespaceIsNotReturnedHasNoTargetPath)
{
    FaultyBroker faulty(broker_);
    faulty.plan({BrokerCall::getNameSpace, 1, FaultManner::nullResult});
    EXPECT_EQ(SensorFactory::get_assoc_targetClass_ObjectPath(faulty.handle(),
                  faulty.watch(path(numericSensor).handle()), systemDevice, nullptr, &rc_),
        nullptr);
    EXPECT_EQ(rc_.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(AssociationTargetTest, NoTargetIsTracedWithItsOwnExitingLineAndAbsentNames)
{
    const LogCapture capture;
    pathFrom("OTHER_Class", nullptr);
    const std::string parameters =
        "broker=PTR ref=PTR _RefLeftClass=(null) _RefRightClass=(null) rc=PTR";
    const std::string name = "get_assoc_targetClass_Name";
    const std::string objectPath = "get_assoc_targetClass_ObjectPath";
    EXPECT_THAT(Testing::withoutPointers(capture.log()),
        ElementsAre(traced(objectPath, "ENTERING", 1288, parameters),
            traced(name, "ENTERING", 1185, parameters), traced(name, "EXITING", 1259, parameters),
            traced(objectPath, "EXITING", 1316, parameters)));
}

// ---- Names ----

TEST(ClassNamesTest, AreTheOnesOfTheSchema)
{
    using namespace Vorn::SensorProfileProvider;
    EXPECT_STREQ(SensorClass, numericSensor);
    EXPECT_STREQ(ComputerSystemClass, computerSystem);
    EXPECT_STREQ(SensorSystemDeviceClass, systemDevice);
    EXPECT_STREQ(SensorElementCapabilitiesClass, elementCapabilities);
    EXPECT_STREQ(SensorEnabledLogicalElementCapClass, capabilities);
}

} // namespace AssociationTargetTests
