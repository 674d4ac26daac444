// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Records that change, that are returned in pieces, and that lead nowhere.

#include "tests/tools/collect/FakeController.h"

namespace SdrRepositoryTests {

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

using SdrRepositoryTest = Testing::FakeControllerTest;

TEST_F(SdrRepositoryTest, ReadsRecordsAgainWhenTheRepositoryChanged)
{
    pass(controller_);
    const std::size_t before = controller_.count(CommandCode::getSdr);
    pass(controller_);
    EXPECT_EQ(controller_.count(CommandCode::getSdr), before);
    controller_.records.push_back(Testing::recordOf(temperature("C", 3)));
    pass(controller_);
    EXPECT_EQ(collector_.nodes().size(), 3U);
}

TEST_F(SdrRepositoryTest, ReadsRecordsInPiecesThatTheControllerCanReturn)
{
    for (const auto& [size, code] :
        {std::pair(8U, 0xCA), {16U, 0xC7}, {23U, 0xC8}, {23U, 0xFF}, {255U, 0xCA}}) {
        FakeController controller({temperature("A name of sixteen", 1)});
        controller.bytesAtOnce = size;
        controller.codeOfTooMany = static_cast<std::uint8_t>(code);
        Collector collector({});
        collector.pass(controller, allThresholds);
        EXPECT_EQ(collector.nodes().at(0).description, "A name of sixteen");
    }
    controller_.bytesAtOnce = 4;
    EXPECT_THAT(
        Testing::errorOf([this] { pass(controller_); }), HasSubstr("Get SDR is answered CA"));
    EXPECT_TRUE(collector_.nodes().empty());
}

TEST_F(SdrRepositoryTest, ReservesTheRepositoryAgainWhenAnotherReaderHasDoneSo)
{
    int count = 0;
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSdr && ++count % 4 == 0)
            ++controller_.reservation;
        return std::nullopt;
    };
    EXPECT_EQ(pass(controller_).values.reading, 100);
    EXPECT_GT(controller_.count(CommandCode::reserveSdrRepository), 1U);

    controller_.records.clear(); // changes the repository
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSdr)
            return Bytes{0xC5};
        return std::nullopt;
    };
    EXPECT_THAT(
        Testing::errorOf([this] { pass(controller_); }), HasSubstr("Get SDR is answered C5"));
}

TEST_F(SdrRepositoryTest, BeginsARecordAgainThatAnotherReaderMayHaveChanged)
{
    int count = 0;
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code == CommandCode::getSdr && ++count == 2) { // after the header
            controller_.records[0] = Testing::recordOf(temperature("A longer name", 1));
            ++controller_.reservation;
        }
        return std::nullopt;
    };
    EXPECT_EQ(pass(controller_).description, "A longer name");
}

TEST_F(SdrRepositoryTest, AcceptsFewerBytesThanItAsksFor)
{
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code != CommandCode::getSdr || command.data[5] <= 10)
            return std::nullopt;
        AddressedCommand shorter = command;
        shorter.data[5] = 10;
        return controller_.answer(shorter);
    };
    EXPECT_EQ(pass(controller_).description, "A");
}

TEST_F(SdrRepositoryTest, EndsWhereTheRecordsLeadInACircle)
{
    controller_.override = [&](const AddressedCommand& command,
                               milliseconds) -> std::optional<Bytes> {
        if (command.code != CommandCode::getSdr)
            return std::nullopt;
        const std::string& record = controller_.records[0];
        Bytes answer = {0, 0, 0}; // the next is the first
        answer.insert(answer.end(), record.begin() + command.data[4],
            record.begin() + command.data[4] + command.data[5]);
        return answer;
    };
    pass(controller_);
    EXPECT_EQ(collector_.nodes().size(), 1U);
}

TEST_F(SdrRepositoryTest, AControllerWithoutARepositoryIsAnError)
{
    controller_.override = [](const AddressedCommand&, milliseconds) -> std::optional<Bytes> {
        return Bytes{0xC1};
    };
    EXPECT_THAT(Testing::errorOf([this] { pass(controller_); }),
        HasSubstr("Get SDR Repository Info is answered C1"));
}

} // namespace SdrRepositoryTests
