// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The numbers of a model file, as records publish them and as a recording has them.

#include "model/Sensor.h"
#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>

namespace MachineFilePrecisionTests {

using Vorn::MachineFileNode;
using Vorn::NodeReading;
using Vorn::readMachineFile;
using Vorn::SensorProfileProvider::Sensor;

std::string fileWith(const std::string& type, const std::string& members)
{
    return R"({ "nodes": [ {"type":")" + type + R"(","path":"/v","description":"V",)" + members +
           "} ] }";
}

std::int32_t published(const MachineFileNode& node, std::optional<double> NodeReading::*field)
{
    Sensor sensor;
    sensor.setSensorType(node.sensorType);
    sensor.setCurrentReading(*(node.values.*field));
    return sensor.getCurrentReading();
}

// Returns a number of thousandths in decimal notation.
std::string decimal(int thousandths)
{
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%.3f", thousandths / 1000.0);
    return text.data();
}

TEST(MachineFilePrecisionTest, EveryWholeNumberOfMillivoltsIsPublishedAsItIs)
{
    for (int number = -20'000; number <= 20'000; number += 7) {
        const auto node =
            readMachineFile(fileWith("voltage", R"("reading":)" + decimal(number))).nodes.at(0);
        ASSERT_EQ(published(node, &NodeReading::reading), number);
    }
}

TEST(MachineFilePrecisionTest, LimitsAreAsPreciseAsReadings)
{
    const auto node = readMachineFile(fileWith("voltage", R"("reading":12.6,"lowerFatal":12.6,
        "lowerCritical":12.6,"lowerNonCritical":12.6,"upperNonCritical":12.6,"upperCritical":12.6,
        "upperFatal":12.6)"))
                          .nodes.at(0);
    for (const auto field : {&NodeReading::reading, &NodeReading::lowerFatal,
             &NodeReading::lowerCritical, &NodeReading::lowerNonCritical,
             &NodeReading::upperNonCritical, &NodeReading::upperCritical, &NodeReading::upperFatal})
        EXPECT_EQ(published(node, field), 12'600);
}

TEST(MachineFilePrecisionTest, OtherNumbersStayAsTheyAre)
{
    EXPECT_EQ(
        readMachineFile(fileWith("temperature", R"("reading":3.3)")).nodes.at(0).values.reading,
        3.3);
    EXPECT_EQ(readMachineFile(fileWith("voltage", R"("reading":3.3,"sensorType":7)"))
                  .nodes.at(0)
                  .values.reading,
        3.3);
    const auto node = readMachineFile(fileWith("voltage", R"("reading":1.2345)")).nodes.at(0);
    EXPECT_EQ(node.values.reading, 1.2345);
    EXPECT_EQ(published(node, &NodeReading::reading), 1234);
}

TEST(MachineFilePrecisionTest, RecordingHasTheNumbersOfTheFile)
{
    for (const char* const number : {"12.6", "1.2", "-3.3", "1.2345", "0.0", "-0.0", "1e+300"}) {
        const std::string member = std::string(R"("reading":)") + number;
        const auto file = readMachineFile(fileWith("voltage", member));
        const std::string recording = Vorn::writeMachineFile(file);
        EXPECT_NE(recording.find(member + "}"), std::string::npos) << recording;
        EXPECT_EQ(readMachineFile(recording).nodes.at(0).values, file.nodes.at(0).values);
    }
}

} // namespace MachineFilePrecisionTests
