// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/bmc/SimulatedSensor.h"

#include <array>
#include <cstdio>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace Testing {

namespace {

constexpr int degreesF = 2;
constexpr int kelvins = 3;
constexpr int volts = 4;
constexpr int rpm = 18;
constexpr int revolutions = 41;

constexpr int onesComplement = 0x40;
constexpr int twosComplement = 0x80;
constexpr int percentage = 0x01;
constexpr int perSecond = 3 << 3;
constexpr int perMinute = 4 << 3;

constexpr int temperature = 1;
constexpr int voltage = 2;
constexpr int fan = 4;

using Sensors = std::vector<SimulatedSensor>;

// clang-format off
Sensors temperatures()
{
    Sensors sensors = {
        {.idString = eightBit("CPU1 Temp"), .raw = 58, .thresholds = {{unc, 85}, {uc, 95}, {unr, 100}}, .entity = {3, 1},
         .description = "CPU1 Temp", .reading = 58, .limits = {{unc, 85}, {uc, 95}, {unr, 100}}},
        {.idString = eightBit("CPU2 Temp"), .raw = 88, .thresholds = {{unc, 85}, {uc, 95}}, .crossed = {unc}, .entity = {3, 2},
         .description = "CPU2 Temp", .status = 23, .reading = 88, .limits = {{unc, 85}, {uc, 95}}},
        {.idString = eightBit("CPU1 Margin"), .raw = 0x100 - 38, .thresholds = {{unc, 0x100 - 10}, {uc, 0x100 - 5}}, .units1 = twosComplement,
         .description = "CPU1 Margin", .reading = -38, .limits = {{unc, -10}, {uc, -5}}},
        {.idString = eightBit("CPU2 Margin"), .raw = 0x100 - 4, .thresholds = {{unc, 0x100 - 10}, {uc, 0x100 - 5}}, .crossed = {unc, uc}, .units1 = twosComplement,
         .description = "CPU2 Margin", .status = 26, .reading = -4, .limits = {{unc, -10}, {uc, -5}}},
        {.idString = eightBit("Inlet Temp"), .raw = 24, .thresholds = {{lc, 0x100 - 7}, {lnc, 3}, {unc, 38}, {uc, 42}}, .entity = {39, 1}, .units1 = twosComplement,
         .description = "Inlet Temp", .reading = 24, .limits = {{lc, -7}, {lnc, 3}, {unc, 38}, {uc, 42}}},
        {.idString = eightBit("Exhaust Temp"), .raw = 83, .thresholds = {{unc, 140}, {uc, 160}}, .m = 5, .resultExponent = -1,
         .description = "Exhaust Temp", .reading = 41.5, .limits = {{unc, 70}, {uc, 80}}},
        {.idString = eightBit("GPU Temp"), .raw = 101, .thresholds = {{unc, 85}, {uc, 95}, {unr, 100}}, .crossed = {unc, uc, unr},
         .description = "GPU Temp", .status = 26, .reading = 101, .limits = {{unc, 85}, {uc, 95}, {unr, 100}}},
        {.idString = eightBit("VR Temp"), .raw = 55, .thresholds = {{unc, 105}}, .entity = {3, 1},
         .description = "Processor 1 VR Temp", .reading = 55, .limits = {{unc, 105}}},
        {.idString = eightBit("VR Temp"), .raw = 72, .thresholds = {{unc, 105}}, .entity = {3, 2},
         .description = "Processor 2 VR Temp", .reading = 72, .limits = {{unc, 105}}},
        {.idString = sixBit("PCH TEMP"), .raw = 49, .description = "PCH TEMP", .reading = 49},
        {.idString = eightBit("Zuluft \xB0" "C f\xFCr L\xFC" "fter"), .raw = 23,
         .description = "Zuluft °C für Lüfter", .reading = 23},
        {.idString = eightBit("BP Temp ①"), .raw = 31, .description = "BP Temp ①", .reading = 31},
        {.idString = eightBit(" "), .raw = 30, .description = "Sensor 20/0/13", .reading = 30},
        {.idString = eightBit("Ambient F"), .unit = degreesF, .raw = 77, .thresholds = {{unc, 104}},
         .description = "Ambient F", .reading = 25, .limits = {{unc, 40}}},
        {.idString = eightBit("SoC K"), .unit = kelvins, .raw = 110, .thresholds = {{unc, 160}}, .b = 200,
         .description = "SoC K", .reading = 36.85, .limits = {{unc, 86.85}}},
        {.idString = eightBit("DIMM H1 Temp"), .raw = 0, .thresholds = {{unc, 210}, {uc, 230}}, .m = 50, .b = -20, .bExponent = 2, .resultExponent = -2, .isScanned = false,
         .description = "DIMM H1 Temp", .status = 16, .limits = {{unc, 85}, {uc, 95}}},
        {.idString = eightBit("Ghost Temp"), .thresholds = {{unc, 90}}, .isThere = false,
         .description = "Ghost Temp", .status = 17, .limits = {{unc, 90}}},
        {.idString = eightBit("NVMe Temp"), .thresholds = {{unc, 70}}, // whose reading is made unavailable
         .description = "NVMe Temp", .status = 17, .limits = {{unc, 70}}},
        {.idString = eightBit("OCP Temp"), .raw = 44, .thresholds = {{unc, 85}}, .lun = 1,
         .description = "OCP Temp", .reading = 44, .limits = {{unc, 85}}},
        {.idString = eightBit("ME Temp"), .raw = 51, .thresholds = {{unc, 90}, {uc, 100}}, .owner = 0x2C,
         .description = "ME Temp", .reading = 51, .limits = {{unc, 90}, {uc, 100}}},
    };
    for (int slot = 0; slot < 7; ++slot) { // DIMMs, in steps of half a degree from -20
        const std::string name = std::string("DIMM ") + static_cast<char>('A' + slot) + "1 Temp";
        sensors.push_back({.idString = eightBit(name), .raw = 121 + slot, .thresholds = {{unc, 210}, {uc, 230}}, .entity = {32, slot + 1},
            .m = 50, .b = -20, .bExponent = 2, .resultExponent = -2,
            .description = name, .reading = 40.5 + 0.5 * slot, .limits = {{unc, 85}, {uc, 95}}});
    }
    return sensors;
}

Sensors voltages()
{
    return {
        {.idString = eightBit("P12V"), .type = voltage, .unit = volts, .raw = 205, .thresholds = {{lc, 183}, {lnc, 193}, {unc, 214}, {uc, 224}}, .m = 59, .resultExponent = -3,
         .description = "P12V", .reading = 12.095, .limits = {{lc, 10.797}, {lnc, 11.387}, {unc, 12.626}, {uc, 13.216}}},
        {.idString = eightBit("P3V3"), .type = voltage, .unit = volts, .raw = 195, .thresholds = {{lc, 175}, {uc, 214}}, .m = 17, .resultExponent = -3, .recordedThresholds = {{lc, 147}, {uc, 235}},
         .description = "P3V3", .reading = 3.315, .limits = {{lc, 2.975}, {uc, 3.638}}},
        {.idString = eightBit("CPU1 Vcore"), .type = voltage, .unit = volts, .raw = 178, .thresholds = {{lc, 150}, {uc, 210}}, .m = 10, .resultExponent = -3, .access = 3,
         .description = "CPU1 Vcore", .reading = 1.78, .limits = {{lc, 1.5}, {uc, 2.1}}},
        {.idString = eightBit("CPU2 Vcore"), .type = voltage, .unit = volts, .raw = 179, .thresholds = {{lc, 150}, {uc, 210}}, .m = 10, .resultExponent = -3, .access = 0,
         .description = "CPU2 Vcore", .reading = 1.79},
        {.idString = eightBit("DIMM ABCD V"), .type = voltage, .unit = volts, .raw = 175, .thresholds = {{lnc, 160}, {unc, 190}}, .m = 4, .b = 50, .bExponent = 1, .resultExponent = -3,
         .description = "DIMM ABCD V", .reading = 1.2, .limits = {{lnc, 1.14}, {unc, 1.26}}},
        {.idString = eightBit("VBAT"), .type = voltage, .unit = volts, .raw = 156, .thresholds = {{lc, 144}, {lnc, 162}}, .crossed = {lnc}, .m = 16, .resultExponent = -3,
         .description = "VBAT", .status = 22, .reading = 2.496, .limits = {{lc, 2.304}, {lnc, 2.592}}},
        {.idString = eightBit("N12V"), .type = voltage, .unit = volts, .raw = 200, .thresholds = {{lc, 220}, {uc, 180}}, .m = -6, .resultExponent = -2,
         .description = "N12V", .reading = -12, .limits = {{lc, -13.2}, {uc, -10.8}}},
        {.idString = eightBit("VREF ofs"), .type = voltage, .unit = volts, .raw = 0xF5, .thresholds = {{lc, 0xCD}, {uc, 50}}, .units1 = onesComplement, .resultExponent = -2,
         .description = "VREF ofs", .reading = -0.1, .limits = {{lc, -0.5}, {uc, 0.5}}},
        {.idString = eightBit("PSU2 Vin"), .type = voltage, .unit = volts, .raw = 0, .thresholds = {{lc, 90}, {unc, 126}}, .crossed = {lc}, .m = 2,
         .description = "PSU2 Vin", .status = 25, .reading = 0, .limits = {{lc, 180}, {unc, 252}}},
        {.idString = bcdPlus("12.-1"), .type = voltage, .unit = volts, .raw = 105, .resultExponent = -2,
         .description = "12.-1", .reading = 1.05},
        {.idString = eightBit("VR curve"), .type = voltage, .unit = volts, .raw = 100, .linearization = 0x70},
        {.idString = eightBit("P1V8 Nm"), .type = voltage, .unit = volts, .raw = 164, .thresholds = {{lc, 147}, {uc, 180}}, .lun = 1, .m = 11, .resultExponent = -3,
         .description = "P1V8 Nm", .reading = 1.804, .limits = {{lc, 1.617}, {uc, 1.98}}},
    };
}

Sensors fans()
{
    Sensors sensors = {
        {.idString = eightBit("PSU1 Fan"), .type = fan, .unit = rpm, .raw = 125, .thresholds = {{lc, 250}}, .linearization = 7, .resultExponent = -6,
         .description = "PSU1 Fan", .reading = 8000, .limits = {{lc, 4000}}},
        {.idString = eightBit("Fan  9 rev "), .type = fan, .unit = revolutions, .raw = 48, .thresholds = {{lc, 5}}, .units1 = perMinute, .m = 100,
         .description = "Fan  9 rev", .reading = 4800, .limits = {{lc, 500}}},
        {.idString = eightBit("Pump"), .type = fan, .unit = revolutions, .raw = 60, .thresholds = {{lc, 10}}, .units1 = perSecond,
         .description = "Pump", .reading = 3600, .limits = {{lc, 600}}},
        {.idString = eightBit("FAN1 Duty"), .type = fan, .unit = 0, .raw = 40, .units1 = percentage},
        {.idString = eightBit("FAN8"), .type = fan, .unit = rpm, .raw = 0, .thresholds = {{lc, 7}}, .m = 75, .isScanned = false,
         .description = "FAN8", .status = 16, .limits = {{lc, 525}}},
        // Neither fan, voltage nor temperature; a temperature that only says whether it is too high;
        // a fan of software.
        {.idString = eightBit("PSU1 Pin"), .type = 11, .unit = 6, .raw = 59, .m = 4},
        {.idString = eightBit("CPU1 Hot"), .raw = 1, .units1 = 0xC0, .eventType = 5},
        {.idString = eightBit("Virtual"), .type = fan, .unit = rpm, .raw = 3, .owner = 0x41, .isThere = false},
    };
    struct { int raw; unsigned status; std::set<int> crossed; } const speeds[] = {
        {70, 1, {}}, {71, 1, {}}, {68, 1, {}}, {9, 22, {lnc}}, {69, 1, {}}, {0, 25, {lnc, lc, lnr}}, {72, 1, {}}};
    for (int number = 1; const auto& speed : speeds) {
        const std::string name = "FAN" + std::to_string(number++);
        sensors.push_back({.idString = eightBit(name), .type = fan, .unit = rpm, .raw = speed.raw, .thresholds = {{lnr, 4}, {lc, 7}, {lnc, 10}}, .crossed = speed.crossed, .m = 75,
            .description = name, .status = speed.status, .reading = 75 * speed.raw, .limits = {{lnr, 300}, {lc, 525}, {lnc, 750}}});
    }
    return sensors;
}
// clang-format on

std::string text(const char* format, auto... arguments)
{
    std::array<char, 256> line{};
    const int length = std::snprintf(line.data(), line.size(), format, arguments...);
    return {line.data(), static_cast<std::size_t>(length)};
}

char byte(int value)
{
    return static_cast<char>(value & 0xFF);
}

int valueAt(const std::map<int, int>& values, int key)
{
    const auto found = values.find(key);
    return found == values.end() ? 0 : found->second;
}

// Returns the mask of the thresholds that a sensor has.
int maskOf(const SimulatedSensor& sensor)
{
    int mask = 0;
    for (const auto& [bit, raw] : sensor.thresholds)
        mask |= 1 << bit;
    return mask;
}

std::string emulationOf(const SimulatedSensor& sensor)
{
    const std::string id = text("0x%x %d %d", sensor.owner, sensor.lun, sensor.number);
    std::string lines =
        text("sensor_add %s 0x%02x 0x%02x\n", id.c_str(), sensor.type, sensor.eventType);
    if (!sensor.thresholds.empty()) {
        constexpr std::array accesses = {"none", "readable", "settable", "fixed"};
        lines += "sensor_set_hysteresis " + id + " settable 2 2\nsensor_set_threshold " + id + " " +
                 accesses.at(static_cast<std::size_t>(sensor.access)) + " ";
        std::string values;
        for (int bit = unr; bit >= lnc; --bit) {
            lines += sensor.thresholds.contains(bit) ? '1' : '0';
            values += text(" 0x%02x", valueAt(sensor.thresholds, bit));
        }
        lines += values + "\n";
    }
    std::string events;
    for (int event = 0; event < 4; ++event)
        events += sensor.thresholds.empty() ? " 000000000000000" : " 000111111111111";
    lines += "sensor_set_event_support " + id + " enable " +
             (sensor.isScanned ? "scanning" : "no-scanning") + " per-state" + events + "\n" +
             text("sensor_set_value %s 0x%02x 0\n", id.c_str(), sensor.raw);
    // The simulator compares raw bytes as unsigned numbers, whatever they represent.
    for (const auto& [bit, raw] : sensor.thresholds)
        lines += text(
            "sensor_set_bit %s %d %d 0\n", id.c_str(), bit, sensor.crossed.contains(bit) ? 1 : 0);
    return lines;
}

Sensors numbered(const std::vector<Sensors>& groups)
{
    Sensors sensors;
    std::map<std::pair<int, int>, int> numbers;
    for (const Sensors& group : groups)
        for (SimulatedSensor sensor : group) {
            sensor.number = ++numbers[{sensor.owner, sensor.lun}];
            sensors.push_back(std::move(sensor));
        }
    return sensors;
}

} // namespace

