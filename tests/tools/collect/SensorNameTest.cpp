// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorName.h"

#include "tests/support/bmc/SimulatedSensor.h"

#include <gtest/gtest.h>

namespace SensorNameTests {

std::string decoded(const std::string& idString)
{
    return Ipmi::decodeName(std::vector<std::uint8_t>(idString.begin(), idString.end()));
}

TEST(SensorNameTest, DecodesEachType)
{
    const std::pair<std::string, std::string> names[] = {
        {Testing::eightBit("CPU1 Temp"), "CPU1 Temp"},
        {Testing::eightBit("16 characters ok"), "16 characters ok"},
        {Testing::eightBit("\xB0\x43"), "°C"},
        {Testing::eightBit("°C ①"), "°C ①"},
        {Testing::eightBit("\xB0\x91 é"), "° Ã©"}, // valid as Latin-1 only
        {Testing::sixBit("PCH TEMP 12"), "PCH TEMP 12"},
        {Testing::sixBit("A"), "A"},
        {Testing::bcdPlus("12.-1"), "12.-1"},
        {"\x42\x21\xFE", "12"}, // reserved digits are left out
        {std::string("\x04") + "Temp", "Temp"},
    };
    for (const auto& [idString, name] : names)
        EXPECT_EQ(decoded(idString), name);
}

TEST(SensorNameTest, LeavesOutUnprintableCharactersAndOuterBlanks)
{
    EXPECT_EQ(decoded(Testing::eightBit("  Fan  9\trev ")), "Fan  9rev");
    EXPECT_EQ(decoded(Testing::eightBit(std::string("Fan\0\x7F", 5))), "Fan");
    EXPECT_EQ(decoded(Testing::eightBit("A\u202EB\u2028")), "AB");
    EXPECT_EQ(decoded(Testing::eightBit("   ")), "");
}

TEST(SensorNameTest, EndsWithTheBytesThatAreThere)
{
    EXPECT_EQ(decoded(""), "");
    EXPECT_EQ(decoded("\xC0"), "");
    EXPECT_EQ(decoded("\xDF"
                      "Short"),
        "Short");
    EXPECT_EQ(decoded("\xC3"
                      "Long"),
        "Lon");
}

TEST(SensorNameTest, NamesEntities)
{
    EXPECT_EQ(Ipmi::entityName(3, 1), "Processor 1");
    EXPECT_EQ(Ipmi::entityName(10, 0x82), "Power Supply 2");
    EXPECT_EQ(Ipmi::entityName(0xD0, 0), "Entity 208 0");
}

} // namespace SensorNameTests
