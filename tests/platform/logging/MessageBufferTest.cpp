// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/RynMessageBuffer.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <locale>

namespace MessageBufferTests {

using RynLog::RynMessageBuffer;

template <typename Value>
std::string buffered(const Value& value)
{
    RynMessageBuffer buffer;
    buffer << value;
    return buffer.str();
}

template <typename Value>
std::string streamed(const Value& value)
{
    std::ostringstream stream;
    stream.imbue(std::locale::classic());
    stream << value;
    return stream.str();
}

struct Opaque;
enum Plain { PlainValue = 7 };

TEST(MessageBufferTest, StrYieldsOnlyTheTextSinceThePreviousStr)
{
    RynMessageBuffer buffer;
    buffer << "one";
    EXPECT_EQ(buffer.str(), "one");
    EXPECT_EQ(buffer.str(), "");
    buffer << "two";
    EXPECT_EQ(buffer.str(), "two");
}

TEST(MessageBufferTest, ComposesAParameterList)
{
    const void* const ref = nullptr;
    RynMessageBuffer buffer;
    buffer << " ref=" << ref << " isObjPath=" << true << " rc=" << 5;
    EXPECT_EQ(buffer.str(), " ref=0 isObjPath=1 rc=5");
}

TEST(MessageBufferTest, PrintsPointersAsTheStreamDoes)
{
    int number = 0;
    const char* texts[] = {"a", nullptr};
    EXPECT_EQ(buffered(&number), streamed(static_cast<const void*>(&number)));
    EXPECT_EQ(buffered(&number).substr(0, 2), "0x");
    EXPECT_EQ(buffered(static_cast<const char**>(texts)), streamed(static_cast<void*>(texts)));
    EXPECT_EQ(buffered(reinterpret_cast<const Opaque*>(&number)),
        streamed(static_cast<const void*>(&number)));
    EXPECT_EQ(buffered(static_cast<int*>(nullptr)), streamed(static_cast<void*>(nullptr)));
    EXPECT_EQ(buffered(static_cast<int*>(nullptr)), "0");
}

TEST(MessageBufferTest, PrintsABrokerAsItsAddress)
{
    int place = 0;
    const auto* const broker = reinterpret_cast<const _CMPIBroker*>(&place);
    EXPECT_EQ(buffered(broker), streamed(static_cast<const void*>(&place)));
}

TEST(MessageBufferTest, PrintsNumbersAsTheStreamDoes)
{
    const auto same = [](auto value) { EXPECT_EQ(buffered(value), streamed(value)); };
    same(std::numeric_limits<std::int64_t>::min());
    same(std::numeric_limits<std::uint64_t>::max());
    same(std::numeric_limits<long long>::min());
    same(short{-5});
    same(std::uint16_t{65535});
    same(1234567);
    same(41.5);
    same(1e300);
    same(0.1F);
    same(PlainValue);
}

TEST(MessageBufferTest, PrintsCharactersAndBooleansAsTheStreamDoes)
{
    EXPECT_EQ(buffered(true), "1");
    EXPECT_EQ(buffered(false), "0");
    EXPECT_EQ(buffered('x'), "x");
    EXPECT_EQ(buffered(static_cast<unsigned char>('x')), "x");
    EXPECT_EQ(buffered(reinterpret_cast<const unsigned char*>("text")), "text");
}

TEST(MessageBufferTest, PrintsTexts)
{
    char array[16] = "array";
    EXPECT_EQ(buffered("literal"), "literal");
    EXPECT_EQ(buffered(array), "array");
    EXPECT_EQ(buffered(static_cast<char*>(array)), "array");
    EXPECT_EQ(buffered(std::string("with\0zero", 9)), std::string("with\0zero", 9));
    EXPECT_EQ(buffered(std::string_view("view")), "view");
}

TEST(MessageBufferTest, PrintsANullTextAsNull)
{
    EXPECT_EQ(buffered(static_cast<const char*>(nullptr)), "(null)");
    EXPECT_EQ(buffered(static_cast<char*>(nullptr)), "(null)");
}

// Groups digits as some languages do.
class Grouping : public std::numpunct<char> {
protected:
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
    char do_decimal_point() const override { return ','; }
};

TEST(MessageBufferTest, TheGlobalLocaleChangesNothing)
{
    const std::locale before =
        std::locale::global(std::locale(std::locale::classic(), new Grouping));
    const std::string number = buffered(1234567);
    const std::string fraction = buffered(1234.5);
    std::locale::global(before);
    EXPECT_EQ(number, "1234567");
    EXPECT_EQ(fraction, "1234.5");
}

} // namespace MessageBufferTests
