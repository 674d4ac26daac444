// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The broker that injects faults. The sweeps over the providers show that each call can fail.

#include "tests/support/FaultyBroker.h"

#include "tests/host/broker/BrokerTest.h"

#include <thread>

namespace HostTests {

using Testing::BrokerCall;
using Testing::FaultManner;
using Testing::FaultyBroker;

using FaultyBrokerTest = BrokerTest;

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
    const CMPIValue reference = {.ref = CMNewObjectPath(faulty.handle(), "ns", "R", &rc)};
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
