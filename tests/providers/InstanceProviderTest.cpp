// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests that are the same for both classes whose instances are records.

#include "tests/providers/FaultyAssociation.h"
#include "tests/providers/InstanceRequestsTest.h"

#include <gmock/gmock.h>

namespace InstanceProviderTests {

using namespace Testing;
using ::testing::ElementsAre;
using ::testing::WithParamInterface;

constexpr const char* noKeyText = "At least one key should be passed";
const std::vector<ScriptedNode> oneFan = {
    {Vorn::NodeLexicon::NodeType::Tachometer, "/f", "Fan", Vorn::NodeReading{}}};

struct ProviderCase {
    const char* name;
    const char* className;
    const char* provider;
    const char* key;
    const char* value; // of the key of the only instance
    InstanceFactory create;
};

const ProviderCase cases[] = {
    {"Sensor", "ZUMLO_NumericSensor", "SensorProfileProvider", "DeviceID", "Fan:/f",
        SensorProfileProvider_Create_InstanceMI},
    {"Capabilities", "ZUMLO_SensorEnabledLogicalElementCapabilities",
        "SensorEnabledLogicalElementCapabilitiesProvider", "InstanceID",
        "ZUMLO:SensorEnabledLogicalElementCap1",
        SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI},
};

std::string nameOfCase(const ::testing::TestParamInfo<ProviderCase>& info)
{
    return info.param.name;
}

// ---- Requests without faults ----

class InstanceProviderTest : public InstanceRequestsTest, public WithParamInterface<ProviderCase> {
protected:
    InstanceProviderTest() : InstanceRequestsTest(GetParam().className, GetParam().create, oneFan)
    {
        broker_.setClassInformation(&profileClasses());
    }

    void expectNothing(bool isDone)
    {
        EXPECT_TRUE(answer_.instances().empty());
        EXPECT_EQ(answer_.refused(), 0U);
        EXPECT_EQ(answer_.isDone(), isDone);
    }

    // Calls GetInstance with a result of its own. Returns what it delivers.
    Host::CollectedResult got(const Host::ObjectPath& ref)
    {
        Host::CollectedResult found;
        Host::Result into(found);
        expectOk(mi_->ft->getInstance(mi_, context(), into.handle(), ref.handle(), nullptr));
        EXPECT_TRUE(found.isDone());
        return found;
    }
};

INSTANTIATE_TEST_SUITE_P(Each, InstanceProviderTest, ::testing::ValuesIn(cases), nameOfCase);

TEST_P(InstanceProviderTest, APathWithoutKeysIsRefusedInAClosedResult)
{
    const CMPIStatus status = get(path(className_));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(textOf(status.msg), noKeyText);
    EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, GetParam().provider, noKeyText}));
    expectNothing(true);
}

TEST_P(InstanceProviderTest, ARefusalHasNoMessageWithoutABroker)
{
    GetParam().create(nullptr, nullptr, nullptr);
    const CMPIStatus status = get(path(className_));
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    EXPECT_TRUE(messages_.empty());
    expectNothing(true);
}

