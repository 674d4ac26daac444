// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_SensorElementCapabilities when calls of the broker fail.

#include "tests/providers/Factories.h"
#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/RequestTrace.h"

#include <gmock/gmock.h>

namespace ElementCapabilitiesFaultTests {

using namespace Testing;
using namespace ::testing;

constexpr const char* Class = "ZUMLO_SensorElementCapabilities";
constexpr const char* CapabilitiesClass = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* Provider = "SensorElementCapabilitiesProvider";
constexpr const char* CapabilitiesProvider = "SensorEnabledLogicalElementCapabilitiesProvider";
const std::string Gap(21, ' ');

const RequestKinds Kinds = {SensorElementCapabilitiesProvider_Create_InstanceMI,
    SensorElementCapabilitiesProvider_Create_AssociationMI};
const SourceMaker Keyless = pathMaker(Class);
const SourceMaker Sensor = sensorMaker("B:/2");
const SourceMaker Capabilities =
    pathMaker(CapabilitiesClass, "InstanceID", "ZUMLO:SensorEnabledLogicalElementCap1");
const SourceMaker Pair = pairMaker(Class, "ManagedElement", Sensor, "Capabilities", Capabilities);

const RequestKind Names = Kinds.names(Keyless);
const RequestKind Instances = Kinds.instances(Keyless);
const RequestKind OneInstance = Kinds.one("oneInstance", Pair);
const RequestKind FromSensor[] = {Kinds.associators("Sensor", Sensor),
    Kinds.associatorNames("Sensor", Sensor), Kinds.references("Sensor", Sensor),
    Kinds.referenceNames("Sensor", Sensor)};
const RequestKind FromCapabilities[] = {Kinds.associators("Capabilities", Capabilities),
    Kinds.associatorNames("Capabilities", Capabilities),
    Kinds.references("Capabilities", Capabilities),
    Kinds.referenceNames("Capabilities", Capabilities)};
enum Which { Associators, AssociatorNames, References, ReferenceNames };

class ElementCapabilitiesFaultTest : public AssociationFaultTest {
protected:
    ElementCapabilitiesFaultTest() : AssociationFaultTest({}) {}

