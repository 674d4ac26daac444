// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/DateTime.h"

#include "host/broker/Refusal.h"
#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

using DateTimeTest = BrokerTest;

TEST_F(DateTimeTest, ReadsPointsAndIntervals)
{
    for (const char* const text : {"20240229123456.789012+060", "19700101000000.000000-300",
             "00000001020304.000005:000", "99999999235959.999999:000"}) {
        const Host::DateTime& read = Host::DateTime::parse(request.arena(), text);
        EXPECT_EQ(read.toText(), text);
        EXPECT_EQ(textOf(CMGetStringFormat(read.handle(), &rc)), text);
    }
}

TEST_F(DateTimeTest, RefusesWhatIsNoDateTime)
{
    for (const char* const text :
        {"", "20240229123456.789012+06", "20240229123456.789012+0600", "20230229123456.789012+000",
            "20241329123456.789012+000", "20240100123456.789012+000", "20240101243456.789012+000",
            "20240101126056.789012+000", "20240101123460.789012+000", "20240101123456,789012+000",
            "20240101123456.******+000", "2024010112345x.789012+000", "20240101123456.789012*000",
            "00000001020304.000005:001", "00000001250304.000005:000", "                         ",
            "\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF.\xFF\xFF\xFF\xFF\xFF\xFF:"
            "\xFF\xFF\xFF"})
        EXPECT_THROW(Host::DateTime::parse(request.arena(), text), Host::Refusal) << text;
}

} // namespace HostTests
