// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The base of tests that collect the sensors of a simulated controller.

#pragma once

#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "tests/support/Texts.h"
#include "tests/support/bmc/SimulatedBmc.h"
#include "tests/support/bmc/SimulatedSensor.h"
#include "tests/tools/ChildProcess.h"

#include <gmock/gmock.h>

#include <cmath>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

class CollectTest : public ::testing::Test {
protected:
    CollectTest() { bmc_.setFaults(unavailable(numberOf("NVMe Temp"))); }

    const std::string& file() const { return file_; }

    std::vector<std::string> arguments(const std::vector<std::string>& more) const
    {
        std::vector<std::string> all = {"collect", "--output", file()};
        all.insert(all.end(), more.begin(), more.end());
        return all;
    }

    // Runs the command once. Throws std::runtime_error with its message when it fails.
    Vorn::MachineFile collect(std::vector<std::string> options = {},
        const std::map<std::string, std::string>& variables = {}) const
    {
        options.emplace_back("--once");
        auto environment = bmc_.environment();
        environment.insert(variables.begin(), variables.end());
        const Ended ended = run(arguments(options), {.environment = environment});
        if (ended.code != 0 || !ended.err.empty())
            throw std::runtime_error(ended.err);
        return collected();
    }

    // Returns what the file holds now.
    Vorn::MachineFile collected() const { return Vorn::readMachineFile(contentOf(file())); }

    static int numberOf(const std::string& description) { return sensorOf(description).number; }

    static const SimulatedSensor& sensorOf(const std::string& description)
    {
        for (const SimulatedSensor& sensor : simulatedServer())
            if (sensor.description == description)
                return sensor;
        throw std::out_of_range(description);
    }

    // Returns the line that spoils each answer to Get Sensor Reading of a sensor.
    static std::string fault(int number, const std::string& action)
    {
        std::ostringstream line;
        line << "4 2d 0 " << std::hex << number << " " << action << "\n";
        return line.str();
    }
    static std::string unavailable(int number) { return fault(number, "set 2 20"); }

    SimulatedBmc bmc_{emulationOf(simulatedServer())};
    TemporaryFolder folder_;
    std::string file_ = (folder_.path() / "ipmi.json").string();
};

inline const Vorn::MachineFileNode* findNode(const Vorn::MachineFile& file, const std::string& path)
{
    for (const Vorn::MachineFileNode& node : file.nodes)
        if (node.path == path)
            return &node;
    return nullptr;
}

inline const Vorn::MachineFileNode& nodeOf(
    const Vorn::MachineFile& file, const std::string& description)
{
    for (const Vorn::MachineFileNode& node : file.nodes)
        if (node.description == description)
            return node;
    throw std::out_of_range(description);
}

// A number is published in thousandths at most, and not the one below.
inline void expectNumber(const std::optional<double>& seen, const std::optional<double>& meant)
{
    ASSERT_EQ(seen.has_value(), meant.has_value());
    if (!meant)
        return;
    EXPECT_EQ(std::trunc(static_cast<long double>(*seen) * 1000), std::round(*meant * 1000));
}

} // namespace Testing