std::string eightBit(const std::string& name)
{
    return byte(0xC0 | static_cast<int>(name.size())) + name;
}

std::string sixBit(const std::string& name)
{
    std::string bytes((name.size() * 6 + 7) / 8, '\0');
    for (std::size_t bit = 0; bit < name.size() * 6; ++bit)
        if (((name[bit / 6] - ' ') >> (bit % 6) & 1) != 0)
            bytes[bit / 8] = byte(bytes[bit / 8] | 1 << (bit % 8));
    return byte(0x80 | static_cast<int>(bytes.size())) + bytes;
}

std::string bcdPlus(const std::string& name)
{
    constexpr std::string_view digits = "0123456789 -.";
    std::string bytes((name.size() + 1) / 2, byte(0xAA)); // blanks
    for (std::size_t at = 0; at < name.size(); ++at) {
        const int digit = static_cast<int>(digits.find(name[at]));
        const int old = bytes[at / 2];
        bytes[at / 2] = byte(at % 2 == 0 ? (old & 0xF0) | digit : (old & 0x0F) | digit << 4);
    }
    return byte(0x40 | static_cast<int>(bytes.size())) + bytes;
}

const std::vector<SimulatedSensor>& simulatedServer()
{
    static const Sensors sensors = numbered({temperatures(), voltages(), fans()});
    return sensors;
}

