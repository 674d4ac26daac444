// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorIndex.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace SensorIndexTests {

using Vorn::SensorProfileProvider::Sensor;
using Vorn::SensorProfileProvider::SensorIndex;

Sensor named(const std::string& deviceID)
{
    Sensor sensor;
    sensor.setDeviceID(deviceID);
    return sensor;
}

TEST(SensorIndexTest, OfNoRecordsIsEmpty)
{
    for (const SensorIndex& index : {SensorIndex(), SensorIndex(std::vector<Sensor>())}) {
        EXPECT_EQ(index.size(), 0U);
        EXPECT_EQ(index.find(""), nullptr);
        EXPECT_TRUE(index.inOrder().empty());
    }
}

TEST(SensorIndexTest, FindsTheLastRecordOfAnIdentifier)
{
    const std::vector<Sensor> sensors = {named("b"), named("a"), named("b"), named("c")};
    const SensorIndex index(sensors);
    EXPECT_EQ(index.size(), 3U);
    EXPECT_EQ(index.find("b"), &sensors[2]);
    EXPECT_EQ(index.find("B"), nullptr);
    EXPECT_EQ(index.inOrder(), (std::vector<const Sensor*>{&sensors[1], &sensors[2], &sensors[3]}));
}

TEST(SensorIndexTest, FindsEachOfManyRecords)
{
    std::vector<Sensor> sensors;
    for (int i = 0; i < 1000; ++i)
        sensors.push_back(named(std::to_string(i)));
    const SensorIndex index(sensors);
    for (const Sensor& sensor : sensors)
        EXPECT_EQ(index.find(sensor.deviceID()), &sensor);
    EXPECT_EQ(index.find("1000"), nullptr);
}

} // namespace SensorIndexTests
