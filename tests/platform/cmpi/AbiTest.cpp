// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The CMPI headers describe a binary interface. Each offset, size and constant is compared with a
// table.

#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <type_traits>

namespace {

TEST(CmpiAbiTest, EveryMemberStandsAtItsOffset)
{
#define MEMBER(structure, member, offset, ...)                                                     \
    EXPECT_EQ(offsetof(structure, member), std::size_t{offset}) << #structure "::" #member;
#include "members.inc"
#undef MEMBER
}

// Installed header sets may differ in the constness of handles; the project's is exact.
#ifdef SENSOR_PROFILE_OWN_CMPI_HEADERS
TEST(CmpiAbiTest, EveryMemberHasItsType)
{
#define MEMBER(structure, member, offset, ...)                                                     \
    static_assert(                                                                                 \
        std::is_same_v<decltype(structure::member), __VA_ARGS__>, #structure "::" #member);
#include "members.inc"
#undef MEMBER
}
#endif

TEST(CmpiAbiTest, EveryStructureHasItsSize)
{
#define SIZE(structure, bytes) EXPECT_EQ(sizeof(structure), std::size_t{bytes}) << #structure;
#include "sizes.inc"
#undef SIZE
}

TEST(CmpiAbiTest, EveryConstantHasItsValue)
{
#define NUMBER(name, value) EXPECT_EQ(static_cast<long>(name), value##L) << #name;
#define TEXT(name, value) EXPECT_STREQ(name, value);
#include "constants.inc"
#undef NUMBER
#undef TEXT
}

TEST(CmpiAbiTest, TheWidthsOfPlainValuesAreTheirNames)
{
    EXPECT_EQ(sizeof(CMPIBoolean), 1U);
    EXPECT_EQ(sizeof(CMPIChar16), 2U);
    EXPECT_EQ(sizeof(CMPIType), 2U);
    EXPECT_EQ(sizeof(CMPIValueState), 2U);
    EXPECT_EQ(sizeof(CMPICount), 4U);
    EXPECT_EQ(sizeof(CMPIReal32), 4U);
    EXPECT_EQ(sizeof(CMPIReal64), 8U);
    EXPECT_EQ(sizeof(CMPIValue), 16U);
}

} // namespace
