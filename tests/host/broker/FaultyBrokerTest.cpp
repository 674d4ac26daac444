// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The broker that fails on demand does what tests rely on.

#include "tests/support/FaultyBroker.h"

#include "host/broker/BrokerUpcalls.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"

#include <map>
#include <thread>
#include <vector>

namespace HostTests {

using Testing::BrokerCall;
using Testing::FaultManner;
using Testing::FaultyBroker;

namespace {

class TwoObjects : public Host::BrokerUpcalls {
    Host::Enumeration& enumerateInstanceNames(
        const Host::Context&, const Host::ObjectPath& path) override
    {
        const std::vector twice(2, Host::Value::of(path));
        return Host::Enumeration::make(Host::Arena::required(), twice);
    }
    Host::Enumeration& enumerateInstances(
        const Host::Context&, const Host::ObjectPath& path, const char**) override
    {
        Host::Arena& arena = Host::Arena::required();
        const std::vector twice(2, Host::Value::of(Host::Instance::make(arena, path, nullptr)));
        return Host::Enumeration::make(arena, twice);
    }
};

} // namespace

class FaultyBrokerTest : public BrokerTest {
protected:
    FaultyBrokerTest() { broker.setUpcalls(&upcalls); }

    // A provider that makes every call that can fail, and looks at nothing it gets back
    // without care.
    void runProvider(const CMPIBroker* to, const CMPIObjectPath* ref, const CMPIResult* answer)
    {
        CMPIStatus status{CMPI_RC_OK, nullptr};
        const auto characters = [](CMPIString* text) {
            return text == nullptr ? nullptr : CMGetCharPtr(text);
        };
        const char* const nameSpace = characters(CMGetNameSpace(ref, &status));
        characters(CMGetClassName(ref, &status));
        characters(CMGetHostname(ref, &status));
        if (CMGetKeyCount(ref, &status) > 0)
            CMGetKeyAt(ref, 0, nullptr, &status);
        CMGetKey(ref, "DeviceID", &status);
        CMTraceMessage(to, CMPI_LEV_INFO, "C", "T", nullptr);
        if (CMPIObjectPath* const made = CMNewObjectPath(to, nameSpace, "Made", &status)) {
            CMSetNameSpace(made, "root/other");
            CMSetHostname(made, "host");
            CMAddKey(made, "DeviceID", "1", CMPI_chars);
            if (CMPIInstance* const object = CMNewInstance(to, made, &status)) {
                const char* keys[] = {"DeviceID", nullptr};
                CMSetPropertyFilter(object, nullptr, keys);
                if (CMPIArray* const list = CMNewArray(to, 1, CMPI_string, &status)) {
                    if (CMPIString* const text = CMNewString(to, "text", &status))
                        CMSetArrayElementAt(list, 0, &text, CMPI_string);
                    CMSetProperty(object, "List", &list, CMPI_stringA);
                }
                CMGetProperty(object, "List", &status);
                CMGetObjectPath(object, &status);
                CMReturnInstance(answer, object);
            }
            CMReturnObjectPath(answer, made);
        }
        const CMPIContext* const context = request.context().handle();
        CBEnumInstances(to, context, ref, nullptr, &status);
        CBGetInstance(to, context, ref, nullptr, &status);
        if (CMPIEnumeration* const names = CBEnumInstanceNames(to, context, ref, &status))
            while (CMHasNext(names, &status)) {
                const CMPIData next = CMGetNext(names, &status);
                if ((next.state & CMPI_nullValue) != 0)
                    break;
                characters(CMGetClassName(next.value.ref, &status));
            }
        CMReturnDone(answer);
    }

    void runProvider(FaultyBroker& faulty)
    {
        Host::CollectedResult collected;
        Host::Result result(collected);
        Host::ObjectPath& ref = request.makePath("root/cimv2", "Test_Class");
        ref.addKey("DeviceID", Host::Value::text(request.arena(), "1"));
        runProvider(faulty.handle(), faulty.watch(ref.handle()), faulty.watch(result.handle()));
    }

