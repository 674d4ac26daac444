// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What becomes of sensors that ipmi_sim cannot have.

#include "tests/tools/collect/FakeController.h"

namespace CollectorTests {

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

using CollectorTest = Testing::FakeControllerTest;

TEST_F(CollectorTest, ReadsThresholdsAgainInTurn)
{
    collector_.pass(controller_, allThresholds);
    EXPECT_EQ(collector_.nodes().at(0).values.lowerFatal, 3);
    controller_.override = [](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorThresholds)
            return Bytes{0, 0x08, 0, 0, 0, 70, 0, 0};
        return std::nullopt;
    };
    collector_.pass(controller_, std::chrono::seconds(10)); // one of the two
    EXPECT_EQ(collector_.nodes().at(0).values.upperNonCritical, 70);
    EXPECT_EQ(collector_.nodes().at(0).values.lowerFatal, std::nullopt);
    EXPECT_EQ(collector_.nodes().at(1).values.upperNonCritical, 4);
    collector_.pass(controller_, std::chrono::seconds(10));
    EXPECT_EQ(collector_.nodes().at(1).values.upperNonCritical, 70);
}

TEST_F(CollectorTest, ReadsMoreThresholdsInAPassWhereThereAreFewerPasses)
{
    FakeController controller(
        {temperature("A", 1), temperature("B", 2), temperature("C", 3), temperature("D", 4)});
    const std::pair<int, std::size_t> rows[] = {
        {1, 1}, {10, 1}, {75, 1}, {150, 2}, {225, 3}, {300, 4}, {3600, 4}};
    for (const auto& [seconds, thresholds] : rows) {
        collector_.pass(controller, std::chrono::seconds(seconds));
        const std::size_t before = controller.count(CommandCode::getSensorThresholds);
        collector_.pass(controller, std::chrono::seconds(seconds));
        EXPECT_EQ(controller.count(CommandCode::getSensorThresholds) - before, thresholds)
            << seconds;
    }
}

TEST_F(CollectorTest, TakesTheThresholdsOfTheRecordWhereTheControllerHasNone)
{
    for (const Bytes& answer : {Bytes{0xC1}, Bytes{0xCC}, Bytes{0, 8, 1}}) {
        controller_.override = [&](const AddressedCommand& command,
                                   milliseconds) -> std::optional<Bytes> {
            return command.code == CommandCode::getSensorThresholds ? std::optional(answer)
                                                                    : std::nullopt;
        };
        EXPECT_EQ(pass(controller_).values.upperNonCritical, 80);
    }
}

TEST_F(CollectorTest, RequestsFactorsThatDependOnTheReadingOnce)
{
    SimulatedSensor curve = temperature("Curve", 1);
    curve.linearization = 0x70;
    FakeController controller({curve});
    controller.override = [](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        if (command.code != CommandCode::getSensorReadingFactors)
            return std::nullopt;
        const int m = command.data[1] < 50 ? 1 : 2;
        return Bytes{0, 0, static_cast<std::uint8_t>(m), 0, 0, 0, 0, 0xF0};
    };
    EXPECT_DOUBLE_EQ(pass(controller).values.reading.value(), 20); // 2 * 100 / 10
    EXPECT_DOUBLE_EQ(collector_.nodes().at(0).values.upperFatal.value(), 0.6);
    const std::size_t requested = controller.count(CommandCode::getSensorReadingFactors);
    pass(controller);
    EXPECT_EQ(controller.count(CommandCode::getSensorReadingFactors), requested);
}

TEST_F(CollectorTest, LeavesOutASensorWithoutFactors)
{
    SimulatedSensor curve = temperature("Curve", 1);
    curve.linearization = 0x70;
    FakeController controller({curve, temperature("B", 2)});
    EXPECT_EQ(pass(controller).description, "B");
}

// A fan whose reading is the reciprocal of a time, 12,500 per minute at the raw reading 80.
SimulatedSensor reciprocalFan()
{
    return {.idString = Testing::eightBit("Fan"),
        .type = 4,
        .unit = 18,
        .thresholds = {{Testing::lc, 250}, {Testing::lnr, 255}},
        .linearization = 7,
        .resultExponent = -6,
        .number = 1};
}

