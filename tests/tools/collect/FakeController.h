// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The base of tests of the collector with a controller that does what ipmi_sim does not.

#pragma once

#include "tests/support/ErrorOf.h"
#include "tests/support/bmc/SimulatedSensor.h"
#include "tools/collect/Collector.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

namespace Testing {

using Ipmi::AddressedCommand;
using Ipmi::Bytes;
using Ipmi::Collector;
using Ipmi::CommandCode;
using std::chrono::milliseconds;

inline constexpr std::chrono::seconds allThresholds{
    300}; // the interval of passes that read them all

// Answers as a controller with these records, whose sensors all read 100.
class FakeController : public Ipmi::Transport {
public:
    explicit FakeController(const std::vector<SimulatedSensor>& sensors)
    {
        for (const SimulatedSensor& sensor : sensors)
            records.push_back(recordOf(sensor));
    }

    Bytes send(const AddressedCommand& command, milliseconds timeout) override
    {
        commands.push_back(command.code);
        if (override)
            if (const auto overridden = override(command, timeout))
                return *overridden;
        return answer(command);
    }

    Bytes answer(const AddressedCommand& command)
    {
        switch (command.code) {
        case CommandCode::getDeviceId:
            return Bytes{0};
        case CommandCode::getSdrRepositoryInfo:
            return Bytes{0, 0x51, static_cast<std::uint8_t>(records.size()), 0, ++freeSpace, 0, 0,
                0, 0, 0, 0, 0, 0, 0, 0};
        case CommandCode::reserveSdrRepository:
            return Bytes{0, ++reservation, 0};
        case CommandCode::getSdr:
            return recordPart(command.data);
        case CommandCode::getSensorReading:
            return Bytes{0, 100, 0x40, 0xC0};
        case CommandCode::getSensorThresholds:
            return Bytes{0, 0x3F, 1, 2, 3, 4, 5, 6};
        default:
            return Bytes{0xC1};
        }
    }

    std::size_t count(CommandCode code) const
    {
        return static_cast<std::size_t>(std::count(commands.begin(), commands.end(), code));
    }

    std::vector<std::string> records;
    std::uint8_t reservation = 0;
    std::uint8_t freeSpace = 0; // is no reason to read the records again
    std::size_t bytesAtOnce = 255;
    std::uint8_t codeOfTooMany = 0xCA;
    std::vector<CommandCode> commands;
    // Returns the answer to some commands; an empty one means silence.
    std::function<std::optional<Bytes>(const AddressedCommand&, milliseconds)> override;

private:
    Bytes recordPart(const Bytes& request) const
    {
        if (request[0] != reservation)
            return {0xC5};
        const std::size_t index = request[2];
        if (index >= records.size())
            return {0xCB};
        const std::string& record = records[index];
        if (request[5] > bytesAtOnce)
            return {codeOfTooMany};
        if (request[4] + std::size_t{request[5]} > record.size())
            return {0xC9};
        const bool isLast = index + 1 == records.size();
        Bytes answer = {0, static_cast<std::uint8_t>(isLast ? 0xFF : index + 1),
            static_cast<std::uint8_t>(isLast ? 0xFF : 0)};
        answer.insert(
            answer.end(), record.begin() + request[4], record.begin() + request[4] + request[5]);
        return answer;
    }
};

inline SimulatedSensor temperature(const std::string& name, int number)
{
    return {.idString = eightBit(name), .thresholds = {{unc, 80}}, .number = number};
}

class FakeControllerTest : public ::testing::Test {
protected:
    const Vorn::MachineFileNode& pass(FakeController& controller)
    {
        collector_.pass(controller, allThresholds);
        return collector_.nodes().at(0);
    }

    Collector collector_{{}};
    FakeController controller_{{temperature("A", 1), temperature("B", 2)}};
};

} // namespace Testing
