// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Controllers, satellites and sensors that are busy, silent or fail.

#include "tests/tools/collect/FakeController.h"

#include <thread>

namespace CollectorFailureTests {

using Ipmi::AddressedCommand;
using Ipmi::Bytes;
using Ipmi::Collector;
using Ipmi::CommandCode;
using std::chrono::milliseconds;
using Testing::allThresholds;
using Testing::FakeController;
using testing::HasSubstr;
using Testing::SimulatedSensor;
using Testing::temperature;

using CollectorFailureTest = Testing::FakeControllerTest;

TEST_F(CollectorFailureTest, KeepsTheThresholdsWhereTheControllerFails)
{
    pass(controller_);
    for (const int code : {0xC3, 0xD5}) {
        controller_.override = [&](const AddressedCommand& command,
                                   milliseconds) -> std::optional<Bytes> {
            if (command.code == CommandCode::getSensorThresholds)
                return Bytes{static_cast<std::uint8_t>(code)};
            return std::nullopt;
        };
        EXPECT_EQ(pass(controller_).values.upperNonCritical, 4);
    }
}

TEST_F(CollectorFailureTest, ASensorWhoseFactorsCannotBeReadNowIsLost)
{
    SimulatedSensor curve = temperature("Curve", 1);
    curve.linearization = 0x70;
    FakeController controller({curve});
    controller.override = [](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReadingFactors)
            return Bytes{0xC3};
        return std::nullopt;
    };
    EXPECT_EQ(pass(controller).values.status, 13U);
    EXPECT_EQ(collector_.nodes().at(0).values.reading, std::nullopt);
}

TEST_F(CollectorFailureTest, RepeatsCommandsToABusyControllerTwice)
{
    int busy = 2;
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReading && busy-- > 0)
            return Bytes{0xC0};
        return std::nullopt;
    };
    EXPECT_EQ(pass(controller_).values.reading, 100);
    busy = 3;
    EXPECT_EQ(pass(controller_).values.status, 13U);
    EXPECT_EQ(collector_.nodes().at(1).values.reading, 100);
}

TEST_F(CollectorFailureTest, ASatelliteThatDoesNotAnswerIsAskedOnce)
{
    SimulatedSensor first = temperature("A", 1);
    SimulatedSensor second = temperature("B", 2);
    first.owner = second.owner = 0x2C;
    FakeController controller({first, second, temperature("C", 1)});
    std::size_t asked = 0;
    controller.override = [&](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        if (command.responder.isBmc)
            return std::nullopt;
        ++asked;
        return Bytes{};
    };
    EXPECT_EQ(pass(controller).values.status, 13U);
    EXPECT_EQ(asked, 1U);
    EXPECT_EQ(controller.count(CommandCode::getDeviceId), 1U);
    EXPECT_EQ(collector_.nodes().at(2).values.reading, 100);
}

TEST_F(CollectorFailureTest, AFailureOfOneSensorOfASatelliteLosesThatSensor)
{
    SimulatedSensor first = temperature("A", 1);
    SimulatedSensor second = temperature("B", 2);
    first.owner = second.owner = 0x2C;
    FakeController controller({first, second});
    std::uint8_t code = 0;
    controller.override = [&](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReading && command.data[0] == 1)
            return Bytes{code};
        return std::nullopt;
    };
    for (const int each : {0xC3, 0xFF}) { // at once
        code = static_cast<std::uint8_t>(each);
        EXPECT_EQ(pass(controller).values.status, 13U);
        EXPECT_EQ(collector_.nodes().at(1).values.reading, 100);
    }
}

TEST_F(CollectorFailureTest, ASilentControllerEndsThePass)
{
    pass(controller_);
    controller_.commands.clear();
    std::vector<milliseconds> timeouts;
    constexpr milliseconds delay{200};
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds timeout) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSdrRepositoryInfo)
            return std::nullopt;
        timeouts.push_back(timeout);
        std::this_thread::sleep_for(delay);
        return Bytes{0xC3}; // as the kernel reports it
    };
    try {
        pass(controller_);
        ADD_FAILURE() << "the pass has not ended";
    } catch (const Ipmi::SilentBmc& silence) {
        EXPECT_STREQ(silence.what(), "the BMC does not answer");
        EXPECT_FALSE(silence.hasWaited());
    }
    EXPECT_EQ(controller_.commands.size(), 3U);
    ASSERT_EQ(timeouts.size(), 2U);
    EXPECT_LE(timeouts[0], milliseconds(5000));
    EXPECT_LE(timeouts[1], milliseconds(5000) - delay); // together
    collector_.loseAll();
    for (const Vorn::MachineFileNode& node : collector_.nodes()) {
        EXPECT_EQ(node.values.status, 13U);
        EXPECT_EQ(node.values.reading, std::nullopt);
        EXPECT_EQ(node.values.upperNonCritical, 4);
    }
}

TEST_F(CollectorFailureTest, ASensorAtWhichTheControllerFallsSilentLosesTheOthersOnce)
{
    bool isHung = false;
    bool isFaulty = true;
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        const bool isForSensor = command.code != CommandCode::getSdr && command.data.size() == 1;
        isHung = isFaulty && (isForSensor ? command.data[0] == 1 : isHung);
        if (isHung && (isForSensor || command.code == CommandCode::getDeviceId))
            return Bytes{};
        return std::nullopt;
    };
    EXPECT_NE(Testing::errorOf([this] { pass(controller_); }), "");
    EXPECT_EQ(pass(controller_).values.status, 13U);
    EXPECT_EQ(collector_.nodes().at(1).values.reading, 100);

    controller_.commands.clear();
    pass(controller_);
    EXPECT_EQ(controller_.count(CommandCode::getSensorReading), 1U); // the other one
    isFaulty = false;
    pass(controller_);
    EXPECT_EQ(collector_.nodes().at(0).values.status, 13U); // is asked later
}

TEST_F(CollectorFailureTest, ASensorAtWhichTheWholeControllerHungIsReadAgainWithTheOthers)
{
    pass(controller_);
    controller_.override = [](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReading ||
            command.code == CommandCode::getDeviceId)
            return Bytes{};
        return std::nullopt;
    };
    EXPECT_NE(Testing::errorOf([this] { pass(controller_); }), "");
    controller_.override = nullptr;
    EXPECT_EQ(pass(controller_).values.reading, 100);
    EXPECT_EQ(collector_.nodes().at(1).values.reading, 100);
}

} // namespace CollectorFailureTests
