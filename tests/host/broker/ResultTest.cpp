// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Result.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Error.h"
#include "host/broker/Instance.h"
#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"

#include <stdexcept>

namespace HostTests {

class ResultTest : public BrokerTest {
protected:
    Host::CollectedResult collected;
    Host::Result result{collected};
    const CMPIResult* handle = result.handle();
};

TEST_F(ResultTest, CollectsTheAnswerInOrder)
{
    EXPECT_EQ(CMReturnInstance(handle, instance("A")).rc, CMPI_RC_OK);
    EXPECT_EQ(CMReturnInstance(handle, instance("B")).rc, CMPI_RC_OK);
    EXPECT_EQ(CMReturnObjectPath(handle, path("C")).rc, CMPI_RC_OK);
    const CMPIUint16 number = 7;
    EXPECT_EQ(CMReturnData(handle, &number, CMPI_uint16).rc, CMPI_RC_OK);
    EXPECT_EQ(CMReturnData(handle, "text", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_FALSE(collected.isDone());
    EXPECT_EQ(CMReturnDone(handle).rc, CMPI_RC_OK);

    ASSERT_EQ(collected.instances().size(), 2U);
    EXPECT_EQ(collected.instances()[0]->className(), "A");
    EXPECT_EQ(collected.instances()[1]->className(), "B");
    ASSERT_EQ(collected.paths().size(), 1U);
    EXPECT_EQ(collected.paths()[0]->className(), "C");
    ASSERT_EQ(collected.values().size(), 2U);
    EXPECT_EQ(collected.values()[0].unsignedInteger(), 7U);
    EXPECT_EQ(collected.values()[1].text(), "text");
    EXPECT_TRUE(collected.isDone());
    EXPECT_EQ(collected.refused(), 0U);
}

TEST_F(ResultTest, ShowsWhatWasDeliveredAsItWasThen)
{
    CMPIObjectPath* const reused = path();
    for (const char* const id : {"fan1", "fan2"}) {
        CMAddKey(reused, "DeviceID", id, CMPI_chars);
        CMReturnObjectPath(handle, reused);
    }
    CMPIInstance* const changed = instance();
    CMSetProperty(changed, "A", "before", CMPI_chars);
    CMReturnInstance(handle, changed);
    CMSetProperty(changed, "A", "after", CMPI_chars);
    EXPECT_EQ(collected.paths()[0]->key("DeviceID")->text(), "fan1");
    EXPECT_EQ(collected.paths()[1]->key("DeviceID")->text(), "fan2");
    EXPECT_EQ(collected.instances()[0]->property("A")->text(), "before");
}

TEST_F(ResultTest, RefusesAndCountsNull)
{
    EXPECT_EQ(CMReturnInstance(handle, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CMReturnObjectPath(handle, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CMReturnError(handle, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(collected.refused(), 3U);
    EXPECT_TRUE(collected.instances().empty());
    EXPECT_TRUE(collected.paths().empty());
}

TEST_F(ResultTest, RefusesAndCountsObjectsWithoutAHandleOrOfAnotherKind)
{
    const CMPIInstance handleless{nullptr, &Host::Instance::functions};
    EXPECT_EQ(CMReturnInstance(handle, &handleless).rc, CMPI_RC_ERR_INVALID_HANDLE);
    const CMPIInstance misplaced{path()->hdl, &Host::Instance::functions};
    EXPECT_EQ(CMReturnInstance(handle, &misplaced).rc, CMPI_RC_ERR_INVALID_HANDLE);
    const CMPIUint16 number = 1;
    EXPECT_EQ(CMReturnData(handle, &number, CMPI_args).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(collected.refused(), 3U);
}

TEST_F(ResultTest, RefusesEverythingAfterTheEnd)
{
    CMReturnDone(handle);
    EXPECT_EQ(CMReturnInstance(handle, instance()).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMReturnObjectPath(handle, path()).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMReturnData(handle, "1", CMPI_chars).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMReturnDone(handle).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(collected.refused(), 4U);
    EXPECT_TRUE(collected.instances().empty());
}

TEST_F(ResultTest, CollectsErrors)
{
    const CMPIError* const error = CMNewCMPIError(
        mb, "owner", "MSG1", "it failed", ErrorSevHigh, Fan_Failure, CMPI_RC_ERR_FAILED, nullptr);
    EXPECT_EQ(CMReturnError(handle, error).rc, CMPI_RC_OK);
    ASSERT_EQ(collected.errors().size(), 1U);
    EXPECT_EQ(collected.errors()[0]->fields().message->text(), "it failed");
}

TEST_F(ResultTest, CannotBeClonedAndIsNotEndedByRelease)
{
    CMPIResult* const mine = result.handle();
    EXPECT_EQ(CMClone(mine, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(CMRelease(mine).rc, CMPI_RC_OK);
    EXPECT_EQ(CMReturnDone(handle).rc, CMPI_RC_OK);
}

TEST_F(ResultTest, BecomesTheAnswerOfAnUpcall)
{
    CMReturnObjectPath(handle, path("A"));
    CMReturnObjectPath(handle, path("B"));
    CMReturnInstance(handle, instance("C"));
    EXPECT_EQ(collected.pathEnumeration().size(), 2U);
    const CMPIEnumeration* const instances = collected.instanceEnumeration().handle();
    const CMPIData only = CMGetNext(instances, nullptr);
    ASSERT_EQ(only.type, CMPI_instance);
    EXPECT_EQ(Host::Instance::of(only.value.inst)->className(), "C");
    EXPECT_FALSE(CMHasNext(instances, nullptr));
}

TEST_F(ResultTest, AFailingSinkReachesTheProviderAsAStatus)
{
    struct Gone : Host::CollectedResult {
        void instance(const Host::Instance&) override { throw std::runtime_error("client gone"); }
    } gone;
    Host::Result failing(gone);
    const CMPIStatus status = CMReturnInstance(failing.handle(), instance());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(textOf(status.msg), "client gone");
}

} // namespace HostTests
