// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorEnabledLogCap.h"

#include <gtest/gtest.h>

namespace {

using Vorn::SensorProfileProvider::SensorEnabledLogCap;
using States = std::vector<std::uint16_t>;

TEST(SensorEnabledLogCapTest, TheInstanceIdentifierIsTheSameAtEveryCall)
{
    SensorEnabledLogCap capabilities;
    EXPECT_EQ(capabilities.getInstanceID(), "ZUMLO:SensorEnabledLogicalElementCap1");
    EXPECT_EQ(capabilities.getInstanceID(), "ZUMLO:SensorEnabledLogicalElementCap1");
}

TEST(SensorEnabledLogCapTest, NamesCannotBeEdited)
{
    SensorEnabledLogCap capabilities;
    EXPECT_FALSE(capabilities.getElementNameEditSupported());
    EXPECT_FALSE(capabilities.getElementNameEditSupported());
}

TEST(SensorEnabledLogCapTest, TheStatesGrowWithEveryReading)
{
    SensorEnabledLogCap capabilities;
    EXPECT_EQ(capabilities.getStatesSupported(), (States{0, 1, 2}));
    EXPECT_EQ(capabilities.getStatesSupported(), (States{0, 1, 2, 0, 1, 2}));
}

TEST(SensorEnabledLogCapTest, ACopyCarriesTheStatesReadSoFarAndGrowsOnItsOwn)
{
    SensorEnabledLogCap capabilities;
    capabilities.getStatesSupported();
    SensorEnabledLogCap copy = capabilities;
    EXPECT_EQ(copy.getStatesSupported().size(), 6U);
    EXPECT_EQ(capabilities.getStatesSupported().size(), 6U);
}

} // namespace