Vorn::NodeLexicon::NodeType nodeTypeOf(const SimulatedSensor& sensor)
{
    using Vorn::NodeLexicon::NodeType;
    if (sensor.type == temperature)
        return NodeType::Temperature;
    return sensor.type == voltage ? NodeType::Voltage : NodeType::Tachometer;
}

std::string pathOf(const SimulatedSensor& sensor)
{
    return text("/ipmi/%02x/%d/%d", sensor.owner, sensor.lun, sensor.number);
}

std::string recordOf(const SimulatedSensor& sensor)
{
    const int mask = maskOf(sensor);
    std::map<int, int> thresholds = sensor.thresholds;
    for (const auto& [bit, raw] : sensor.recordedThresholds)
        thresholds[bit] = raw;
    std::string record = {0, 0, 0x51, 1, 0, byte(sensor.owner), byte(sensor.lun),
        byte(sensor.number), byte(sensor.entity.id), byte(sensor.entity.instance), 0x7F,
        byte(0x60 | sensor.access << 2), byte(sensor.type), byte(sensor.eventType), 0,
        byte((mask & 7) << 4), 0, byte((mask >> 3 & 7) << 4), byte(sensor.access == 0 ? 0 : mask),
        byte(sensor.access == 2 ? mask : 0), byte(sensor.units1), byte(sensor.unit), 0,
        byte(sensor.linearization), byte(sensor.m), byte((sensor.m >> 8 & 3) << 6), byte(sensor.b),
        byte((sensor.b >> 8 & 3) << 6), 0,
        byte((sensor.resultExponent & 15) << 4 | (sensor.bExponent & 15)), 0, 0, 0, 0, byte(0xFF),
        0};
    for (int bit : {unr, uc, unc, lnr, lc, lnc})
        record += byte(valueAt(thresholds, bit));
    record += std::string{2, 2, 0, 0, 0} + sensor.idString;
    record[4] = byte(static_cast<int>(record.size()) - 5);
    return record;
}

