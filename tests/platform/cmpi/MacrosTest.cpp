// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The stub macros make complete function tables, and the convenience functions survive what is
// missing.

#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

#include <gtest/gtest.h>

namespace {

const CMPIBroker* theBroker = nullptr;
int hookCalls = 0;

CMPIStatus code(CMPIrc rc)
{
    return {rc, nullptr};
}

CMPIStatus LampCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean)
{
    return code(CMPI_RC_OK);
}

CMPIStatus LampEnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)
{
    return code(CMPI_RC_ERR_ACCESS_DENIED);
}

CMPIStatus LampEnumInstances(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char**)
{
    return code(CMPI_RC_ERR_INVALID_NAMESPACE);
}

CMPIStatus LampGetInstance(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char**)
{
    return code(CMPI_RC_ERR_INVALID_PARAMETER);
}

CMPIStatus LampCreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*)
{
    return code(CMPI_RC_ERR_INVALID_CLASS);
}

CMPIStatus LampModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*, const char**)
{
    return code(CMPI_RC_ERR_NOT_FOUND);
}

CMPIStatus LampDeleteInstance(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)
{
    return code(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIStatus LampExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const char*, const char*)
{
    return code(CMPI_RC_ERR_INVALID_QUERY);
}

CMInstanceMIStub(Lamp, LampProvider, theBroker, ++hookCalls)

    TEST(CmpiStubTest, TheInstanceFactoryFillsEverySlotInOrder)
{
    const CMPIBroker broker = {};
    CMPIStatus status = {CMPI_RC_ERR_FAILED, nullptr};
    CMPIInstanceMI* mi = LampProvider_Create_InstanceMI(&broker, nullptr, &status);
    ASSERT_NE(mi, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    EXPECT_EQ(theBroker, &broker);
    EXPECT_EQ(hookCalls, 1);
    EXPECT_EQ(mi->ft->ftVersion, CMPICurrentVersion);
    EXPECT_STREQ(mi->ft->miName, "instanceLampProvider");
    EXPECT_EQ(mi->ft->cleanup(mi, nullptr, 1).rc, CMPI_RC_OK);
    EXPECT_EQ(mi->ft->enumerateInstanceNames(mi, nullptr, nullptr, nullptr).rc, 2U);
    EXPECT_EQ(mi->ft->enumerateInstances(mi, nullptr, nullptr, nullptr, nullptr).rc, 3U);
    EXPECT_EQ(mi->ft->getInstance(mi, nullptr, nullptr, nullptr, nullptr).rc, 4U);
    EXPECT_EQ(mi->ft->createInstance(mi, nullptr, nullptr, nullptr, nullptr).rc, 5U);
    EXPECT_EQ(mi->ft->modifyInstance(mi, nullptr, nullptr, nullptr, nullptr, nullptr).rc, 6U);
    EXPECT_EQ(mi->ft->deleteInstance(mi, nullptr, nullptr, nullptr).rc, 7U);
    EXPECT_EQ(mi->ft->execQuery(mi, nullptr, nullptr, nullptr, nullptr, nullptr).rc, 15U);
}

TEST(CmpiMacrosTest, AStatusWithCharactersHasNoMessageWithoutABroker)
{
    CMPIString* const other = reinterpret_cast<CMPIString*>(&hookCalls);
    CMPIStatus status = {CMPI_RC_OK, other};
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