    TwoObjects upcalls;
};

TEST_F(FaultyBrokerTest, CountsEveryKindOfCall)
{
    FaultyBroker faulty(broker);
    runProvider(faulty);
    for (const BrokerCall call : Testing::allBrokerCalls())
        EXPECT_GE(faulty.count(call), 1U) << nameOf(call);
    EXPECT_EQ(faulty.count(BrokerCall::hasNext), 3U);
    EXPECT_EQ(faulty.count(BrokerCall::getNext), 2U);
    EXPECT_EQ(faulty.count(BrokerCall::newObjectPath), 1U);
    EXPECT_EQ(faulty.calls().front(), BrokerCall::getNameSpace);
    EXPECT_EQ(faulty.calls().back(), BrokerCall::returnDone);
    EXPECT_EQ(faulty.fired(), 0U);
    faulty.reset();
    EXPECT_TRUE(faulty.calls().empty());
    EXPECT_EQ(faulty.count(BrokerCall::hasNext), 0U);
}

TEST_F(FaultyBrokerTest, ACarefulProviderSurvivesEveryFault)
{
    std::map<BrokerCall, unsigned> counted;
    {
        FaultyBroker faulty(broker);
        runProvider(faulty);
        for (const BrokerCall call : Testing::allBrokerCalls())
            counted[call] = faulty.count(call);
    }
    for (const BrokerCall call : Testing::allBrokerCalls())
        for (const FaultManner manner : Testing::mannersOf(call))
            for (unsigned n = 1; n <= counted[call]; ++n) {
                FaultyBroker faulty(broker);
                faulty.plan({call, n, manner});
                runProvider(faulty);
                EXPECT_EQ(faulty.fired(), 1U) << nameOf(call) << ' ' << n << ' ' << nameOf(manner);
            }
}

TEST_F(FaultyBrokerTest, TheNthCallFailsAndNoOther)
{
    FaultyBroker faulty(broker);
    faulty.plan({BrokerCall::newString, 2, FaultManner::nullResult, CMPI_RC_ERR_ACCESS_DENIED});
    EXPECT_NE(CMNewString(faulty.handle(), "first", &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(CMNewString(faulty.handle(), "second", &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(CMNewString(faulty.handle(), "second", nullptr)->ft->ftVersion, 200U);
    EXPECT_EQ(faulty.fired(), 1U);
}

TEST_F(FaultyBrokerTest, AHandlelessObjectSurvivesBeingUsed)
{
    FaultyBroker faulty(broker);
    faulty.plan({BrokerCall::newObjectPath, 1, FaultManner::handleless});
    CMPIObjectPath* const made = CMNewObjectPath(faulty.handle(), "ns", "C", &rc);
    ASSERT_NE(made, nullptr);
    EXPECT_TRUE(CMIsNullObject(made));
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMAddKey(made, "A", "1", CMPI_chars).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CMNewInstance(faulty.handle(), made, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(FaultyBrokerTest, AnErrorStatusComesWithTheResult)
{
    FaultyBroker faulty(broker);
    faulty.plan({BrokerCall::newString, 1, FaultManner::errorStatus});
    CMPIString* const made = CMNewString(faulty.handle(), "text", &rc);
    EXPECT_EQ(textOf(made), "text");
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(FaultyBrokerTest, AFailedChangeIsNotMade)
{
    FaultyBroker faulty(broker);
    CMPIObjectPath* const made = CMNewObjectPath(faulty.handle(), "ns", "C", &rc);
    faulty.plan({BrokerCall::setNameSpace, 1, FaultManner::errorStatus});
    EXPECT_EQ(CMSetNameSpace(made, "other").rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(textOf(CMGetNameSpace(made, nullptr)), "ns");
}

TEST_F(FaultyBrokerTest, ValuesFailByTheirType)
{
    FaultyBroker faulty(broker);
    CMPIObjectPath* const made = CMNewObjectPath(faulty.handle(), "ns", "C", &rc);
    CMPIObjectPath* const reference = CMNewObjectPath(faulty.handle(), "ns", "R", &rc);
    CMAddKey(made, "Text", "1", CMPI_chars);
    CMAddKey(made, "Ref", &reference, CMPI_ref);
    faulty.plan({BrokerCall::getKey, 1, FaultManner::handleless, CMPI_RC_OK});
    faulty.plan({BrokerCall::getKey, 2, FaultManner::handleless, CMPI_RC_OK});
    faulty.plan({BrokerCall::getKey, 3, FaultManner::nullResult, CMPI_RC_OK});
    const CMPIData text = CMGetKey(made, "Text", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(text.type, CMPI_string);
    EXPECT_EQ(CMGetCharPtr(text.value.string), nullptr);
    const CMPIData path = CMGetKey(made, "Ref", &rc);
    EXPECT_EQ(path.type, CMPI_ref);
    EXPECT_TRUE(CMIsNullObject(path.value.ref));
    EXPECT_EQ(CMGetKey(made, "Text", &rc).state, absentState);
    EXPECT_EQ(textOf(CMGetKey(made, "Text", &rc)), "1");
}

TEST_F(FaultyBrokerTest, ObjectsWorkOnAfterItsEndAndOnOtherThreads)
{
    CMPIObjectPath* made = nullptr;
    {
        FaultyBroker faulty(broker);
        made = CMNewObjectPath(faulty.handle(), "ns", "C", &rc);
        faulty.plan({BrokerCall::getClassName, 1, FaultManner::nullResult});
        std::thread([&] { EXPECT_NE(CMGetClassName(made, nullptr), nullptr); }).join();
        EXPECT_EQ(faulty.count(BrokerCall::getClassName), 0U);
    }
    EXPECT_EQ(textOf(CMGetClassName(made, nullptr)), "C");
}

TEST_F(FaultyBrokerTest, IsTheSameBrokerOtherwise)
{
    FaultyBroker faulty(broker);
    EXPECT_STREQ(faulty.handle()->bft->brokerName, "sensor-profile");
    EXPECT_EQ(faulty.handle()->bft->brokerCapabilities, mb->bft->brokerCapabilities);
    EXPECT_EQ(faulty.handle()->xft, mb->xft);
    EXPECT_EQ(faulty.handle()->mft, mb->mft);
}

} // namespace HostTests
