// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Arguments.h"

#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

using ArgumentsTest = BrokerTest;

TEST_F(ArgumentsTest, KeepsValuesByName)
{
    CMPIArgs* const args = CMNewArgs(mb, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    const CMPISint32 number = -3;
    EXPECT_EQ(CMAddArg(args, "Number", &number, CMPI_sint32).rc, CMPI_RC_OK);
    EXPECT_EQ(CMAddArg(args, "Text", "text", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetArgCount(args, nullptr), 2U);
    EXPECT_EQ(CMGetArg(args, "NUMBER", nullptr).value.sint32, -3);
    CMPIString* name = nullptr;
    EXPECT_EQ(textOf(CMGetArgAt(args, 1, &name, nullptr)), "text");
    EXPECT_EQ(textOf(name), "Text");
}

TEST_F(ArgumentsTest, AMissingArgumentIsNotFound)
{
    CMPIArgs* const args = CMNewArgs(mb, nullptr);
    EXPECT_EQ(CMGetArg(args, "A", &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(CMGetArgAt(args, 0, nullptr, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(CMAddArg(args, nullptr, "1", CMPI_chars).rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

} // namespace HostTests
