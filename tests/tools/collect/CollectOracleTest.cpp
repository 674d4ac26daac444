// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Other readers of the same controller, where they are right: they do not decode all names and
// convert no units.

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

// Returns the limits by increasing threshold.
std::array<std::optional<double>, 6> limitsOf(const NodeReading& values)
{
    return {values.lowerFatal, values.lowerCritical, values.lowerNonCritical,
        values.upperNonCritical, values.upperCritical, values.upperFatal};
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

// What ipmitool says of a sensor, by the words before the colons.
using Fields = std::map<std::string, std::string>;

// Returns the fields of each sensor.
std::vector<Fields> fieldsIn(const std::vector<Cells>& lines)
{
    std::vector<Fields> sensors;
    for (const Cells& line : lines) {
        if (line.size() < 2)
            continue;
        if (line[0] == "Sensor ID") // such as "CPU1 Temp (0x1)"
            sensors.push_back({{line[0], line[1].substr(0, line[1].rfind(" ("))}});
        else if (!sensors.empty())
            sensors.back().insert({line[0], line[1]});
    }
    return sensors;
}

void expectStatus(unsigned status, const std::string& words)
{
    const std::map<std::string, std::set<unsigned>> statuses = {{"ok", {1}},
        {"Lower Non-Critical", {22}}, {"Upper Non-Critical", {23}}, {"Lower Critical", {25}},
        {"Lower Non-Recoverable", {25}}, {"Upper Critical", {26}}, {"Upper Non-Recoverable", {26}},
        {"Not Available", {13, 16, 17}}};
    EXPECT_TRUE(statuses.at(words).contains(status)) << status << ", but " << words;
}

// Returns how many limits were compared.
std::size_t expectLimits(const NodeReading& values, const Fields& fields)
{
    constexpr std::array names = {"Lower non-recoverable", "Lower critical", "Lower non-critical",
        "Upper non-critical", "Upper critical", "Upper non-recoverable"};
    std::size_t compared = 0;
    for (std::size_t at = 0; at < names.size(); ++at) {
        const auto limit = fields.find(names.at(at));
        if (limit == fields.end())
            continue;
        SCOPED_TRACE(limit->first);
        expectNumber(limitsOf(values).at(at), std::stod(limit->second));
        ++compared;
    }
    return compared;
}

TEST_F(CollectOracleTest, IpmitoolHasTheSameReadingsStatesAndLimits)
{
    const MachineFile file = collect();
    std::size_t readings = 0;
    std::size_t limits = 0;
    for (Fields& fields :
        fieldsIn(linesOf("/usr/bin/ipmitool", {"-I", "open", "-v", "sdr"}, ':'))) {
        const MachineFileNode* const node = named(file, fields["Sensor ID"]);
        const std::string& reading = fields["Sensor Reading"]; // such as "58 (+/- 0) degrees C"
        const std::string unit = reading.substr(std::min(reading.find(") "), reading.size()));
        if (node == nullptr ||
            (!unit.empty() && unit != ") degrees C" && unit != ") Volts" && unit != ") RPM"))
            continue;
        SCOPED_TRACE(node->description);
        expectNumber(
            node->values.reading, unit.empty() ? std::nullopt : std::optional(std::stod(reading)));
        expectStatus(node->values.status, fields["Status"]);
        ++readings;
        if (node->description != "P3V3") // has other limits than its record, which ipmitool shows
            limits += expectLimits(node->values, fields);
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

void expectNear(const std::optional<double>& seen, const std::string& cell)
{
    constexpr double rounding = 0.0051; // two decimals
    ASSERT_EQ(seen.has_value(), cell != "N/A");
    if (seen) {
        EXPECT_NEAR(*seen, std::stod(cell), rounding);
    }
}

// Its limits are those of another sensor where a sensor is not the BMC's at its logical unit 0, and
// it ends at a sensor that has limits in its record only.
TEST_F(CollectOracleTest, IpmiSensorsHasTheSameReadingsStatesAndLimits)
{
    const MachineFile file = collect();
    std::size_t readings = 0;
    std::size_t limited = 0;
    for (const Cells& cells : linesOf("/usr/sbin/ipmi-sensors",
             {"-D", "OPENIPMI", "--sdr-cache-directory=" + folder_.path().string(), "--quiet-cache",
                 "--comma-separated-output", "--no-header-output", "--bridge-sensors",
                 "--output-event-bitmask", "--output-sensor-thresholds",
                 "--exclude-record-ids=" + std::to_string(Testing::recordIdOf("Ghost Temp"))},
             ',')) {
        ASSERT_EQ(cells.size(), 12U);
        const MachineFileNode* const node = named(file, cells[1]);
        const std::string& unit = cells[4];
        if (node == nullptr || (unit != "C" && unit != "V" && unit != "RPM"))
            continue;
        SCOPED_TRACE(cells[1]);
        const NodeReading& values = node->values;
        ++readings;
        expectNear(values.reading, cells[3]);
        if (values.reading) {
            EXPECT_EQ(values.status, statusOf(std::stoul(cells[11], nullptr, 16)));
        }
        if (!node->path.starts_with("/ipmi/20/0/"))
            continue;
        ++limited;
        for (std::size_t at = 0; at < limitsOf(values).size(); ++at)
            expectNear(limitsOf(values).at(at), cells[5 + at]);
    }
    EXPECT_GT(readings, 35U);
    EXPECT_GT(limited, 30U);
}

} // namespace CollectOracleTests
