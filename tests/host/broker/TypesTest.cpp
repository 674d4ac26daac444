// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the broker says about objects and classes.

#include "host/broker/ClassInformation.h"
#include "host/broker/Instance.h"
#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

using TypesTest = BrokerTest;

TEST_F(TypesTest, EveryObjectHasAType)
{
    const auto type = [this](const void* object) { return textOf(CDGetType(mb, object, &rc)); };
    EXPECT_EQ(type(string("x")), "CMPIString");
    EXPECT_EQ(type(array({1})), "CMPIArray");
    EXPECT_EQ(type(path()), "CMPIObjectPath");
    EXPECT_EQ(type(instance()), "CMPIInstance");
    EXPECT_EQ(type(CMNewArgs(mb, nullptr)), "CMPIArgs");
    EXPECT_EQ(type(CMNewDateTime(mb, nullptr)), "CMPIDateTime");
    EXPECT_EQ(type(request.context().handle()), "CMPIContext");
    EXPECT_EQ(type(mb), "CMPIBroker");
    EXPECT_TRUE(CDIsOfType(mb, path(), "CMPIObjectPath", &rc));
    EXPECT_FALSE(CDIsOfType(mb, path(), "CMPIInstance", &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(TypesTest, EveryObjectHasAText)
{
    const auto text = [this](const void* object) { return textOf(CDToString(mb, object, &rc)); };
    EXPECT_EQ(text(string("plain")), "plain");
    EXPECT_EQ(text(array({1, 2})), "{1, 2}");
    EXPECT_EQ(text(path()), "root/cimv2:Test_Class");
    CMPIInstance* const made = instance();
    CMSetProperty(made, "A", "x", CMPI_chars);
    CMSetProperty(made, "B", nullptr, CMPI_uint16);
    EXPECT_EQ(text(made), "instance of Test_Class { A = \"x\"; B = NULL; };");
    EXPECT_EQ(text(CMNewDateTimeFromBinary(mb, 0, 0, nullptr)), "19700101000000.000000+000");
    EXPECT_EQ(text(CMNewArgs(mb, nullptr)), "CMPIArgs");
}

TEST_F(TypesTest, APathIsOfItsOwnClass)
{
    EXPECT_TRUE(CMClassPathIsA(mb, path("Test_Class"), "test_CLASS", &rc));
    EXPECT_FALSE(CMClassPathIsA(mb, path("Test_Class"), "Test_Base", &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(TypesTest, APathIsOfItsAncestorsWhereTheyAreKnown)
{
    Host::ClassTable classes;
    classes.add("Test_Class", {}, "Test_Middle");
    classes.add("Test_Middle", {}, "Test_Base");
    classes.add("Test_Circle", {}, "Test_Circle2");
    classes.add("Test_Circle2", {}, "Test_Circle");
    broker.setClassInformation(&classes);
    EXPECT_TRUE(CMClassPathIsA(mb, path("test_class"), "Test_Middle", nullptr));
    EXPECT_TRUE(CMClassPathIsA(mb, path("Test_Class"), "test_base", nullptr));
    EXPECT_FALSE(CMClassPathIsA(mb, path("Test_Middle"), "Test_Class", nullptr));
    EXPECT_FALSE(CMClassPathIsA(mb, path("Test_Circle"), "Test_Base", nullptr));
    EXPECT_FALSE(CMClassPathIsA(mb, path("Unknown"), "Test_Base", nullptr));
}

} // namespace HostTests
