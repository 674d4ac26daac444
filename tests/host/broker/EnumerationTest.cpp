// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Enumeration.h"

#include "tests/host/broker/BrokerTest.h"

#include <vector>

namespace HostTests {

class EnumerationTest : public BrokerTest {
protected:
    // Returns an enumeration of paths of these classes.
    CMPIEnumeration* enumeration(std::initializer_list<const char*> classes)
    {
        std::vector<Host::Value> paths;
        for (const char* const name : classes)
            paths.push_back(Host::Value::of(request.makePath("root/cimv2", name)));
        return Host::Enumeration::make(request.arena(), paths).handle();
    }
};

TEST_F(EnumerationTest, ReturnsItsElementsInOrderAndThenNoMore)
{
    CMPIEnumeration* const made = enumeration({"A", "B", "C", "D", "E"});
    std::string order;
    while (CMHasNext(made, &rc))
        order += textOf(CMGetClassName(CMGetNext(made, &rc).value.ref, nullptr));
    EXPECT_EQ(order, "ABCDE");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(CMGetNext(made, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_NO_MORE_ELEMENTS);
}

TEST_F(EnumerationTest, CanBeEmpty)
{
    EXPECT_FALSE(CMHasNext(enumeration({}), &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(EnumerationTest, ReturnsTheObjectsThemselves)
{
    CMPIObjectPath* const first = CMGetNext(enumeration({"A"}), nullptr).value.ref;
    EXPECT_EQ(CMSetNameSpace(first, "changed").rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetNameSpace(first, nullptr)), "changed");
}

} // namespace HostTests
