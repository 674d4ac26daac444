// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Value.h"

#include "host/broker/Array.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"
#include "tests/host/broker/BrokerTest.h"

#include <cstring>
#include <limits>

namespace HostTests {

using Host::Value;

class ValueTest : public BrokerTest {
protected:
    // Returns the value that the host reads from a property that a provider has set.
    template <typename T>
    Value through(const T& value, CMPIType type)
    {
        CMPIInstance* const holder = instance();
        rc = CMSetProperty(holder, "P", &value, type);
        const Value* const stored = Host::Instance::of(holder)->property("P");
        return stored == nullptr ? Value::absent() : *stored;
    }
};

TEST_F(ValueTest, KeepsEveryUnsignedIntegerType)
{
    EXPECT_EQ(through(CMPIUint8{255}, CMPI_uint8).unsignedInteger(), 255U);
    EXPECT_EQ(through(CMPIUint16{65535}, CMPI_uint16).unsignedInteger(), 65535U);
    EXPECT_EQ(through(CMPIUint32{4294967295U}, CMPI_uint32).unsignedInteger(), 4294967295U);
    EXPECT_EQ(through(std::numeric_limits<CMPIUint64>::max(), CMPI_uint64).unsignedInteger(),
        std::numeric_limits<CMPIUint64>::max());
    EXPECT_EQ(through(CMPIChar16{0x20AC}, CMPI_char16).unsignedInteger(), 0x20ACU);
}

TEST_F(ValueTest, KeepsEverySignedIntegerType)
{
    EXPECT_EQ(through(CMPISint8{-128}, CMPI_sint8).signedInteger(), -128);
    EXPECT_EQ(through(CMPISint16{-32768}, CMPI_sint16).signedInteger(), -32768);
    EXPECT_EQ(through(CMPISint32{-7}, CMPI_sint32).signedInteger(), -7);
    EXPECT_EQ(through(std::numeric_limits<CMPISint64>::min(), CMPI_sint64).signedInteger(),
        std::numeric_limits<CMPISint64>::min());
}

TEST_F(ValueTest, KeepsRealsAndBooleans)
{
    EXPECT_EQ(through(CMPIReal32{1.5F}, CMPI_real32).real(), 1.5);
    EXPECT_EQ(through(CMPIReal64{0.1}, CMPI_real64).real(), 0.1);
    EXPECT_EQ(through(CMPIBoolean{0}, CMPI_boolean).boolean(), false);
    EXPECT_EQ(through(CMPIBoolean{1}, CMPI_boolean).boolean(), true);
}

TEST_F(ValueTest, ABooleanIsZeroOrOne)
{
    EXPECT_EQ(through(CMPIBoolean{7}, CMPI_boolean).data().value.boolean, 1);
}

TEST_F(ValueTest, ReadsAsNothingThroughAnotherType)
{
    const Value number = through(CMPIUint16{5}, CMPI_uint16);
    EXPECT_EQ(number.signedInteger(), std::nullopt);
    EXPECT_EQ(number.real(), std::nullopt);
    EXPECT_EQ(number.boolean(), std::nullopt);
    EXPECT_EQ(number.text(), std::nullopt);
    EXPECT_EQ(number.string(), nullptr);
    EXPECT_EQ(number.path(), nullptr);
    EXPECT_EQ(number.instance(), nullptr);
    EXPECT_EQ(number.array(), nullptr);
    EXPECT_EQ(number.dateTime(), nullptr);
    EXPECT_EQ(Value::text(request.arena(), "5").unsignedInteger(), std::nullopt);
}

TEST_F(ValueTest, NullReadsAsNothing)
{
    for (const int type : {CMPI_uint16, CMPI_sint16, CMPI_real64, CMPI_boolean, CMPI_string,
             CMPI_ref, CMPI_instance, CMPI_dateTime, CMPI_uint16A}) {
        const Value null = Value::null(static_cast<CMPIType>(type));
        EXPECT_TRUE(null.isNull());
        EXPECT_EQ(null.unsignedInteger(), std::nullopt);
        EXPECT_EQ(null.signedInteger(), std::nullopt);
        EXPECT_EQ(null.real(), std::nullopt);
        EXPECT_EQ(null.boolean(), std::nullopt);
        EXPECT_EQ(null.text(), std::nullopt);
        EXPECT_EQ(null.path(), nullptr);
        EXPECT_EQ(null.array(), nullptr);
        EXPECT_EQ(Host::toText(null), "NULL");
    }
}

TEST_F(ValueTest, ANullObjectPointerIsANullValue)
{
    EXPECT_TRUE(through(static_cast<CMPIString*>(nullptr), CMPI_string).isNull());
    EXPECT_TRUE(through(static_cast<CMPIObjectPath*>(nullptr), CMPI_ref).isNull());
    EXPECT_TRUE(through(static_cast<CMPIInstance*>(nullptr), CMPI_instance).isNull());
    EXPECT_TRUE(through(static_cast<CMPIDateTime*>(nullptr), CMPI_dateTime).isNull());
    const Value array = through(static_cast<CMPIArray*>(nullptr), CMPI_uint16A);
    EXPECT_TRUE(array.isNull());
    EXPECT_EQ(array.type(), CMPI_uint16A);
    const Value pointer = through(static_cast<char*>(nullptr), CMPI_charsptr);
    EXPECT_TRUE(pointer.isNull());
    EXPECT_EQ(pointer.type(), CMPI_string);
}

TEST_F(ValueTest, AHandlelessObjectIsRefused)
{
    const CMPIString string{nullptr, &Host::String::functions};
    EXPECT_EQ(through(&string, CMPI_string).state(), absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    const CMPIObjectPath path{nullptr, &Host::ObjectPath::functions};
    through(&path, CMPI_ref);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    const CMPIArray array{nullptr, &Host::Array::functions};
    through(&array, CMPI_uint16A);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(ValueTest, AnObjectOfAnotherKindIsRefused)
{
    CMPIObjectPath* const aPath = path();
    through(aPath, CMPI_string);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(textOf(rc.msg), "no CMPIString behind the handle");
}

TEST_F(ValueTest, AnArrayOfAnotherTypeIsRefused)
{
    through(array({1}), CMPI_uint32A);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_TYPE_MISMATCH);
}

TEST_F(ValueTest, UnknownTypesAreRefused)
{
    const CMPIUint64 value = 0;
    for (const int type : {CMPI_args, CMPI_class, CMPI_filter, CMPI_enumeration, CMPI_ptr, 0x0001,
             0x0042, 0x1B00, 0x7FFF, 0xFFFF, CMPI_ARRAY, CMPI_ENC | CMPI_string | 0x4000}) {
        const Value stored = through(value, static_cast<CMPIType>(type));
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
        EXPECT_EQ(stored.state(), absentState) << type;
    }
}

TEST_F(ValueTest, TakesAValueThatIsNotAligned)
{
    alignas(8) char bytes[16] = {};
    const CMPISint64 number = -5;
    std::memcpy(bytes + 1, &number, sizeof number);
    CMPIInstance* const holder = instance();
    CMSetProperty(holder, "P", bytes + 1, CMPI_sint64);
    EXPECT_EQ(Host::Instance::of(holder)->property("P")->signedInteger(), -5);
}

TEST_F(ValueTest, TheHostMakesIntegersOfEveryWidth)
{
    EXPECT_EQ(Value::integer(CMPI_uint8, 0x1FF).unsignedInteger(), 0xFFU);
    EXPECT_EQ(Value::integer(CMPI_uint16, 0x1FFFF).unsignedInteger(), 0xFFFFU);
    EXPECT_EQ(Value::integer(CMPI_uint32, 0x1FFFFFFFFU).unsignedInteger(), 0xFFFFFFFFU);
    EXPECT_EQ(Value::integer(CMPI_sint64, static_cast<std::uint64_t>(-1)).signedInteger(), -1);
    EXPECT_EQ(Value::integer(CMPI_sint16, static_cast<std::uint64_t>(-2)).signedInteger(), -2);
    EXPECT_EQ(Value::real(CMPI_real32, 2.5).real(), 2.5);
    EXPECT_EQ(Value::real(CMPI_real64, 0.1).real(), 0.1);
}

TEST_F(ValueTest, IsWrittenAsPeopleReadIt)
{
    EXPECT_EQ(Host::toText(Value::integer(CMPI_uint16, 7)), "7");
    EXPECT_EQ(Host::toText(Value::integer(CMPI_sint32, static_cast<std::uint64_t>(-7))), "-7");
    EXPECT_EQ(Host::toText(Value::boolean(true)), "TRUE");
    EXPECT_EQ(Host::toText(Value::boolean(false)), "FALSE");
    EXPECT_EQ(Host::toText(Value::real(CMPI_real64, 0.1)), "0.1");
    EXPECT_EQ(Host::toText(Value::real(CMPI_real32, 0.1)), "0.1");
    EXPECT_EQ(Host::toText(Value::text(request.arena(), "a\"b\\c")), "\"a\\\"b\\\\c\"");
    EXPECT_EQ(Host::toText(Value::of(*Host::Array::of(array({1, 2})))), "{1, 2}");
    const char* const interval = "00000000000000.000000:000";
    EXPECT_EQ(Host::toText(Value::of(Host::DateTime::parse(request.arena(), interval))),
        "\"00000000000000.000000:000\"");
}

} // namespace HostTests