TEST_F(CollectorTest, AFanThatStandsTurnsAtZeroWhereTheControllerSaysThatItIsSlow)
{
    FakeController controller({reciprocalFan()});
    Bytes answer;
    controller.override = [&](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        return command.code == CommandCode::getSensorReading ? std::optional(answer) : std::nullopt;
    };
    answer = {0, 80, 0x40, 0xC0};
    EXPECT_EQ(pass(controller).values.reading, 12500);
    const std::pair<int, unsigned> alarms[] = {{0x01, 22}, {0x02, 25}, {0x04, 25}, {0xC7, 25}};
    for (const auto& [bits, status] : alarms) {
        answer = {0, 0, 0x40, static_cast<std::uint8_t>(bits)};
        EXPECT_EQ(pass(controller).values.status, status) << bits;
        EXPECT_EQ(pass(controller).values.reading, 0) << bits;
    }
    // Without such an alarm, nothing is known.
    for (const Bytes& unknown : {Bytes{0, 0, 0x40, 0xC0}, {0, 0, 0x40, 0x08}, {0, 0, 0x40}}) {
        answer = unknown;
        EXPECT_EQ(pass(controller).values.status, 13U);
        EXPECT_EQ(pass(controller).values.reading, std::nullopt);
    }
    answer = {0, 0, 0, 0x02}; // is not scanned
    EXPECT_EQ(pass(controller).values.status, 16U);
    EXPECT_EQ(pass(controller).values.reading, std::nullopt);
}

TEST_F(CollectorTest, ASensorThatWasNeverThereIsNotPresent)
{
    bool isThere = false;
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReading && command.data[0] == 1 && !isThere)
            return Bytes{0xCB};
        return std::nullopt;
    };
    EXPECT_EQ(pass(controller_).values.status, 17U);
    EXPECT_EQ(collector_.presentNodes().size(), 1U);
    collector_.loseAll();
    EXPECT_EQ(collector_.presentNodes().size(), 1U);
    isThere = true;
    EXPECT_EQ(pass(controller_).values.reading, 100);
    EXPECT_EQ(collector_.presentNodes().size(), 2U);
    isThere = false;
    EXPECT_EQ(pass(controller_).values.status, 13U);
    EXPECT_EQ(collector_.presentNodes().size(), 2U);
}

TEST_F(CollectorTest, ReadsDiscreteSensorsWhereThatIsWanted)
{
    SimulatedSensor discrete = temperature("Discrete", 1);
    discrete.eventType = 0x6F;
    FakeController controller({discrete});
    controller.override = [](const AddressedCommand& command,
                              milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSensorReading)
            return Bytes{0, 100, 0x40, 0xFF};
        return std::nullopt;
    };
    collector_.pass(controller, allThresholds);
    EXPECT_TRUE(collector_.nodes().empty());
    Collector wanting({.readsDiscrete = true});
    wanting.pass(controller, allThresholds);
    EXPECT_EQ(wanting.nodes().at(0).values.reading, 100);
    EXPECT_EQ(wanting.nodes().at(0).values.status, 1U);
}

TEST_F(CollectorTest, SensorsOfSoftwareAreTheControllersWhereThatIsAssumed)
{
    SimulatedSensor software = temperature("Virtual", 1);
    software.owner = 0x41;
    FakeController controller({software});
    collector_.pass(controller, allThresholds);
    EXPECT_TRUE(collector_.nodes().empty());
    Collector assuming({.assumesBmcOwner = true});
    assuming.pass(controller, allThresholds);
    EXPECT_EQ(assuming.nodes().at(0).values.reading, 100);
    EXPECT_EQ(assuming.nodes().at(0).path, "/ipmi/41/0/1");
}

TEST_F(CollectorTest, NamesAndPathsDistinguishSensors)
{
    SimulatedSensor far = temperature("A", 1);
    far.owner = 0x2C;
    far.lun = 0x72; // channel 7 and LUN 2
    far.entity = {10, 2};
    FakeController controller({temperature("A", 1), temperature("", 1), far});
    pass(controller);
    EXPECT_EQ(collector_.nodes().at(0).path, "/ipmi/20/0/1");
    EXPECT_EQ(collector_.nodes().at(0).description, "System Board 1 A");
    EXPECT_EQ(collector_.nodes().at(1).path, "/ipmi/20/0/1#2");
    EXPECT_EQ(collector_.nodes().at(1).description, "Sensor 20/0/1");
    EXPECT_EQ(collector_.nodes().at(2).path, "/ipmi/7-2c/2/1");
    EXPECT_EQ(collector_.nodes().at(2).description, "Power Supply 2 A");
}

} // namespace CollectorTests
