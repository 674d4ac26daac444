// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Other readers of the same controller, where they are right: they do not decode all names, convert
// no units, and do not show the limits of each sensor.

#include "tests/tools/collect/CollectTest.h"

#include <array>
#include <set>
#include <sstream>

namespace CollectOracleTests {

using Testing::expectNumber;
using Testing::findNode;
using Vorn::MachineFile;
using Vorn::MachineFileNode;
using Vorn::NodeReading;

using Cells = std::vector<std::string>;

// Returns the cells of a line without the blanks at their ends.
Cells cellsOf(const std::string& line, char separator)
{
    Cells cells;
    std::istringstream row(line);
    for (std::string cell; std::getline(row, cell, separator);) {
        const auto begin = std::min(cell.find_first_not_of(' '), cell.size());
        cells.push_back(cell.substr(begin, cell.find_last_not_of(' ') + 1 - begin));
    }
    return cells;
}

const MachineFileNode* named(const MachineFile& file, const std::string& name)
{
    const auto node = std::find_if(file.nodes.begin(), file.nodes.end(),
        [&](const MachineFileNode& each) { return each.description == name; });
    return node == file.nodes.end() ? nullptr : &*node;
}

class CollectOracleTest : public Testing::CollectTest {
protected:
    // Returns the lines of another reader, in cells.
    std::vector<Cells> linesOf(const std::string& program, const Cells& arguments, char separator)
    {
        std::vector<Cells> lines;
        const Testing::Ended ended =
            Testing::run(arguments, {.program = program, .environment = bmc_.environment()});
        for (const std::string& line : Testing::linesOf(ended.out))
            lines.push_back(cellsOf(line, separator));
        return lines;
    }
};

void expectStatus(const NodeReading& values, const std::string& state)
{
    const std::map<std::string, std::set<unsigned>> statuses = {
        {"ok", {1}}, {"nc", {22, 23}}, {"cr", {25, 26}}, {"nr", {25, 26}}, {"na", {13, 16, 17}}};
    EXPECT_TRUE(statuses.at(state).contains(values.status)) << values.status;
}

// Returns how many limits were compared.
std::size_t expectLimits(const NodeReading& values, std::span<const std::string> cells)
{
    const std::array limits = {values.lowerFatal, values.lowerCritical, values.lowerNonCritical,
        values.upperNonCritical, values.upperCritical, values.upperFatal};
    std::size_t compared = 0;
    for (std::size_t at = 0; at < limits.size(); ++at) {
        if (cells[at] == "na")
            continue;
        expectNumber(limits.at(at), std::stod(cells[at]));
        ++compared;
    }
    return compared;
}

TEST_F(CollectOracleTest, IpmitoolHasTheSameReadingsStatesAndLimits)
{
    const MachineFile file = collect();
    std::size_t readings = 0;
    std::size_t limits = 0;
    for (const Cells& cells : linesOf("/usr/bin/ipmitool", {"-I", "open", "sensor"}, '|')) {
        ASSERT_EQ(cells.size(), 10U);
        const MachineFileNode* const node = named(file, cells[0]);
        const std::string& unit = cells[2];
        if (node == nullptr ||
            (!unit.empty() && unit != "degrees C" && unit != "Volts" && unit != "RPM"))
            continue;
        SCOPED_TRACE(cells[0]);
        expectNumber(node->values.reading,
            cells[1] == "na" ? std::nullopt : std::optional(std::stod(cells[1])));
        expectStatus(node->values, cells[3]);
        ++readings;
        limits += expectLimits(node->values, std::span(cells).subspan<4, 6>());
    }
    EXPECT_GT(readings, 35U);
    EXPECT_GT(limits, 60U);
}

unsigned statusOf(unsigned long events)
{
    if ((events & 0x30U) != 0)
        return 26;
    if ((events & 0x06U) != 0)
        return 25;
    if ((events & 0x08U) != 0)
        return 23;
    return (events & 0x01U) != 0 ? 22 : 1;
}

TEST_F(CollectOracleTest, IpmiSensorsHasTheSameReadingsAndStates)
{
    const MachineFile file = collect();
    std::size_t compared = 0;
    for (const Cells& cells : linesOf("/usr/sbin/ipmi-sensors",
             {"-D", "OPENIPMI", "--sdr-cache-directory=" + folder_.path().string(), "--quiet-cache",
                 "--comma-separated-output", "--no-header-output", "--bridge-sensors",
                 "--output-event-bitmask"},
             ',')) {
        ASSERT_GE(cells.size(), 6U);
        const MachineFileNode* const node = named(file, cells[1]);
        const std::string& unit = cells[4];
        if (node == nullptr || (unit != "C" && unit != "V" && unit != "RPM"))
            continue;
        SCOPED_TRACE(cells[1]);
        const NodeReading& values = node->values;
        ++compared;
        ASSERT_EQ(values.reading.has_value(), cells[3] != "N/A");
        if (!values.reading)
            continue;
        constexpr double rounding = 0.0051; // two decimals
        EXPECT_NEAR(*values.reading, std::stod(cells[3]), rounding);
        EXPECT_EQ(values.status, statusOf(std::stoul(cells[5], nullptr, 16)));
    }
    EXPECT_GT(compared, 35U);
}

} // namespace CollectOracleTests