    static HandlerLines handler(const std::string& function)
    {
        return {"SensorElementCapabilities", Provider, function};
    }

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

// ---- Every call in every manner ----

class ElementCapabilitiesFaultSweepTest : public ElementCapabilitiesFaultTest,
                                          public ::testing::WithParamInterface<RequestKind> {};

INSTANTIATE_TEST_SUITE_P(Instances, ElementCapabilitiesFaultSweepTest,
    ::testing::Values(Names, Instances, OneInstance, Kinds.one("instanceWithoutKeys", Keyless)),
    ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromSensor, ElementCapabilitiesFaultSweepTest,
    ::testing::ValuesIn(FromSensor), ::testing::PrintToStringParamName());
INSTANTIATE_TEST_SUITE_P(FromCapabilities, ElementCapabilitiesFaultSweepTest,
    ::testing::ValuesIn(FromCapabilities), ::testing::PrintToStringParamName());

TEST_P(ElementCapabilitiesFaultSweepTest, IsSurvivedAndAnswersWithNothingMadeUp)
{
    sweepFaults(broker_, [&](FaultyBroker& faulty) {
        const FaultyRequest request(broker_, faulty, GetParam());
        EXPECT_LE(request.answer.paths().size() + request.answer.instances().size(), 2U);
        expectWellFormed(request, Class,
            {{"ManagedElement", "ZUMLO_NumericSensor"}, {"Capabilities", CapabilitiesClass}});
    });
}

// ---- The iteration over all pairs. Paths are made in this order: both sensors, then for each
// ---- sensor the capabilities and the association. A sensor has four keys, capabilities one. ----

constexpr unsigned FirstSensor = 1;
constexpr unsigned FirstCapabilities = 3;
constexpr unsigned FirstAssociation = 4;
constexpr unsigned SecondAssociation = 6;
constexpr unsigned LastKeyOfFirstSensor = 4;
constexpr unsigned KeyOfFirstCapabilities = 9;

TEST_F(ElementCapabilitiesFaultTest, NamesWithoutSensorPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : Undelivered) {
        const auto [request, lines] =
            runTraced(Names, {BrokerCall::newObjectPath, FirstSensor, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed.");
        EXPECT_EQ(request->messages.size(), 1U); // the factory's
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesFaultTest, NamesWithoutCapabilitiesPathsEndInTheFactorysStatus)
{
    for (const FaultManner manner : Undelivered) {
        const auto [request, lines] =
            runTraced(Names, {BrokerCall::newObjectPath, FirstCapabilities, manner});
        expectBrokenOff(*request, "Create CMPIObjectPath failed");
        EXPECT_EQ(lines, handler("SensorElementCapabilities_EnumInstanceNames").entry());
    }
}

TEST_F(ElementCapabilitiesFaultTest, NamesEndAtAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed" + Gap + "for ElementCapabilities";
    for (const FaultManner manner : Undelivered)
        expectNamesFailure({BrokerCall::newObjectPath, FirstAssociation, manner}, text, text + ".");
}

TEST_F(ElementCapabilitiesFaultTest, NamesBeforeAFailureAreDelivered)
{
    const auto request =
        run(Names, {BrokerCall::newObjectPath, SecondAssociation, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->answer.paths().size(), 1U);
    EXPECT_FALSE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesFaultTest, NamesEndAtASensorPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for Sensor class";
    expectNamesFailure(
        {BrokerCall::addKey, LastKeyOfFirstSensor, FaultManner::lostHandle}, text, text);
}

TEST_F(ElementCapabilitiesFaultTest, NamesEndAtACapabilitiesPathThatIsGone)
{
    expectNamesFailure({BrokerCall::addKey, KeyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + Gap + "NULL for SensorEnabledLogicalElementCap",
        "CMPIObjectPath is NULL for" + Gap + "EnabledLogicalElementCap");
}

TEST_F(ElementCapabilitiesFaultTest, TheBuilderReportsSensorPathsThatCannotBeMade)
{
    for (const FaultManner manner : Undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, FirstSensor, manner},
            "Create CMPIObjectPath failed.",
            "***Can't get Sensor ObjectPaths." + std::string(13, ' ') +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesFaultTest, TheBuilderReportsCapabilitiesPathsThatCannotBeMade)
{
    const std::string gap(17, ' ');
    for (const FaultManner manner : Undelivered)
        expectBuilderFailure({BrokerCall::newObjectPath, FirstCapabilities, manner},
            "Create CMPIObjectPath failed",
            "***Can't get ObjectPaths for" + gap + "EnabledLogicalElementCap" + gap +
                "Exiting EnumerateInstanceNames***",
            "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed");
}

TEST_F(ElementCapabilitiesFaultTest, TheBuilderReportsAnAssociationPathThatCannotBeMade)
{
    const std::string text = "Create CMPIObjectPath failed for ElementCapabilities";
    for (const FaultManner manner : Undelivered)
        for (const unsigned nth : {FirstAssociation, SecondAssociation})
            expectBuilderFailure({BrokerCall::newObjectPath, nth, manner}, text, text + ".", text);
}

TEST_F(ElementCapabilitiesFaultTest, TheBuilderReportsASensorPathThatIsGone)
{
    expectBuilderFailure({BrokerCall::addKey, LastKeyOfFirstSensor, FaultManner::lostHandle},
        "CMPIObjectPath is" + std::string(17, ' ') + "NULL for Sensor",
        "CMPIObjectPath is NULL for Sensor", "CMPIObjectPath is NULL for Sensor");
}

TEST_F(ElementCapabilitiesFaultTest, TheBuilderReportsACapabilitiesPathThatIsGone)
{
    const std::string text = "CMPIObjectPath is NULL for EnabledLogicalElementCap";
    expectBuilderFailure({BrokerCall::addKey, KeyOfFirstCapabilities, FaultManner::lostHandle},
        "CMPIObjectPath is" + Gap + "NULL for EnabledLogicalElementCap", text, text);
}

TEST_F(ElementCapabilitiesFaultTest, AnInstanceThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : Undelivered) {
        const auto request = run(Instances, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.refused(), 1U);
        EXPECT_EQ(request->answer.instances().size(), 1U);
        EXPECT_TRUE(request->answer.isDone());
    }
}

TEST_F(ElementCapabilitiesFaultTest, AnInstanceThatCannotBeMadeIsPassedOverInASearch)
{
    for (const FaultManner manner : Undelivered) {
        const auto request = run(OneInstance, {BrokerCall::newInstance, 1, manner});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->answer.instances().size(), 1U); // the pair is the second one
        EXPECT_EQ(request->answer.refused(), 0U);
    }
}

TEST_F(ElementCapabilitiesFaultTest, AnAssociatorThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const FaultManner manner : Undelivered)
        for (const auto* const kinds : {FromSensor, FromCapabilities}) {
            const auto request = run(kinds[Associators], {BrokerCall::newInstance, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(request->answer.refused(), 1U);
        }
}

// The status of the request is not passed to the call that returns the path of an instance.
TEST_F(ElementCapabilitiesFaultTest, APathThatIsNotToldLeavesTheStatus)
{
    const Fault fault = {BrokerCall::getObjectPath, 2, FaultManner::nullResult}; // the last
    for (const RequestKind& kind : {OneInstance, FromCapabilities[ReferenceNames]})
        EXPECT_EQ(run(kind, fault)->status.rc, CMPI_RC_OK) << kind;
}

TEST_F(ElementCapabilitiesFaultTest, TheFilterIsSetBeforeTheReferences)
{
    run(Instances, {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus});
    const std::vector<BrokerCall>& calls = faulty_->calls();
    EXPECT_LT(std::find(calls.begin(), calls.end(), BrokerCall::setPropertyFilter),
        std::find(calls.begin(), calls.end(), BrokerCall::setProperty));
}

TEST_F(ElementCapabilitiesFaultTest, APathThatCannotCountItsKeysHasNone)
{
    const auto request = run(OneInstance, {BrokerCall::getKeyCount, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(), "At least one key should be passed");
    EXPECT_TRUE(request->answer.isDone());
}

TEST_F(ElementCapabilitiesFaultTest, APathWhoseKeyCountReportsAFailureLeavesTheStatus)
{
    const auto request = run(OneInstance, {BrokerCall::getKeyCount, 1, FaultManner::errorStatus});
    EXPECT_EQ(request->status.rc, CMPI_RC_OK);
    EXPECT_EQ(request->answer.instances().size(), 1U);
}

TEST_F(ElementCapabilitiesFaultTest, NamespacesAndClassNamesLeaveTheStatus)
{
    const RequestKind alongAnother = {
        "alongAnother", Sensor, [](auto* broker, auto* context, auto* result, auto* path) {
            CMPIAssociationMI* const mi = Kinds.associationFactory(broker, nullptr, nullptr);
            return mi->ft->associators(mi, context, result, path, "ZUMLO_SensorSystemDevice",
                nullptr, nullptr, nullptr, nullptr);
        }};
    EXPECT_EQ(runWithLast(alongAnother, BrokerCall::getCharPtr)->status.rc, CMPI_RC_OK);
    const auto unnamed =
        runWithLast(alongAnother, BrokerCall::getClassName, FaultManner::nullResult);
    EXPECT_EQ(unnamed->status.rc, CMPI_RC_OK);
    expectNamespacesLeaveTheStatus(Names);
    for (const auto* const kinds : {FromSensor, FromCapabilities})
        for (const Which which : {Associators, AssociatorNames, References, ReferenceNames})
            expectNamespacesLeaveTheStatus(kinds[which]);
}

TEST_F(ElementCapabilitiesFaultTest, TheCapabilitiesAreGivenTheirNamespaceBeforeTheSensor)
{
    expectNameSpacesInOrder(Names, Class, CapabilitiesClass, "ZUMLO_NumericSensor");
}

TEST_F(ElementCapabilitiesFaultTest, EveryValueIsWhole)
{
    expectWholeValues(Names, Instances, {"Capabilities", CapabilitiesClass});
}

// ---- Associated objects. The first path that is made is the target; for references the
// ---- association's follows, and then come the far ends. ----

TEST_F(ElementCapabilitiesFaultTest, ATargetThatCannotBeMadeIsNoTarget)
{
    const std::string names[] = {"Associators", "AssociatorsNames", "References", "ReferenceNames"};
    for (const FaultManner manner : Undelivered)
        for (const auto* const kinds : {FromSensor, FromCapabilities})
            for (const Which which : {Associators, AssociatorNames, References, ReferenceNames}) {
                const auto request =
                    run(kinds[which], {BrokerCall::newObjectPath, 1, manner, CMPI_RC_OK});
                const std::string text = "Object Path is NULL in " + names[which] + ".";
                expectBrokenOff(*request, text);
                EXPECT_EQ(request->lastMessage(), (BrokerMessage{2, Provider, text}));
            }
}

// Each fetch of the paths ends with its own trace line.
TEST_F(ElementCapabilitiesFaultTest, FarEndsThatCannotBeMadeEndInTheFactorysStatus)
{
    const std::string functions[] = {"", "SensorElementCapabilities_AssociatorNames",
        "SensorElementCapabilities_References", "SensorElementCapabilities_ReferenceNames"};
    for (const Which which : {AssociatorNames, References, ReferenceNames})
        for (const bool fromSensor : {true, false}) {
            const auto [request, lines] =
                runTraced((fromSensor ? FromSensor : FromCapabilities)[which],
                    {BrokerCall::newObjectPath, which == AssociatorNames ? 2U : 3U,
                        FaultManner::nullResult});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
            EXPECT_EQ(request->message(),
                fromSensor ? "Create CMPIObjectPath failed" : "Create CMPIObjectPath failed.");
            EXPECT_THAT(request->answer.paths(), IsEmpty());
            EXPECT_THAT(request->answer.instances(), IsEmpty());
            const HandlerLines expected = handler(functions[which]);
            EXPECT_THAT(lines,
                ElementsAreArray(sequence({expected.entry(),
                    expected.failure(fromSensor
                                         ? "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed"
                                         : "getAllSensorCMPIObjPaths failed"),
                    expected.exit()})));
        }
}

TEST_F(ElementCapabilitiesFaultTest, WithoutAnAssociationPathThereAreNoReferences)
{
    for (const FaultManner manner : Undelivered)
        for (const Which which : {References, ReferenceNames}) {
            const auto [request, lines] = runTraced(
                FromSensor[which], {BrokerCall::newObjectPath, 2, manner, CMPI_RC_ERR_FAILED});
            EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED); // as the broker left it
            const HandlerLines expected =
                handler(which == References ? "SensorElementCapabilities_References"
                                            : "SensorElementCapabilities_ReferenceNames");
            EXPECT_EQ(lines, sequence({expected.entry(), expected.exit()}));
            EXPECT_THAT(request->answer.paths(), IsEmpty());
            EXPECT_THAT(request->answer.instances(), IsEmpty());
            EXPECT_EQ(request->answer.refused(), 0U);
        }
}

TEST_F(ElementCapabilitiesFaultTest, EveryAssociatorNameIsGivenItsNamespaceOnceMore)
{
    run(FromCapabilities[AssociatorNames], std::vector<Fault>{});
    EXPECT_EQ(timesCalled("setNameSpace", "ZUMLO_NumericSensor"), 1 + 2 * 2); // and the target's
    run(FromSensor[AssociatorNames], std::vector<Fault>{});
    EXPECT_EQ(timesCalled("setNameSpace", CapabilitiesClass), 1 + 2);
}

TEST_F(ElementCapabilitiesFaultTest, AssociatorsEndInTheStatusThatTheBrokerLeft)
{
    const auto capabilities = run(FromSensor[Associators],
        {BrokerCall::newObjectPath, 2, FaultManner::nullResult, CMPI_RC_ERR_ACCESS_DENIED});
    EXPECT_EQ(capabilities->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    const auto sensors = runWithLast(FromCapabilities[Associators], BrokerCall::newArray);
    EXPECT_EQ(sensors->status.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(sensors->answer.instances().size(), 2U);
}

TEST_F(ElementCapabilitiesFaultTest, AReferenceThatCannotBeMadeIsLeftOut)
{
    for (const FaultManner manner : Undelivered)
        for (const Which which : {References, ReferenceNames}) {
            const auto request = run(FromCapabilities[which], {BrokerCall::newInstance, 1, manner});
            EXPECT_EQ(request->status.rc, CMPI_RC_OK);
            EXPECT_EQ(request->answer.paths().size() + request->answer.instances().size(), 1U);
            EXPECT_EQ(request->answer.refused(), 0U);
        }
}

TEST_F(ElementCapabilitiesFaultTest, AReferenceWhosePathIsNotToldIsLeftOutOfTheNames)
{
    for (const FaultManner manner : Undelivered) {
        const auto request =
            run(FromCapabilities[ReferenceNames], {BrokerCall::getObjectPath, 1, manner});
        EXPECT_EQ(request->answer.paths().size(), 1U);
        EXPECT_EQ(request->answer.refused(), 0U);
    }
}

TEST_F(ElementCapabilitiesFaultTest, AMissingArrayStandsInTheStatusBesideTheAssociator)
{
    const auto request = run(
        FromSensor[Associators], {BrokerCall::newArray, 1, FaultManner::nullResult, CMPI_RC_OK});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(),
        "Creating array for Property" + std::string(25, ' ') + "RequestedStatesSupported failed.");
    EXPECT_EQ(request->lastMessage().component, CapabilitiesProvider);
    ASSERT_EQ(request->answer.instances().size(), 1U);
    EXPECT_EQ(request->answer.instances()[0]->properties().size(), 2U);
}

} // namespace ElementCapabilitiesFaultTests
