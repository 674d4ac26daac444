// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Enumeration.h"

#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

class EnumerationTest : public BrokerTest {
protected:
    // Of paths to these classes.
    CMPIEnumeration* enumeration(std::initializer_list<const char*> classes)
    {
        Host::Enumeration& made = Host::Enumeration::make(request.arena(), CMPI_ref);
        for (const char* const name : classes)
            made.add(Host::Value::of(request.makePath("root/cimv2", name)));
        return made.handle();
    }
    static std::string classOf(const CMPIData& data)
    {
        return data.type == CMPI_ref ? textOf(CMGetClassName(data.value.ref, nullptr)) : "(none)";
    }
};

TEST_F(EnumerationTest, GivesItsElementsInOrderAndThenNoMore)
{
    CMPIEnumeration* const made = enumeration({"A", "B", "C", "D", "E"});
    std::string order;
    while (CMHasNext(made, &rc))
        order += classOf(CMGetNext(made, &rc));
    EXPECT_EQ(order, "ABCDE");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetNext(made, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_NO_MORE_ELEMENTS);
}

// Elements lie in chunks of four: the fourth is where a chunk ends.
TEST_F(EnumerationTest, WhatIsAddedAtItsEndIsReadNext)
{
    for (const std::string before : {"", "A", "ABC", "ABCD", "ABCDE", "ABCDEFGH"}) {
        Host::Enumeration& grown = Host::Enumeration::make(request.arena(), CMPI_ref);
        const auto add = [&](const std::string& name) {
            grown.add(Host::Value::of(request.makePath("root/cimv2", name)));
        };
        for (const char name : before)
            add(std::string(1, name));
        std::string order;
        while (CMHasNext(grown.handle(), &rc))
            order += classOf(CMGetNext(grown.handle(), &rc));
        EXPECT_EQ(CMGetNext(grown.handle(), nullptr).state, absentState);
        add("Y");
        ASSERT_TRUE(CMHasNext(grown.handle(), &rc)) << before;
        order += classOf(CMGetNext(grown.handle(), &rc));
        EXPECT_FALSE(CMHasNext(grown.handle(), &rc));
        add("Z");
        order += classOf(CMGetNext(grown.handle(), &rc));
        EXPECT_EQ(order, before + "YZ");
        EXPECT_EQ(rc.rc, CMPI_RC_OK);
    }
}

TEST_F(EnumerationTest, CanBeEmpty)
{
    CMPIEnumeration* const made = enumeration({});
    EXPECT_FALSE(CMHasNext(made, &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetArrayCount(CMToArray(made, nullptr), nullptr), 0U);
}

TEST_F(EnumerationTest, BecomesAnArray)
{
    CMPIArray* const all = CMToArray(enumeration({"A", "B"}), &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    ASSERT_EQ(CMGetArrayCount(all, nullptr), 2U);
    EXPECT_EQ(CMGetArrayType(all, nullptr), CMPI_ref);
    EXPECT_EQ(classOf(CMGetArrayElementAt(all, 1, nullptr)), "B");
}

TEST_F(EnumerationTest, HandsOutTheObjectsThemselves)
{
    CMPIEnumeration* const made = enumeration({"A"});
    CMPIObjectPath* const first = CMGetNext(made, nullptr).value.ref;
    EXPECT_EQ(CMSetNameSpace(first, "changed").rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetNameSpace(first, nullptr)), "changed");
}

TEST_F(EnumerationTest, ACloneGoesOnWhereTheOriginalStands)
{
    CMPIEnumeration* const made = enumeration({"A", "B", "C"});
    CMGetNext(made, nullptr);
    CMPIEnumeration* const clone = CMClone(made, nullptr);
    CMGetNext(made, nullptr);
    EXPECT_EQ(classOf(CMGetNext(clone, nullptr)), "B");
    EXPECT_EQ(classOf(CMGetNext(clone, nullptr)), "C");
    EXPECT_FALSE(CMHasNext(clone, nullptr));
    CMRelease(clone);
}

} // namespace HostTests
