// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Context.h"

#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

using ContextTest = BrokerTest;

TEST_F(ContextTest, SaysWhatTheRequestIsAbout)
{
    Host::Request inner(broker, {.flags = CMPI_FLAG_DeepInheritance | CMPI_FLAG_IncludeClassOrigin,
                                    .nameSpace = "root/cimv2",
                                    .principal = "operator",
                                    .role = "admin",
                                    .acceptLanguage = "de",
                                    .contentLanguage = "fr"});
    const CMPIContext* const context = inner.context().handle();
    const CMPIData flags = CMGetContextEntry(context, CMPIInvocationFlags, &rc);
    EXPECT_EQ(flags.type, CMPI_uint32);
    EXPECT_EQ(flags.value.uint32, 10U);
    EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIInitNameSpace, nullptr)), "root/cimv2");
    EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIPrincipal, nullptr)), "operator");
    EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIRole, nullptr)), "admin");
    EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIAcceptLanguage, nullptr)), "de");
    EXPECT_EQ(textOf(CMGetContextEntry(context, CMPIContentLanguage, nullptr)), "fr");
    EXPECT_EQ(CMGetContextEntryCount(context, nullptr), 6U);
}

TEST_F(ContextTest, LeavesOutWhatIsNotKnown)
{
    const CMPIContext* const context = request.context().handle();
    EXPECT_EQ(CMGetContextEntryCount(context, nullptr), 1U);
    EXPECT_EQ(CMGetContextEntry(context, CMPIPrincipal, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(ContextTest, TakesEntriesOfTheProvider)
{
    const CMPIContext* const context = request.context().handle();
    EXPECT_EQ(CMAddContextEntry(context, "Mine", "text", CMPI_chars).rc, CMPI_RC_OK);
    CMPIString* name = nullptr;
    EXPECT_EQ(textOf(CMGetContextEntryAt(context, 1, &name, nullptr)), "text");
    EXPECT_EQ(textOf(name), "Mine");
    EXPECT_EQ(
        CMAddContextEntry(context, nullptr, "text", CMPI_chars).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMGetContextEntryAt(context, 2, nullptr, &rc).state, absentState);
}

} // namespace HostTests
