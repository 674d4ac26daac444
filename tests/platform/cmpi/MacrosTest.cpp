// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The convenience functions accept null arguments.

#include <cmpimacs.h>

#include <gtest/gtest.h>

namespace {

TEST(CmpiMacrosTest, AStatusWithCharactersHasNoMessageWithoutABroker)
{
    CMPIString other = {nullptr, nullptr};
    CMPIStatus status = {CMPI_RC_OK, &other};
    CMSetStatusWithChars(nullptr, &status, CMPI_RC_ERR_FAILED, "text");
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(status.msg, nullptr);
    CMSetStatusWithChars(nullptr, nullptr, CMPI_RC_ERR_FAILED, "text"); // no status, no crash
}

TEST(CmpiMacrosTest, AnObjectIsNullWithoutAHandle)
{
    CMPIString* none = nullptr;
    CMPIString empty = {nullptr, nullptr};
    CMPIString full = {&empty, nullptr};
    EXPECT_TRUE(CMIsNullObject(none));
    EXPECT_TRUE(CMIsNullObject(&empty));
    EXPECT_FALSE(CMIsNullObject(&full));
}

} // namespace
