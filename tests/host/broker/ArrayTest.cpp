// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Array.h"

#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

class ArrayTest : public BrokerTest {
protected:
    static const Host::Value& element(const CMPIArray* array, std::size_t position)
    {
        return Host::Array::of(array)->elements()[position];
    }
    static std::size_t sizeOf(const CMPIArray* array)
    {
        return Host::Array::of(array)->elements().size();
    }
};

TEST_F(ArrayTest, StartsWithNullElementsOfItsType)
{
    CMPIArray* const made = CMNewArray(mb, 2, CMPI_uint16, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(sizeOf(made), 2U);
    EXPECT_EQ(Host::Array::of(made)->type(), CMPI_uint16);
    EXPECT_EQ(element(made, 1).type(), CMPI_uint16);
    EXPECT_TRUE(element(made, 1).isNull());
}

TEST_F(ArrayTest, GivesBackWhatWasSet)
{
    CMPIArray* const made = array({7, 65535});
    EXPECT_EQ(element(made, 0).unsignedInteger(), 7U);
    EXPECT_EQ(element(made, 1).unsignedInteger(), 65535U);
}

TEST_F(ArrayTest, CanBeEmpty)
{
    CMPIArray* const made = CMNewArray(mb, 0, CMPI_uint16, &rc);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(sizeOf(made), 0U);
}

TEST_F(ArrayTest, RefusesAnIndexOutOfRange)
{
    CMPIArray* const made = array({7});
    const CMPIUint16 number = 1;
    rc = CMSetArrayElementAt(made, 1, &number, CMPI_uint16);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(textOf(rc.msg), "element 1 of 1");
}

TEST_F(ArrayTest, RefusesAnElementOfAnotherType)
{
    CMPIArray* const made = array({7});
    const CMPIUint32 number = 1;
    EXPECT_EQ(CMSetArrayElementAt(made, 0, &number, CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetArrayElementAt(made, 0, "text", CMPI_chars).rc, CMPI_RC_ERR_TYPE_MISMATCH);
    EXPECT_EQ(CMSetArrayElementAt(made, 0, &number, CMPI_args).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
    EXPECT_EQ(element(made, 0).unsignedInteger(), 7U);
}

TEST_F(ArrayTest, IsNotMadeOfATypeThatIsNotSimple)
{
    for (const int type : {CMPI_null, CMPI_uint16A, CMPI_args, CMPI_enumeration, CMPI_filter,
             CMPI_class, CMPI_ptr, 0x7777}) {
        EXPECT_EQ(CMNewArray(mb, 1, static_cast<CMPIType>(type), &rc), nullptr) << type;
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
    }
}

TEST_F(ArrayTest, HasALimit)
{
    EXPECT_NE(CMNewArray(mb, Host::Array::maximumSize, CMPI_uint8, &rc), nullptr);
    EXPECT_EQ(CMNewArray(mb, Host::Array::maximumSize + 1, CMPI_uint8, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED);
    EXPECT_EQ(CMNewArray(mb, 0xFFFFFFFF, CMPI_string, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED);
}

TEST_F(ArrayTest, TakesTextsHoweverTheyCome)
{
    CMPIArray* const made = CMNewArray(mb, 3, CMPI_chars, nullptr);
    CMPIString* const object = string("object");
    const char* pointer = "pointer";
    EXPECT_EQ(CMSetArrayElementAt(made, 0, "chars", CMPI_chars).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(made, 1, &object, CMPI_string).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(made, 2, &pointer, CMPI_charsptr).rc, CMPI_RC_OK);
    EXPECT_EQ(Host::Array::of(made)->type(), CMPI_string);
    EXPECT_EQ(element(made, 0).text(), "chars");
    EXPECT_EQ(element(made, 1).text(), "object");
    EXPECT_EQ(element(made, 2).text(), "pointer");
}

TEST_F(ArrayTest, TakesNullForAnyElement)
{
    CMPIArray* const made = array({7, 8});
    EXPECT_EQ(CMSetArrayElementAt(made, 0, nullptr, CMPI_uint16).rc, CMPI_RC_OK);
    EXPECT_EQ(CMSetArrayElementAt(made, 1, nullptr, CMPI_null).rc, CMPI_RC_OK);
    EXPECT_TRUE(element(made, 0).isNull());
    EXPECT_EQ(element(made, 1).type(), CMPI_uint16);
}

TEST_F(ArrayTest, KeepsACopyOfAPath)
{
    CMPIArray* const made = CMNewArray(mb, 1, CMPI_ref, nullptr);
    CMPIObjectPath* const reference = path("Before");
    CMSetArrayElementAt(made, 0, &reference, CMPI_ref);
    CMSetClassName(reference, "After");
    EXPECT_EQ(element(made, 0).path()->className(), "Before");
}

} // namespace HostTests
