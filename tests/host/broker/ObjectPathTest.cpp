// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/ObjectPath.h"

#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/ClassTable.h"

namespace HostTests {

using ObjectPathTest = BrokerTest;

TEST_F(ObjectPathTest, HasTheNamespaceAndClassItWasMadeWith)
{
    CMPIObjectPath* const made = CMNewObjectPath(mb, "root/cimv2", "Test_Class", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetNameSpace(made, nullptr)), "root/cimv2");
    EXPECT_EQ(textOf(CMGetClassName(made, nullptr)), "Test_Class");
    EXPECT_EQ(textOf(CMGetHostname(made, nullptr)), "");
    EXPECT_EQ(CMGetKeyCount(made, nullptr), 0U);
}

TEST_F(ObjectPathTest, NeedsAClassButNoNamespace)
{
    EXPECT_EQ(CMNewObjectPath(mb, "root/cimv2", nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    CMPIObjectPath* const made = CMNewObjectPath(mb, nullptr, "Test_Class", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetNameSpace(made, nullptr)), "(null)");
    EXPECT_EQ(Host::ObjectPath::of(made)->nameSpace(), "");
}

TEST_F(ObjectPathTest, TakesOtherNames)
{
    CMPIObjectPath* const made = path();
    EXPECT_EQ(CMSetNameSpace(made, "root/interop").rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetHostname(made, "host.example").rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetClassName(made, "Other_Class").rc, CMPI_RC_OK);
    EXPECT_EQ(textOf(CMGetNameSpace(made, nullptr)), "root/interop");
    EXPECT_EQ(textOf(CMGetHostname(made, nullptr)), "host.example");
    EXPECT_EQ(textOf(CMGetClassName(made, nullptr)), "Other_Class");
    EXPECT_EQ(CMSetClassName(made, nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(textOf(CMGetClassName(made, nullptr)), "Other_Class");
}

TEST_F(ObjectPathTest, ItsClassIsItselfAndEachOfItsSuperclasses)
{
    Testing::ClassTable classes;
    classes.add("Test_Class", {}, "Test_Base");
    classes.add("Test_Base", {}, "Test_Root");
    broker.setClassInformation(&classes);
    for (const char* const name : {"Test_Class", "TEST_BASE", "test_root"})
        EXPECT_TRUE(CMClassPathIsA(mb, path(), name, &rc)) << name;
    for (const char* const name : {"Test_Other", ""})
        EXPECT_FALSE(CMClassPathIsA(mb, path(), name, &rc)) << name;
    EXPECT_FALSE(CMClassPathIsA(mb, path("Test_Base"), "Test_Class", &rc));
    EXPECT_FALSE(CMClassPathIsA(mb, path("Unknown"), "Test_Root", &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_FALSE(CMClassPathIsA(mb, path(), nullptr, &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(ObjectPathTest, WithoutClassInformationItsClassIsOnlyItself)
{
    EXPECT_TRUE(CMClassPathIsA(mb, path(), "test_class", &rc));
    EXPECT_FALSE(CMClassPathIsA(mb, path(), "Test_Base", &rc));
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(ObjectPathTest, ANameReadEarlierStaysAsItWas)
{
    CMPIObjectPath* const made = path();
    CMPIString* const before = CMGetNameSpace(made, nullptr);
    CMSetNameSpace(made, "root/interop");
    EXPECT_EQ(textOf(before), "root/cimv2");
}

TEST_F(ObjectPathTest, AHostTakenAwayReadsAsAStringWithoutCharacters)
{
    CMPIObjectPath* const made = path();
    EXPECT_EQ(CMSetHostname(made, nullptr).rc, CMPI_RC_OK);
    CMPIString* const host = CMGetHostname(made, nullptr);
    ASSERT_NE(host, nullptr);
    EXPECT_EQ(CMGetCharPtr(host), nullptr);
}

TEST_F(ObjectPathTest, KeepsKeysInTheOrderTheyWereAdded)
{
    CMPIObjectPath* const made = path();
    const CMPIUint32 number = 42;
    for (const char* const name : {"B", "A", "D", "C", "F", "E"})
        EXPECT_EQ(CMAddKey(made, name, name, CMPI_chars).rc, CMPI_RC_OK);
    CMAddKey(made, "Number", &number, CMPI_uint32);
    ASSERT_EQ(CMGetKeyCount(made, &rc), 7U);
    std::string order;
    CMPIString* name = nullptr;
    for (CMPICount i = 0; i < 6; ++i) {
        order += textOf(CMGetKeyAt(made, i, &name, nullptr));
        EXPECT_EQ(order.back(), textOf(name).front());
    }
    EXPECT_EQ(order, "BADCFE");
    const CMPIData last = CMGetKeyAt(made, 6, nullptr, nullptr);
    EXPECT_EQ(last.type, CMPI_uint32);
    EXPECT_EQ(last.value.uint32, 42U);
    EXPECT_EQ(last.state, CMPI_keyValue);
}

TEST_F(ObjectPathTest, FindsAKeyWithoutRegardToLetterCase)
{
    CMPIObjectPath* const made = path();
    CMAddKey(made, "DeviceID", "fan1", CMPI_chars);
    EXPECT_EQ(textOf(CMGetKey(made, "DEVICEid", &rc)), "fan1");
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
}

TEST_F(ObjectPathTest, AddingAKeyAgainReplacesItInItsPlace)
{
    CMPIObjectPath* const made = path();
    CMAddKey(made, "A", "1", CMPI_chars);
    CMAddKey(made, "B", "2", CMPI_chars);
    const CMPIUint16 number = 3;
    CMAddKey(made, "a", &number, CMPI_uint16);
    EXPECT_EQ(CMGetKeyCount(made, nullptr), 2U);
    CMPIString* name = nullptr;
    EXPECT_EQ(CMGetKeyAt(made, 0, &name, nullptr).value.uint16, 3);
    EXPECT_EQ(textOf(name), "A");
}

TEST_F(ObjectPathTest, AMissingKeyIsNotFound)
{
    CMPIObjectPath* const made = path();
    CMAddKey(made, "A", "1", CMPI_chars);
    const CMPIData none = CMGetKey(made, "B", &rc);
    EXPECT_EQ(none.type, CMPI_null);
    EXPECT_EQ(none.state, absentState);
    EXPECT_EQ(none.value.string, nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(textOf(rc.msg), "there is no B");
    EXPECT_EQ(CMGetKeyAt(made, 1, nullptr, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(CMGetKey(made, nullptr, &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(ObjectPathTest, RefusesKeysThatCannotBe)
{
    CMPIObjectPath* const made = path();
    CMPIArray* const numbers = array({1});
    CMPIInstance* const embedded = instance();
    EXPECT_EQ(CMAddKey(made, nullptr, "1", CMPI_chars).rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMAddKey(made, "A", &numbers, CMPI_uint16A).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(CMAddKey(made, "A", &embedded, CMPI_instance).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(CMAddKey(made, "A", &numbers, CMPI_args).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(CMGetKeyCount(made, nullptr), 0U);
}

TEST_F(ObjectPathTest, CopiesTextKeysByValue)
{
    CMPIObjectPath* const made = path();
    std::string text = "before";
    CMAddKey(made, "A", text.data(), CMPI_chars);
    text = "after!";
    EXPECT_EQ(textOf(CMGetKey(made, "A", nullptr)), "before");
    EXPECT_EQ(CMGetKey(made, "A", nullptr).type, CMPI_string);
}

TEST_F(ObjectPathTest, CopiesReferenceKeysDeep)
{
    CMPIObjectPath* const made = path();
    CMPIObjectPath* const reference = path("Referred");
    CMAddKey(reference, "Name", "before", CMPI_chars);
    CMAddKey(made, "R", &reference, CMPI_ref);
    CMAddKey(reference, "Name", "after", CMPI_chars);
    CMAddKey(reference, "More", "after", CMPI_chars);
    CMSetNameSpace(reference, "after");
    const CMPIData key = CMGetKey(made, "R", nullptr);
    ASSERT_EQ(key.type, CMPI_ref);
    EXPECT_EQ(textOf(CMGetKey(key.value.ref, "Name", nullptr)), "before");
    EXPECT_EQ(CMGetKeyCount(key.value.ref, nullptr), 1U);
    EXPECT_EQ(textOf(CMGetNameSpace(key.value.ref, nullptr)), "root/cimv2");
}

TEST_F(ObjectPathTest, ChangingAReferenceThatWasReadDoesNotChangeTheKey)
{
    CMPIObjectPath* const made = path();
    CMPIObjectPath* const reference = path("Referred");
    CMAddKey(made, "R", &reference, CMPI_ref);
    CMSetClassName(CMGetKey(made, "R", nullptr).value.ref, "Changed");
    EXPECT_EQ(textOf(CMGetClassName(CMGetKey(made, "R", nullptr).value.ref, nullptr)), "Referred");
}

TEST_F(ObjectPathTest, ShowsAKeyThatAClientLeftOutAsNullAndNotFound)
{
    Host::ObjectPath& made = request.makePath("root/cimv2", "Test_Class");
    made.addKey("SystemName", Host::Value::absent());
    const CMPIData key = CMGetKey(made.handle(), "SystemName", &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(key.type, CMPI_null);
    EXPECT_EQ(key.state & absentState, absentState);
    EXPECT_EQ(CMGetKeyCount(made.handle(), nullptr), 1U);
}

TEST_F(ObjectPathTest, IsWrittenAsAUri)
{
    CMPIObjectPath* const reference = path("Referred");
    CMAddKey(reference, "Name", "x", CMPI_chars);
    CMPIObjectPath* const made = path();
    const CMPISint32 number = -5;
    const CMPIBoolean yes = 1;
    EXPECT_EQ(Host::ObjectPath::of(made)->toText(), "root/cimv2:Test_Class");
    CMSetHostname(made, "host.example");
    CMAddKey(made, "ID", "a\"b\\c", CMPI_chars);
    CMAddKey(made, "Number", &number, CMPI_sint32);
    CMAddKey(made, "Yes", &yes, CMPI_boolean);
    CMAddKey(made, "Ref", &reference, CMPI_ref);
    EXPECT_EQ(Host::ObjectPath::of(made)->toText(),
        "//host.example/root/cimv2:Test_Class.ID=\"a\\\"b\\\\c\",Number=-5,Yes=TRUE,"
        "Ref=\"root/cimv2:Referred.Name=\\\"x\\\"\"");
}

TEST_F(ObjectPathTest, IsReadByTheHostWithoutTheTable)
{
    CMPIObjectPath* const made = path();
    CMSetHostname(made, "host.example");
    CMAddKey(made, "DeviceID", "fan1", CMPI_chars);
    const Host::ObjectPath& read = *Host::ObjectPath::of(made);
    EXPECT_EQ(read.nameSpace(), "root/cimv2");
    EXPECT_EQ(read.host(), "host.example");
    EXPECT_EQ(read.className(), "Test_Class");
    EXPECT_EQ(read.key("deviceid")->text(), "fan1");
    EXPECT_EQ(read.key("other"), nullptr);
    for (const auto& [name, value] : read.keys()) {
        EXPECT_EQ(name->text(), "DeviceID");
        EXPECT_EQ(value.text(), "fan1");
    }
}

} // namespace HostTests
