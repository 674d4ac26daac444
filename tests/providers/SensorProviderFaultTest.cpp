// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_NumericSensor when calls of the broker fail.

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyRequest.h"

#include <gmock/gmock.h>

namespace SensorProviderFaultTests {

using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_NumericSensor";
const std::vector<ScriptedNode> twoSensors = {{NodeType::Temperature, "/t", "CPU", NodeReading{}},
    {NodeType::Tachometer, "/f", "Fan", NodeReading{}}};

enum class Operation { names, instances, oneInstance, instanceByPath };

// Returns the kind of request for an operation.
RequestKind kindOf(Operation operation, const char** properties = nullptr)
{
    const auto source = [operation](const Host::Request& request) -> Host::ObjectPath& {
        Host::ObjectPath& made = request.makePath("root/cimv2", Class);
        if (operation == Operation::oneInstance)
            made.addKey("DeviceID", Host::Value::text(request.arena(), "Fan:/f"));
        if (operation == Operation::instanceByPath)
            made.addKey("Other", Host::Value::text(request.arena(), "x"));
        return made;
    };
    const auto run = [=](const CMPIBroker* broker, const CMPIContext* context,
                         const CMPIResult* result, const CMPIObjectPath* ref) {
        CMPIInstanceMI* const mi =
            SensorProfileProvider_Create_InstanceMI(broker, nullptr, nullptr);
        if (operation == Operation::names)
            return mi->ft->enumerateInstanceNames(mi, context, result, ref);
        if (operation == Operation::instances)
            return mi->ft->enumerateInstances(mi, context, result, ref, properties);
        return mi->ft->getInstance(mi, context, result, ref, properties);
    };
    return {"", source, run};
}

class SensorProviderFaultTest : public FaultTest {
protected:
    // Runs the request with one fault.
    std::unique_ptr<FaultyRequest> run(
        Operation operation, const Testing::Fault& fault, const char** properties = nullptr)
    {
        return FaultTest::run(kindOf(operation, properties), fault);
    }

    ScriptedMachine machine_{twoSensors};
};

// ---- Paths ----

class PathFailureTest : public SensorProviderFaultTest,
                        public ::testing::WithParamInterface<FaultManner> {
protected:
    static void expectFailedPath(const FaultyRequest& request)
    {
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request.message(), "Create CMPIObjectPath failed.");
        EXPECT_TRUE(request.answer.paths().empty());
        EXPECT_FALSE(request.answer.isDone());
        EXPECT_THAT(request.messages,
            ElementsAre(BrokerMessage{2, "SensorProfileProvider",
                "Create CMPIObjectPath                     failed for RecordLogClass."}));
    }
};

INSTANTIATE_TEST_SUITE_P(NullOrHandleless, PathFailureTest,
    ::testing::Values(FaultManner::nullResult, FaultManner::handleless));

TEST_P(PathFailureTest, AnEnumerationOfNamesEndsAtTheFirstPathThatCannotBeMade)
{
    for (const unsigned nth : {1U, 2U})
        expectFailedPath(*run(Operation::names, {BrokerCall::newObjectPath, nth, GetParam()}));
}

TEST_P(PathFailureTest, ANamespaceThatCannotBeReadIsAPathThatCannotBeMade)
{
    expectFailedPath(*run(Operation::names, {BrokerCall::getNameSpace, 1, GetParam()}));
}

TEST_P(PathFailureTest, AnInstanceWithoutAPathIsANullInstance)
{
    const auto request = run(Operation::instances, {BrokerCall::newObjectPath, 1, GetParam()});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_EQ(request->answer.instances().size(), 1U);
    EXPECT_EQ(request->answer.refused(), 1U); // the null entry is passed to the result
    EXPECT_TRUE(request->answer.isDone());
    EXPECT_TRUE(request->messages.empty());
}

TEST_P(PathFailureTest, AnInstanceWhosePathIsNotReturnedEqualsNothing)
{
    const auto request = run(Operation::instanceByPath, {BrokerCall::getObjectPath, 1, GetParam()});
    EXPECT_EQ(request->answer.instances().size(), 0U);
    EXPECT_TRUE(request->answer.isDone());
}

// ---- Arrays, in the order in which an instance needs them ----

constexpr unsigned possibleStates = 1;
constexpr unsigned supportedThresholds = 2;
constexpr unsigned settableThresholds = 3;
constexpr unsigned operationalStatus = 4;