TEST_P(InstanceProviderTest, ARequestWithoutAPathIsRefused)
{
    const CMPIObjectPath handleless = {nullptr, &Host::ObjectPath::functions};
    const CMPIStatus status = mi_->ft->getInstance(mi_, context(), result(), &handleless, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(textOf(status.msg), noKeyText);
}

TEST_P(InstanceProviderTest, AnUnknownKeyIsAnOpenEmptyAnswer)
{
    std::string similar = GetParam().value;
    similar.back() = 'X';
    for (const std::string& unknown :
        {similar, GetParam().value + std::string(" "), std::string(), std::string("other")})
        expectOk(get({{GetParam().key, unknown}}));
    expectNothing(false);
    EXPECT_TRUE(messages_.empty());
}

TEST_P(InstanceProviderTest, OtherKeysAndTheLetterCaseOfNamesDoNotMatter)
{
    std::string className = className_;
    std::string key = GetParam().key;
    for (std::string* const name : {&className, &key})
        std::transform(name->begin(), name->end(), name->begin(), ::tolower);
    EXPECT_EQ(
        got(path(className.c_str(), {{"Other", "x"}, {key, GetParam().value}})).instances().size(),
        1U);
}

TEST_P(InstanceProviderTest, KeysWithoutTheIdentifierAreAClosedEmptyAnswer)
{
    expectOk(get({{"Other", "x"}}));
    expectNothing(true);
    EXPECT_TRUE(messages_.empty());
}

// Some object managers pass every key of the class, with null for those that the client left out.
TEST_P(InstanceProviderTest, AnIdentifierOfAnotherTypeCountsAsAbsent)
{
    const Host::ObjectPath& inner = path(className_, {{GetParam().key, GetParam().value}});
    for (const Host::Value& value : {Host::Value::integer(CMPI_uint64, 7),
             Host::Value::integer(CMPI_sint64, 7), Host::Value::boolean(true),
             Host::Value::of(inner), Host::Value::null(CMPI_string), Host::Value::absent()}) {
        Host::ObjectPath& ref = path(className_);
        ref.addKey(GetParam().key, value);
        EXPECT_TRUE(got(ref).instances().empty());
    }
    EXPECT_TRUE(messages_.empty());
}

TEST_P(InstanceProviderTest, TheNameThatIsEnumeratedCanBeFetched)
{
    expectOk(enumerateNames());
    ASSERT_EQ(answer_.paths().size(), 1U);
    const Host::CollectedResult found = got(*answer_.paths()[0]);
    ASSERT_EQ(found.instances().size(), 1U);
    EXPECT_EQ(found.instances()[0]->objectPath().toText(), answer_.paths()[0]->toText());
}

TEST_P(InstanceProviderTest, TheBrokerOfTheLastFactoryCallIsUsed)
{
    const FaultyBroker other(broker_);
    GetParam().create(other.handle(), nullptr, nullptr);
    get(path(className_));
    EXPECT_EQ(other.count(BrokerCall::trace), 1U);
}

// ---- Requests with faults ----

class InstanceProviderFaultTest : public FaultTest, public WithParamInterface<ProviderCase> {
protected:
    static RequestKinds kinds() { return {GetParam().create, nullptr}; }
    static SourceMaker keyless() { return pathMaker(GetParam().className); }
    static SourceMaker keyed(const char* key)
    {
        return pathMaker(GetParam().className, key, GetParam().value);
    }
    static RequestKind one() { return kinds().one("one", keyed(GetParam().key)); }

    const ScriptedMachine machine_{
        {oneFan[0], {Vorn::NodeLexicon::NodeType::Temperature, "/t", "CPU", {}}}};
};

INSTANTIATE_TEST_SUITE_P(Each, InstanceProviderFaultTest, ::testing::ValuesIn(cases), nameOfCase);

TEST_P(InstanceProviderFaultTest, EveryFaultOfEveryCallIsSurvivedAndNothingIsMadeUp)
{
    const std::size_t limit = GetParam().className == std::string("ZUMLO_NumericSensor") ? 2 : 1;
    for (const RequestKind& kind : {kinds().names(keyless()), kinds().instances(keyless()), one(),
             kinds().one("byPath", keyed("Other")), kinds().one("withoutKeys", keyless())})
        sweepFaults(broker_, [&](FaultyBroker& faulty) {
            const FaultyRequest request(broker_, faulty, kind);
            EXPECT_LE(request.answer.paths().size() + request.answer.instances().size(), limit);
            expectWellFormed(request, GetParam().className, {});
        });
}

TEST_P(InstanceProviderFaultTest, AnInstanceThatCannotBeMadeIsPassedOnAsItIs)
{
    for (const RequestKind& kind : {kinds().instances(keyless()), one()})
        for (const FaultManner manner : undelivered)
            for (const BrokerCall call : {BrokerCall::newInstance, BrokerCall::newObjectPath}) {
                const auto request = run(kind, {call, 1, manner, CMPI_RC_OK});
                EXPECT_EQ(request->status.rc, CMPI_RC_OK);
                EXPECT_EQ(request->answer.refused(), 1U);
                EXPECT_TRUE(request->answer.isDone());
                EXPECT_TRUE(request->messages.empty());
            }
}

TEST_P(InstanceProviderFaultTest, AKeyReportedMissingThroughTheStatusIsAbsentAndTheAnswerIsOk)
{
    for (const FaultManner manner : undelivered) {
        const auto request =
            run(one(), {BrokerCall::getKey, 1, manner, CMPI_RC_ERR_NO_SUCH_PROPERTY});
        EXPECT_EQ(request->status.rc, CMPI_RC_OK);
        EXPECT_EQ(request->status.msg, nullptr);
        EXPECT_TRUE(request->answer.instances().empty());
        EXPECT_TRUE(request->answer.isDone());
    }
}

TEST_P(InstanceProviderFaultTest, APathThatCannotCountItsKeysHasNone)
{
    const auto request = run(one(), {BrokerCall::getKeyCount, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->message(), noKeyText);
    EXPECT_TRUE(request->answer.isDone());
}

TEST_P(InstanceProviderFaultTest, AFailureWhoseMessageCannotBeMadeHasNone)
{
    const auto request = run(
        kinds().one("withoutKeys", keyless()), {BrokerCall::newString, 1, FaultManner::nullResult});
    EXPECT_EQ(request->status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(request->status.msg, nullptr);
}

// A broker may drop excluded properties at the moment in which the filter is set.
TEST_P(InstanceProviderFaultTest, TheFilterIsSetBeforeTheProperties)
{
    run(one(), {BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus});
    const std::vector<BrokerCall>& calls = faulty_->calls();
    EXPECT_LT(std::find(calls.begin(), calls.end(), BrokerCall::setPropertyFilter),
        std::find(calls.begin(), calls.end(), BrokerCall::setProperty));
}

} // namespace InstanceProviderTests