int recordIdOf(const std::string& description)
{
    int id = 6; // follows the records that are no sensors of the server
    for (const SimulatedSensor& sensor : simulatedServer()) {
        if (sensor.description == description)
            return id;
        ++id;
    }
    throw std::out_of_range(description);
}

std::string additionOf(const std::string& record)
{
    std::string line = "main_sdr_add 0x20";
    for (const char each : record)
        line += text(" 0x%02x", static_cast<unsigned>(static_cast<unsigned char>(each)));
    return line + "\n";
}

std::string emulationOf(const std::vector<SimulatedSensor>& sensors)
{
    // Sensor 0 of the simulator's BMC is the watchdog, which has an event-only record. Other
    // records are the satellite's, a compact one of three shared sensors, that of a device with an
    // inventory and one of a manufacturer.
    std::string lines = "mc_setbmc 0x20\n"
                        "mc_add 0x20 0x20 no-device-sdrs 0x01 2 5 0x9f 0x1291 0xf02\n"
                        "sel_enable 0x20 1000 0x0a\n"
                        "mc_add 0x2c 0x2c no-device-sdrs 0x01 4 1 0x01 0x1291 0xf03\n"
                        "sensor_add 0x20 0 0 0x23 0x6f event-only\n";
    lines += additionOf({0, 0, 0x51, 3, 20, 0x20, 0, 0, 7, 1, 0x23, 0x6F, 1, 0, 0, 0, byte(0xC8),
        'W', 'a', 't', 'c', 'h', 'd', 'o', 'g'});
    lines +=
        additionOf({0, 0, 0x51, 0x12, 13, 0x2C, 0, 0, 1, 0, 0, 0, 46, 1, 0, byte(0xC2), 'M', 'E'});
    lines += additionOf({0, 0, 0x51, 2, 32, 0x20, 0, 100, 10, 1, 0x67, 0x40, 8, 0x6F, 0, 0, 0, 0, 0,
        0, byte(0xC0), 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, byte(0xC5), 'P', 'S', 'U', ' ', 'A'});
    lines += additionOf({0, 0, 0x51, 0x11, 14, 0x20, 0, byte(0x80), 0, 0, 0x10, 0, 7, 1, 0,
        byte(0xC3), 'F', 'R', 'U'});
    lines += additionOf({0, 0, 0x51, byte(0xC0), 6, 0x12, 0x0F, 0, 1, 2, 3});
    for (const SimulatedSensor& sensor : sensors) {
        lines += additionOf(recordOf(sensor));
        if (sensor.isThere)
            lines += emulationOf(sensor);
    }
    return lines + "mc_enable 0x2c\nmc_enable 0x20\n";
}

} // namespace Testing