class ArrayFailureTest : public SensorProviderFaultTest,
                         public ::testing::WithParamInterface<FaultManner> {
protected:
    std::unique_ptr<FaultyRequest> runWithout(unsigned array)
    {
        return run(Operation::oneInstance, {BrokerCall::newArray, array, GetParam(), CMPI_RC_OK});
    }

    static void expectReport(
        const FaultyRequest& request, const std::string& statusText, const std::string& traceText)
    {
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request.message(), statusText);
        EXPECT_THAT(
            request.messages, ElementsAre(BrokerMessage{2, "SensorProfileProvider", traceText}));
        EXPECT_EQ(request.answer.instances().size(), 1U); // with the properties set so far
        EXPECT_TRUE(request.answer.isDone());
    }

    static std::string lastProperty(const FaultyRequest& request)
    {
        return Testing::namesOf(request.answer.instances().at(0)->properties()).back();
    }
};

INSTANTIATE_TEST_SUITE_P(NullOrHandleless, ArrayFailureTest,
    ::testing::Values(FaultManner::nullResult, FaultManner::handleless));

TEST_P(ArrayFailureTest, WithoutPossibleStatesTheBuildGoesOn)
{
    const LogCapture capture;
    const auto request = runWithout(possibleStates);
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    ASSERT_EQ(request->answer.instances().size(), 1U);
    EXPECT_EQ(property(*request->answer.instances()[0], "PossibleStates"), "absent");
    EXPECT_EQ(lastProperty(*request), "UnitModifier");
    EXPECT_TRUE(request->messages.empty());
    EXPECT_EQ(capture.marksOf("makeSensorInstance").back(), "EXITING 737");
    std::vector<std::string> failures;
    for (const Testing::LogLine& line : capture.log())
        if (line.level == 6000)
            failures.push_back(Testing::withoutPointers(line));
    EXPECT_THAT(failures,
        ElementsAre("makeSensorInstance(SensorFactory:440) 6000 MESSAGE [File: SensorFactory, "
                    "Line: 440]: Failed to create CMPIArray for PossibleStates"));
}

TEST_P(ArrayFailureTest, WithoutSupportedThresholdsTheBuildEndsWithoutItsExitingLine)
{
    const LogCapture capture;
    const auto request = runWithout(supportedThresholds);
    const std::string text =
        "Create Array for Property" + std::string(25, ' ') + "SupportedThresholds failed.";
    expectReport(*request, text, text);
    EXPECT_EQ(lastProperty(*request), "RateUnits");
    EXPECT_THAT(capture.marksOf("makeSensorInstance"), ElementsAre("ENTERING 269"));
}

TEST_P(ArrayFailureTest, WithoutSettableThresholdsTheBuildEndsWithoutItsExitingLine)
{
    const LogCapture capture;
    const auto request = runWithout(settableThresholds);
    const std::string text =
        "Create Array for Property" + std::string(25, ' ') + "SettableThresholds failed.";
    expectReport(*request, text, text);
    EXPECT_EQ(lastProperty(*request), "SupportedThresholds");
    EXPECT_THAT(capture.marksOf("makeSensorInstance"), ElementsAre("ENTERING 269"));
}

TEST_P(ArrayFailureTest, WithoutOperationalStatusTheBuildEndsWithAnExitingLineOfItsOwn)
{
    const LogCapture capture;
    const auto request = runWithout(operationalStatus);
    expectReport(*request,
        "Create Array for Property" + std::string(25, ' ') + "OperationalStatus failed.",
        "Create Array for Property Operat" + std::string(24, ' ') + "ionalStatus failed.");
    EXPECT_EQ(lastProperty(*request), "Status");
    EXPECT_THAT(capture.marksOf("makeSensorInstance"), ElementsAre("ENTERING 269", "EXITING 615"));
}

