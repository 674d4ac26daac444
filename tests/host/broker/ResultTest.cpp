// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Result.h"

#include "host/broker/Instance.h"
#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"

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
    EXPECT_FALSE(collected.isDone());
    EXPECT_EQ(CMReturnDone(handle).rc, CMPI_RC_OK);

    ASSERT_EQ(collected.instances().size(), 2U);
    EXPECT_EQ(collected.instances()[0]->className(), "A");
    EXPECT_EQ(collected.instances()[1]->className(), "B");
    ASSERT_EQ(collected.paths().size(), 1U);
    EXPECT_EQ(collected.paths()[0]->className(), "C");
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
    EXPECT_EQ(collected.refused(), 2U);
    EXPECT_TRUE(collected.instances().empty());
    EXPECT_TRUE(collected.paths().empty());
}

TEST_F(ResultTest, RefusesAndCountsObjectsWithoutAHandleOrOfAnotherKind)
{
    const CMPIInstance handleless{nullptr, &Host::Instance::functions};
    EXPECT_EQ(CMReturnInstance(handle, &handleless).rc, CMPI_RC_ERR_INVALID_HANDLE);
    const CMPIInstance misplaced{path()->hdl, &Host::Instance::functions};
    EXPECT_EQ(CMReturnInstance(handle, &misplaced).rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(collected.refused(), 2U);
}

TEST_F(ResultTest, RefusesEverythingAfterTheEnd)
{
    CMReturnDone(handle);
    EXPECT_EQ(CMReturnInstance(handle, instance()).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMReturnObjectPath(handle, path()).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(CMReturnDone(handle).rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(collected.refused(), 3U);
    EXPECT_TRUE(collected.instances().empty());
}

} // namespace HostTests
