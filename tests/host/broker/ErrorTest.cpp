// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Error.h"

#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

class ErrorTest : public BrokerTest {
protected:
    CMPIError* error = CMNewCMPIError(
        mb, "owner", "MSG1", "it failed", ErrorSevHigh, Fan_Failure, CMPI_RC_ERR_FAILED, nullptr);
    const CMPIErrorFT& ft = *error->ft;
};

TEST_F(ErrorTest, SaysWhatItWasMadeWith)
{
    EXPECT_EQ(textOf(ft.getOwningEntity(error, &rc)), "owner");
    EXPECT_EQ(textOf(ft.getMessageID(error, nullptr)), "MSG1");
    EXPECT_EQ(textOf(ft.getMessage(error, nullptr)), "it failed");
    EXPECT_EQ(ft.getPerceivedSeverity(error, nullptr), ErrorSevHigh);
    EXPECT_EQ(ft.getProbableCause(error, nullptr), Fan_Failure);
    EXPECT_EQ(ft.getCIMStatusCode(error, nullptr), CMPI_RC_ERR_FAILED);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(ErrorTest, WhatWasNotGivenIsNull)
{
    EXPECT_EQ(ft.getErrorType(error, nullptr), UnknownErrorType);
    EXPECT_EQ(ft.getOtherErrorType(error, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(ft.getRecommendedActions(error, nullptr), nullptr);
    EXPECT_EQ(ft.getErrorSource(error, nullptr), nullptr);
    EXPECT_EQ(ft.getErrorSourceFormat(error, nullptr), CMPIErrSrcUnknown);
    CMPIError* const bare = CMNewCMPIError(
        mb, nullptr, nullptr, nullptr, ErrorSevUnknown, ErrorProbCauseUnknown, CMPI_RC_OK, &rc);
    ASSERT_NE(bare, nullptr);
    EXPECT_EQ(ft.getMessage(bare, nullptr), nullptr);
}

TEST_F(ErrorTest, TakesTheRest)
{
    CMPIArray* const actions = array({1, 2});
    CMPIArray* const arguments = array({3});
    EXPECT_EQ(ft.setErrorType(error, HardwareError).rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setOtherErrorType(error, "other type").rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setProbableCauseDescription(error, "cause").rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setRecommendedActions(error, actions).rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setErrorSource(error, "source").rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setErrorSourceFormat(error, CIMObjectHandle).rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setOtherErrorSourceFormat(error, "other format").rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setCIMStatusCodeDescription(error, "code").rc, CMPI_RC_OK);
    EXPECT_EQ(ft.setMessageArguments(error, arguments).rc, CMPI_RC_OK);

    EXPECT_EQ(ft.getErrorType(error, nullptr), HardwareError);
    EXPECT_EQ(textOf(ft.getOtherErrorType(error, nullptr)), "other type");
    EXPECT_EQ(textOf(ft.getProbableCauseDescription(error, nullptr)), "cause");
    EXPECT_EQ(CMGetArrayCount(ft.getRecommendedActions(error, nullptr), nullptr), 2U);
    EXPECT_EQ(textOf(ft.getErrorSource(error, nullptr)), "source");
    EXPECT_EQ(ft.getErrorSourceFormat(error, nullptr), CIMObjectHandle);
    EXPECT_EQ(textOf(ft.getOtherErrorSourceFormat(error, nullptr)), "other format");
    EXPECT_EQ(textOf(ft.getCIMStatusCodeDescription(error, nullptr)), "code");
    EXPECT_EQ(CMGetArrayCount(ft.getMessageArguments(error, nullptr), nullptr), 1U);
}

TEST_F(ErrorTest, KeepsItsOwnCopyOfArrays)
{
    CMPIArray* const actions = array({1});
    ft.setRecommendedActions(error, actions);
    const CMPIUint16 changed = 9;
    CMSetArrayElementAt(actions, 0, &changed, CMPI_uint16);
    CMPIArray* const kept = ft.getRecommendedActions(error, nullptr);
    EXPECT_EQ(CMGetArrayElementAt(kept, 0, nullptr).value.uint16, 1);
    EXPECT_EQ(ft.setRecommendedActions(error, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(ft.getRecommendedActions(error, nullptr), nullptr);
}

TEST_F(ErrorTest, IsReadByTheHostWithoutTheTable)
{
    const Host::Error::Fields& fields = Host::Error::of(error)->fields();
    EXPECT_EQ(fields.message->text(), "it failed");
    EXPECT_EQ(fields.probableCause, Fan_Failure);
}

} // namespace HostTests