TEST_P(ArrayFailureTest, InAnEnumerationLeavesTheOtherInstancesWhole)
{
    const auto request = run(
        Operation::instances, {BrokerCall::newArray, supportedThresholds, GetParam(), CMPI_RC_OK});
    EXPECT_EQ(request->messages.size(), 1U);
    ASSERT_EQ(request->answer.instances().size(), 2U);
    EXPECT_EQ(property(*request->answer.instances()[0], "SupportedThresholds"), "absent");
    EXPECT_EQ(request->answer.instances()[1]->properties().size(), 22U);
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(SensorProviderFaultTest, TheStatusThatTheBrokerLeftIsReturned)
{
    const char* properties[] = {"PossibleStates", nullptr};
    const auto request = run(Operation::oneInstance,
        {BrokerCall::newArray, possibleStates, FaultManner::nullResult, CMPI_RC_ERR_ACCESS_DENIED},
        properties);
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(request->status.msg, nullptr);
}

TEST_F(SensorProviderFaultTest, EveryRequestReturnsTheStatusThatTheBrokerLeft)
{
    for (const auto& [call, manner] : std::initializer_list<std::pair<BrokerCall, FaultManner>>{
             {BrokerCall::getNameSpace, FaultManner::nullResult},
             {BrokerCall::getCharPtr, FaultManner::errorStatus}}) {
        const auto names = runWithLast(kindOf(Operation::names), call, manner);
        EXPECT_EQ(names->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
        EXPECT_EQ(names->answer.paths().size(), 2U);
        EXPECT_TRUE(names->answer.isDone());
    }
    const auto instances = runWithLast(kindOf(Operation::instances), BrokerCall::newArray);
    EXPECT_EQ(instances->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(instances->answer.instances().size(), 2U);
    const auto searched = run(Operation::instanceByPath,
        {BrokerCall::getObjectPath, 2, FaultManner::errorStatus, CMPI_RC_ERR_ACCESS_DENIED});
    EXPECT_EQ(searched->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_TRUE(searched->answer.isDone());
}

// The faulty broker reads whole values, so that AddressSanitizer reports one that is shorter.
TEST_F(SensorProviderFaultTest, EveryValueIsWhole)
{
    const auto request = FaultTest::run(kindOf(Operation::oneInstance), std::vector<Fault>{});
    ASSERT_EQ(request->answer.instances().size(), 1U);
    const Host::Instance& instance = *request->answer.instances()[0];
    EXPECT_EQ(property(instance, "SensorType"), "uint16 5");
    EXPECT_EQ(property(instance, "UnitModifier"), "sint32 0");
    EXPECT_EQ(
        describe(instance.property("PossibleStates")->array()->elements()[0]), "string \"Normal\"");
    EXPECT_EQ(faulty_->count(BrokerCall::setProperty), 22U);
}

TEST_F(SensorProviderFaultTest, ALabelThatCannotBeMadeIsAnEmptyElement)
{
    const char* properties[] = {"PossibleStates", nullptr};
    for (const auto& [manner, code] : std::initializer_list<std::pair<FaultManner, CMPIrc>>{
             {FaultManner::nullResult, CMPI_RC_OK}, {FaultManner::handleless, CMPI_RC_OK},
             {FaultManner::errorStatus, CMPI_RC_ERR_FAILED}}) {
        const auto request =
            run(Operation::oneInstance, {BrokerCall::newString, 2, manner, code}, properties);
        ASSERT_EQ(request->answer.instances().size(), 1U);
        const Host::Array& states =
            *request->answer.instances()[0]->property("PossibleStates")->array();
        ASSERT_EQ(states.elements().size(), 12U);
        EXPECT_EQ(describe(states.elements()[0]), "string \"Normal\"");
        EXPECT_TRUE(states.elements()[1].isNull());
        EXPECT_EQ(describe(states.elements()[2]), "string \"Non-Critical\"");
        EXPECT_EQ(faulty_->count(BrokerCall::setElementAt), 11U);
    }
}

// ---- Failures that are ignored ----

// Without the broker's filter, only the builder selects properties.
TEST_F(SensorProviderFaultTest, HealthStateBringsStatusAlong)
{
    const char* properties[] = {"HealthState", nullptr};
    const auto request = run(Operation::oneInstance,
        {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus}, properties);
    ASSERT_EQ(request->answer.instances().size(), 1U);
    EXPECT_EQ(property(*request->answer.instances()[0], "HealthState"), "uint16 0");
    EXPECT_EQ(property(*request->answer.instances()[0], "Status"), "string \"\"");
    EXPECT_EQ(request->answer.instances()[0]->properties().size(), 6U);
}

TEST_F(SensorProviderFaultTest, SettingsThatFailAreIgnored)
{
    for (const BrokerCall call : {BrokerCall::setProperty, BrokerCall::setElementAt,
             BrokerCall::setHostname, BrokerCall::setNameSpace, BrokerCall::returnDone}) {
        const auto request = run(Operation::oneInstance, {call, 1, FaultManner::errorStatus});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK) << Testing::nameOf(call);
        EXPECT_EQ(request->answer.instances().size(), 1U) << Testing::nameOf(call);
    }
}

// A broker may not keep the namespace with which a path was made.
TEST_F(SensorProviderFaultTest, EveryNameIsGivenItsNamespaceOnceMoreBeforeItIsReturned)
{
    run(Operation::names, {BrokerCall::setNameSpace, 4, FaultManner::errorStatus});
    EXPECT_EQ(faulty_->count(BrokerCall::setNameSpace), 4U); // two for each sensor
}

// ---- Keys ----

TEST_F(SensorProviderFaultTest, AKeyWithoutCharactersFindsNothing)
{
    const auto request = run(
        Operation::oneInstance, {BrokerCall::getCharPtr, 1, FaultManner::nullResult, CMPI_RC_OK});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_TRUE(request->answer.instances().empty());
    EXPECT_FALSE(request->answer.isDone());
}

} // namespace SensorProviderFaultTests
