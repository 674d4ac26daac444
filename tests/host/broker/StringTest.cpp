// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/String.h"

#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

using StringTest = BrokerTest;

TEST_F(StringTest, KeepsItsOwnCopyOfTheText)
{
    std::string text = "Fan 1 \xC2\xB0";
    CMPIString* const made = CMNewString(mb, text.c_str(), &rc);
    text = "something else";
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(made), "Fan 1 \xC2\xB0");
}

TEST_F(StringTest, IsNotMadeOfNull)
{
    EXPECT_EQ(CMNewString(mb, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMNewString(mb, nullptr, nullptr), nullptr);
}

TEST_F(StringTest, CanBeEmpty)
{
    EXPECT_EQ(textOf(string("")), "");
}

TEST_F(StringTest, WithoutTextHasANullCharacterPointerAndStatusOk)
{
    CMPIString* const none = Host::String::makeWithoutText(request.arena()).handle();
    EXPECT_EQ(none->ft->getCharPtr(none, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(Host::String::of(none)->text(), std::nullopt);
}

TEST_F(StringTest, IsReadByTheHostWithoutTheTable)
{
    EXPECT_EQ(Host::String::of(string("text"))->text(), "text");
}

TEST_F(StringTest, ACopyOfTheHandleIsTheSameString)
{
    const CMPIString copy = *string("text");
    EXPECT_EQ(textOf(&copy), "text");
}

} // namespace HostTests
