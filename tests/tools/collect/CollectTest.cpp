// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/collect/CollectTest.h"

#include "tests/support/ErrorOf.h"

#include <array>
#include <cerrno>
#include <set>

namespace CollectTests {

using CollectTest = Testing::CollectTest;
using Testing::findNode;
using Testing::nodeOf;
using Testing::SimulatedSensor;
using Vorn::MachineFile;
using Vorn::MachineFileNode;

std::optional<double> limitOf(const SimulatedSensor& sensor, Testing::ThresholdBit bit)
{
    const auto limit = sensor.limits.find(bit);
    return limit == sensor.limits.end() ? std::nullopt : std::optional(limit->second);
}

std::vector<unsigned> possibleStatesOf(const SimulatedSensor& sensor)
{
    std::set<unsigned> states{1, 16};
    for (const auto& [bit, raw] : sensor.thresholds)
        states.insert(std::array{22U, 25U, 25U, 23U, 26U, 26U}.at(static_cast<std::size_t>(bit)));
    return {states.begin(), states.end()};
}

unsigned baseUnitsOf(Vorn::NodeLexicon::NodeType type)
{
    using Vorn::NodeLexicon::NodeType;
    if (type == NodeType::Temperature)
        return 2;
    return type == NodeType::Voltage ? 5 : 19;
}

void expectMeant(const MachineFileNode& node, const SimulatedSensor& sensor)
{
    SCOPED_TRACE(sensor.description);
    EXPECT_EQ(node.type, Testing::nodeTypeOf(sensor));
    EXPECT_EQ(node.sensorType, static_cast<unsigned>(node.type));
    EXPECT_EQ(node.description, sensor.description);
    EXPECT_EQ(node.values.status, sensor.status);
    EXPECT_EQ(node.values.baseUnits, baseUnitsOf(node.type));
    EXPECT_EQ(node.values.possibleStates, possibleStatesOf(sensor));
    Testing::expectNumber(node.values.reading, sensor.reading);
    Testing::expectNumber(node.values.lowerNonCritical, limitOf(sensor, Testing::lnc));
    Testing::expectNumber(node.values.lowerCritical, limitOf(sensor, Testing::lc));
    Testing::expectNumber(node.values.lowerFatal, limitOf(sensor, Testing::lnr));
    Testing::expectNumber(node.values.upperNonCritical, limitOf(sensor, Testing::unc));
    Testing::expectNumber(node.values.upperCritical, limitOf(sensor, Testing::uc));
    Testing::expectNumber(node.values.upperFatal, limitOf(sensor, Testing::unr));
}

void expectServer(const MachineFile& file)
{
    std::size_t published = 0;
    for (const SimulatedSensor& sensor : Testing::simulatedServer()) {
        const MachineFileNode* const node = findNode(file, Testing::pathOf(sensor));
        ASSERT_EQ(node != nullptr, !sensor.description.empty()) << Testing::pathOf(sensor);
        if (node == nullptr)
            continue;
        ++published;
        expectMeant(*node, sensor);
    }
    EXPECT_EQ(file.nodes.size(), published);
}

TEST_F(CollectTest, EverySensorIsWhatItIsMeantToBe)
{
    expectServer(collect());
}

TEST_F(CollectTest, ASlowControllerIsReadInTheSameWay)
{
    const MachineFile file = collect({}, {{"SIMULATED_BMC_DELAY", "30"}});
    expectServer(file);
    // The pass took at least six seconds, and takes a fifth of the time at most.
    EXPECT_GT(file.renewal.value().period, 30);
}

TEST_F(CollectTest, LateAnswersAreDiscarded)
{
    expectServer(collect({}, {{"SIMULATED_LATE_ANSWERS", "1"}}));
}

// A controller whose state bits are set to each of them in turn.
TEST_F(CollectTest, EachAlarmOfTheControllerIsAStatus)
{
    const std::pair<const char*, unsigned> alarms[] = {{"00", 1}, {"01", 22}, {"02", 25},
        {"04", 25}, {"08", 23}, {"10", 26}, {"20", 26}, {"3f", 26}, {"0b", 25}, {"09", 23},
        {"c0", 1}};
    for (const auto& [bits, status] : alarms) {
        bmc_.setFaults(fault(numberOf("CPU1 Temp"), std::string("set 3 ") + bits));
        EXPECT_EQ(nodeOf(collect(), "CPU1 Temp").values.status, status) << bits;
    }
}

TEST_F(CollectTest, ASensorWithoutAReadingSaysWhy)
{
    const std::pair<const char*, unsigned> faults[] = {{"set 2 20", 17}, {"code cb", 17},
        {"code cc", 17}, {"code cd", 17}, {"code c1", 17}, {"code c0", 13}, {"code d5", 13},
        {"code c3", 13}, {"code ff", 13}, {"length 2", 13}, {"length 1", 13}};
    for (const auto& [action, status] : faults) {
        bmc_.setFaults(fault(numberOf("CPU1 Temp"), action));
        const MachineFile file = collect();
        const Vorn::NodeReading& values = nodeOf(file, "CPU1 Temp").values;
        EXPECT_EQ(values.status, status) << action;
        EXPECT_EQ(values.reading, std::nullopt) << action;
        EXPECT_EQ(values.upperCritical, 95) << action;
        EXPECT_EQ(nodeOf(file, "GPU Temp").values.status, 26) << action;
    }
}

TEST_F(CollectTest, AnAnswerWithoutAlarmsIsComparedWithTheLimits)
{
    std::string faults;
    for (const SimulatedSensor& sensor : Testing::simulatedServer())
        if (sensor.owner == 0x20 && sensor.lun == 0)
            faults += fault(sensor.number, "length 3");
    bmc_.setFaults(faults + unavailable(numberOf("NVMe Temp")));
    expectServer(collect());
}

// Each of the six thresholds is crossed and crossed back, two raw units beyond it.
TEST_F(CollectTest, AlarmsFollowTheReadingWithTheHysteresisOfTheController)
{
    const std::vector<std::pair<int, unsigned>> down = {
        {70, 1}, {9, 22}, {11, 22}, {13, 1}, {6, 25}, {8, 25}, {10, 22}, {3, 25}, {5, 25}, {70, 1}};
    const std::vector<std::pair<int, unsigned>> up = {
        {60, 1}, {86, 23}, {84, 23}, {82, 1}, {96, 26}, {94, 26}, {92, 23}, {101, 26}, {60, 1}};
    for (const auto& [sensor, factor, readings] :
        {std::tuple("FAN1", 75, down), {"GPU Temp", 1, up}})
        for (const auto& [raw, status] : readings) {
            bmc_.command("sensor_set_value 0x20 0 " + std::to_string(numberOf(sensor)) + " " +
                         std::to_string(raw) + " 0");
            const MachineFile file = collect();
            EXPECT_EQ(nodeOf(file, sensor).values.status, status) << sensor << " " << raw;
            EXPECT_EQ(nodeOf(file, sensor).values.reading, factor * raw);
        }
}

TEST_F(CollectTest, ASatelliteThatIsOffLosesItsSensorsOnly)
{
    bmc_.command("mc_disable 0x2c");
    const MachineFile file = collect();
    EXPECT_EQ(nodeOf(file, "ME Temp").values.status, 13);
    EXPECT_EQ(nodeOf(file, "ME Temp").values.reading, std::nullopt);
    EXPECT_EQ(nodeOf(file, "CPU1 Temp").values.reading, 58);
}

TEST_F(CollectTest, ASatelliteToWhichTheKernelKnowsNoWayLosesItsSensorsOnly)
{
    for (const int error : {EINVAL, EAGAIN}) {
        const MachineFile file =
            collect({}, {{"SIMULATED_SATELLITE_ERROR", std::to_string(error)}});
        EXPECT_EQ(nodeOf(file, "ME Temp").values.status, 13) << error;
        EXPECT_EQ(nodeOf(file, "ME Temp").values.upperCritical, 100); // as the record says
        EXPECT_EQ(nodeOf(file, "CPU1 Temp").values.reading, 58);
    }
    EXPECT_EQ(Testing::errorOf([this] {
        collect({}, {{"SIMULATED_SATELLITE_ERROR", std::to_string(ENODEV)}});
    }),
        "sensorctl: /dev/ipmi0: No such device\n");
}

TEST_F(CollectTest, WorkaroundsAreApplied)
{
    const SimulatedSensor& off = sensorOf("FAN8");
    EXPECT_EQ(nodeOf(collect(), off.description).values.status, 16);
    const MachineFile scanned = collect({"--workaround", "ignorescanningdisabled"});
    EXPECT_EQ(nodeOf(scanned, off.description).values.reading, 0);

    // The satellite's sensor 1 is taken for the BMC's, which is 58 degrees.
    const MachineFile owned =
        collect({"--workaround", "assumebmcowner", "--workaround", "discretereading"});
    EXPECT_EQ(nodeOf(owned, "ME Temp").values.reading, 58);
    EXPECT_EQ(nodeOf(owned, off.description).values.status, 16);
}

} // namespace CollectTests
