// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The status of each channel of captured machines.

#include "tests/platform/instrumentation/HwmonMachine.h"

#include <gtest/gtest.h>

namespace HwmonTreesTests {

using Testing::BoundSysfs;
using Testing::HwmonTest;

using HwmonTreesTest = HwmonTest;

// Returns the statuses that are not normal, by path.
std::map<std::string, unsigned> statusesBesideNormal()
{
    std::map<std::string, unsigned> statuses;
    for (const Testing::SeenNode& node : Testing::walk())
        if (node.values.status != 1)
            statuses[node.path] = node.values.status;
    return statuses;
}

TEST_F(HwmonTreesTest, ADesktopBoardShowsItsUnconnectedInputs)
{
    const BoundSysfs sysfs("desktop");
    EXPECT_EQ(statusesBesideNormal(), (std::map<std::string, unsigned>{
                                          {"/hwmon/amdgpu-pci-0b00/fan1", 16},
                                          {"/hwmon/nct6798-isa-0290/fan5", 22},
                                          {"/hwmon/nct6798-isa-0290/in1", 21},
                                          {"/hwmon/nct6798-isa-0290/in10", 21},
                                          {"/hwmon/nct6798-isa-0290/in4", 21},
                                          {"/hwmon/nct6798-isa-0290/in5", 21},
                                          {"/hwmon/nct6798-isa-0290/in6", 21},
                                          {"/hwmon/nct6798-isa-0290/temp4", 23},
                                      }));
}

TEST_F(HwmonTreesTest, AServerShowsWhatIsHotFailedDisabledAndLost)
{
    const BoundSysfs sysfs("server");
    EXPECT_EQ(statusesBesideNormal(), (std::map<std::string, unsigned>{
                                          {"/hwmon/coretemp-isa-0001/temp1", 23},
                                          {"/hwmon/coretemp-isa-0001/temp2", 23},
                                          {"/hwmon/coretemp-isa-0001/temp3", 23},
                                          {"/hwmon/coretemp-isa-0001/temp4", 23},
                                          {"/hwmon/coretemp-isa-0001/temp5", 26},
                                          {"/hwmon/ina3221-i2c-1-40/in2", 16},
                                          {"/hwmon/jc42-i2c-0-1a/temp1", 23},
                                          {"/hwmon/mlx5-pci-8100/temp1", 13},
                                          {"/hwmon/pfe1100-i2c-7-59/fan1", 13},
                                          {"/hwmon/pfe1100-i2c-7-59/in1", 25},
                                          {"/hwmon/pfe1100-i2c-7-59/in2", 25},
                                          {"/hwmon/w83795g-i2c-0-2f/fan3", 22},
                                          {"/hwmon/w83795g-i2c-0-2f/fan4", 22},
                                          {"/hwmon/w83795g-i2c-0-2f/in5", 22},
                                          {"/hwmon/w83795g-i2c-0-2f/temp2", 13},
                                      }));
}

} // namespace HwmonTreesTests
