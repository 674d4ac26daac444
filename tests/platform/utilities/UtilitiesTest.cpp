// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include <gtest/gtest.h>

#include <fstream>

namespace {

using Vorn::stripSpaces;

TEST(SystemNameTest, IsTheKernelsHostName)
{
    std::ifstream kernel("/proc/sys/kernel/hostname");
    std::string name;
    ASSERT_TRUE(std::getline(kernel, name));
    EXPECT_EQ(Vorn::getSystemName(), name);
    EXPECT_NE(name, "");
}

TEST(StripSpacesTest, TakesBlanksFromBothEnds)
{
    EXPECT_EQ(stripSpaces("  CPU 1 Temp "), "CPU 1 Temp");
    EXPECT_EQ(stripSpaces("\t CPU\t"), "CPU");
}

TEST(StripSpacesTest, LeavesBlanksWithinAndOtherCharacters)
{
    EXPECT_EQ(stripSpaces("a  b\tc"), "a  b\tc");
    EXPECT_EQ(stripSpaces("\na\n"), "\na\n");
    EXPECT_EQ(stripSpaces("plain"), "plain");
}

TEST(StripSpacesTest, NothingIsLeftOfBlanks)
{
    EXPECT_EQ(stripSpaces(""), "");
    EXPECT_EQ(stripSpaces(" "), "");
    EXPECT_EQ(stripSpaces(" \t  "), "");
}

} // namespace
