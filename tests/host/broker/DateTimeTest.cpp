// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/DateTime.h"

#include "tests/host/broker/BrokerTest.h"

#include <chrono>

namespace HostTests {

class DateTimeTest : public BrokerTest {
protected:
    CMPIDateTime* parse(const char* text) { return CMNewDateTimeFromChars(mb, text, &rc); }
};

TEST_F(DateTimeTest, ReadsAPointInTime)
{
    CMPIDateTime* const time = parse("20240229123456.789012+060");
    ASSERT_NE(time, nullptr);
    EXPECT_EQ(CMGetBinaryFormat(time, nullptr), 1709206496789012U);
    EXPECT_EQ(CMIsInterval(time, nullptr), 0);
    EXPECT_EQ(textOf(CMGetStringFormat(time, nullptr)), "20240229123456.789012+060");
}

TEST_F(DateTimeTest, ReadsAPointWestOfGreenwich)
{
    CMPIDateTime* const time = parse("19700101000000.000000-300");
    ASSERT_NE(time, nullptr);
    EXPECT_EQ(CMGetBinaryFormat(time, nullptr), 300ULL * 60 * 1000000);
    EXPECT_EQ(textOf(CMGetStringFormat(time, nullptr)), "19700101000000.000000-300");
}

TEST_F(DateTimeTest, ReadsAnInterval)
{
    CMPIDateTime* const time = parse("00000001020304.000005:000");
    ASSERT_NE(time, nullptr);
    EXPECT_EQ(CMGetBinaryFormat(time, nullptr), ((26U * 60 + 3) * 60 + 4) * 1000000ULL + 5);
    EXPECT_EQ(CMIsInterval(time, nullptr), 1);
    EXPECT_EQ(textOf(CMGetStringFormat(time, nullptr)), "00000001020304.000005:000");
}

TEST_F(DateTimeTest, RefusesWhatIsNoDateTime)
{
    for (const char* const text : {"", "20240229123456.789012+06", "20240229123456.789012+0600",
             "20230229123456.789012+000", "20241329123456.789012+000", "20240100123456.789012+000",
             "20240101243456.789012+000", "20240101126056.789012+000", "20240101123460.789012+000",
             "20240101123456,789012+000", "20240101123456.******+000", "2024010112345x.789012+000",
             "20240101123456.789012*000", "19691231235959.999999+000", "19700101000000.000000+001",
             "00000001020304.000005:001", "00000001250304.000005:000", "                         ",
             "\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF.\xFF\xFF\xFF\xFF\xFF\xFF:"
             "\xFF\xFF\xFF"}) {
        EXPECT_EQ(parse(text), nullptr) << text;
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER) << text;
    }
    EXPECT_EQ(parse(nullptr), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(DateTimeTest, ComesFromMicroseconds)
{
    CMPIDateTime* const point = CMNewDateTimeFromBinary(mb, 253402300799999999ULL, 0, &rc);
    ASSERT_NE(point, nullptr);
    EXPECT_EQ(textOf(CMGetStringFormat(point, nullptr)), "99991231235959.999999+000");
    CMPIDateTime* const interval = CMNewDateTimeFromBinary(mb, 8639999999999999999ULL, 1, &rc);
    ASSERT_NE(interval, nullptr);
    EXPECT_EQ(textOf(CMGetStringFormat(interval, nullptr)), "99999999235959.999999:000");
}

TEST_F(DateTimeTest, RefusesMicrosecondsBeyondItsRange)
{
    EXPECT_EQ(CMNewDateTimeFromBinary(mb, 253402300800000000ULL, 0, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMNewDateTimeFromBinary(mb, 8640000000000000000ULL, 1, &rc), nullptr);
    EXPECT_EQ(CMNewDateTimeFromBinary(mb, ~0ULL, 1, &rc), nullptr);
}

TEST_F(DateTimeTest, NowIsNow)
{
    const auto seconds = [] {
        const auto now = std::chrono::system_clock::now().time_since_epoch();
        return static_cast<CMPIUint64>(
            std::chrono::duration_cast<std::chrono::microseconds>(now).count());
    };
    const CMPIUint64 before = seconds();
    const CMPIUint64 now = CMGetBinaryFormat(CMNewDateTime(mb, nullptr), nullptr);
    EXPECT_LE(before, now);
    EXPECT_LE(now, seconds());
}

TEST_F(DateTimeTest, IsAPropertyToo)
{
    CMPIInstance* const holder = instance();
    CMPIDateTime* const time = parse("20240229123456.789012+060");
    EXPECT_EQ(CMSetProperty(holder, "T", &time, CMPI_dateTime).rc, CMPI_RC_OK);
    const CMPIData data = CMGetProperty(holder, "T", nullptr);
    ASSERT_EQ(data.type, CMPI_dateTime);
    EXPECT_EQ(CMGetBinaryFormat(data.value.dateTime, nullptr), 1709206496789012U);
}

} // namespace HostTests
