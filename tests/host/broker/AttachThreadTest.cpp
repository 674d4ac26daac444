// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Other threads of a provider that work for a request.

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"

#include <memory>
#include <thread>
#include <vector>

namespace HostTests {

using AttachThreadTest = BrokerTest;

TEST_F(AttachThreadTest, AnAttachedThreadMakesObjectsForTheRequest)
{
    CMPIContext* const prepared = CBPrepareAttachThread(mb, request.context().handle());
    ASSERT_NE(prepared, nullptr);
    CMPIString* made = nullptr;
    std::thread([&] {
        CMPIStatus status{CMPI_RC_OK, nullptr};
        EXPECT_EQ(CMNewString(mb, "too early", &status), nullptr);
        EXPECT_EQ(CBAttachThread(mb, prepared).rc, CMPI_RC_OK);
        made = CMNewString(mb, "from the other thread", &status);
        EXPECT_EQ(CBDetachThread(mb, prepared).rc, CMPI_RC_OK);
        EXPECT_EQ(CMNewString(mb, "too late", &status), nullptr);
    }).join();
    EXPECT_EQ(textOf(made), "from the other thread");
}

TEST_F(AttachThreadTest, ThePreparedContextSaysTheSame)
{
    CMAddContextEntry(request.context().handle(), "Mine", "text", CMPI_chars);
    CMPIContext* const prepared = CBPrepareAttachThread(mb, request.context().handle());
    EXPECT_EQ(textOf(CMGetContextEntry(prepared, "Mine", nullptr)), "text");
}

TEST_F(AttachThreadTest, SeveralThreadsDeliverToOneResult)
{
    Host::CollectedResult collected;
    Host::Result result(collected);
    CMPIObjectPath* const common = path("Common");
    std::vector<std::thread> threads;
    for (int i = 0; i < 4; ++i) {
        CMPIContext* const prepared = CBPrepareAttachThread(mb, request.context().handle());
        threads.emplace_back([&, prepared] {
            CBAttachThread(mb, prepared);
            for (int n = 0; n < 100; ++n) {
                CMPIInstance* const made = CMNewInstance(mb, common, nullptr);
                CMSetProperty(made, "N", &n, CMPI_sint32);
                CMReturnInstance(result.handle(), made);
            }
            CBDetachThread(mb, prepared);
        });
    }
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(collected.instances().size(), 400U);
    for (const Host::Instance* const delivered : collected.instances()) {
        EXPECT_EQ(delivered->className(), "Common");
        EXPECT_TRUE(delivered->property("N")->signedInteger());
    }
}

TEST_F(AttachThreadTest, AnObjectOfOneThreadTakesChangesFromAnother)
{
    CMPIInstance* const made = instance();
    CMPIContext* const prepared = CBPrepareAttachThread(mb, request.context().handle());
    std::thread other([&] {
        CBAttachThread(mb, prepared);
        CMSetProperty(made, "A", "from the other thread", CMPI_chars);
        CBDetachThread(mb, prepared);
    });
    for (int i = 0; i < 100; ++i)
        path("Meanwhile");
    other.join();
    EXPECT_EQ(textOf(CMGetProperty(made, "A", nullptr)), "from the other thread");
}

TEST_F(AttachThreadTest, AnAttachedThreadCanPrepareAnother)
{
    CMPIString* made = nullptr;
    CMPIContext* const first = CBPrepareAttachThread(mb, request.context().handle());
    std::thread([&] {
        CBAttachThread(mb, first);
        CMPIContext* const second = CBPrepareAttachThread(mb, first);
        std::thread([&] {
            CBAttachThread(mb, second);
            made = CMNewString(mb, "from the third thread", nullptr);
            CBDetachThread(mb, second);
        }).join();
        CBDetachThread(mb, first);
    }).join();
    EXPECT_EQ(textOf(made), "from the third thread");
}

TEST_F(AttachThreadTest, OneContextServesOneThreadOnce)
{
    CMPIContext* const prepared = CBPrepareAttachThread(mb, request.context().handle());
    EXPECT_EQ(CBAttachThread(mb, prepared).rc, CMPI_RC_ERR_FAILED) << "has a request already";
    EXPECT_EQ(CBDetachThread(mb, prepared).rc, CMPI_RC_ERR_FAILED) << "was not attached";
    std::thread([&] {
        EXPECT_EQ(CBAttachThread(mb, prepared).rc, CMPI_RC_OK);
        std::thread([&] {
            EXPECT_EQ(CBAttachThread(mb, prepared).rc, CMPI_RC_ERR_FAILED) << "in use";
            EXPECT_EQ(CBDetachThread(mb, prepared).rc, CMPI_RC_ERR_FAILED) << "another thread's";
        }).join();
        EXPECT_EQ(CBDetachThread(mb, prepared).rc, CMPI_RC_OK);
        EXPECT_EQ(CBAttachThread(mb, request.context().handle()).rc, CMPI_RC_ERR_FAILED)
            << "not prepared";
    }).join();
}

TEST(AttachThreadLifetimeTest, AThreadMayOutliveTheRequest)
{
    Host::Broker broker;
    const CMPIBroker* const mb = broker.handle();
    auto request = std::make_unique<Host::Request>(broker, Host::RequestInfo{.principal = "me"});
    CMPIContext* const prepared = CBPrepareAttachThread(mb, request->context().handle());
    request.reset();
    std::thread([&] {
        EXPECT_EQ(CBAttachThread(mb, prepared).rc, CMPI_RC_OK);
        EXPECT_EQ(textOf(CMGetContextEntry(prepared, CMPIPrincipal, nullptr)), "me");
        EXPECT_NE(CMNewString(mb, "text", nullptr), nullptr);
        EXPECT_EQ(CBDetachThread(mb, prepared).rc, CMPI_RC_OK);
    }).join();
}

TEST(AttachThreadLifetimeTest, AThreadThatNeverCameLeavesNothingBehindTheBroker)
{
    Host::Broker broker;
    Host::Request request(broker);
    EXPECT_NE(CBPrepareAttachThread(broker.handle(), request.context().handle()), nullptr);
}

} // namespace HostTests
