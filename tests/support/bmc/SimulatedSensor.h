// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors of the simulated machine: what the controller says of each, and what each is meant to
// be.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <cstdint>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace Testing {

// The bits of thresholds.
enum ThresholdBit { lnc, lc, lnr, unc, uc, unr };

struct Entity {
    int id = 7;
    int instance = 1;
};

struct SimulatedSensor {
    // A type/length byte and the bytes of the name.
    std::string idString;
    int type = 1; // 1 temperature, 2 voltage, 4 fan
    int unit = 1; // 1 degrees C, 4 volts, 18 RPM
    int raw = 0;
    std::map<int, int> thresholds = {}; // raw, by their bits
    std::set<int> crossed = {};         // their bits
    Entity entity = {};
    int owner = 0x20;
    int lun = 0;
    int units1 = 0; // bits 7:6 format, 5:3 rate, 2:1 modifier, 0 percentage
    int linearization = 0;
    int m = 1;
    int b = 0;
    int bExponent = 0;
    int resultExponent = 0;
    int access = 2; // to thresholds: 0 none, 1 readable, 2 settable, 3 fixed
    std::map<int, int> recordedThresholds = {}; // raw, where the record has others
    bool isScanned = true;
    bool isThere = true; // else there is only the record
    int eventType = 1;
    int number = 0; // assigned by the machine

    // What is published. A sensor without a description is not.
    std::string description = {};
    unsigned status = 1;
    std::optional<double> reading = {};
    std::map<int, double> limits = {}; // by the bits of their thresholds
};

// Return an ID string of 8-bit bytes, of packed 6-bit characters and of BCD plus.
std::string eightBit(const std::string& name);
std::string sixBit(const std::string& name);
std::string bcdPlus(const std::string& name);

// Returns the sensors of a server, numbered for each owner and LUN from 1.
const std::vector<SimulatedSensor>& simulatedServer();

Vorn::NodeLexicon::NodeType nodeTypeOf(const SimulatedSensor& sensor);
std::string pathOf(const SimulatedSensor& sensor);

// Returns the full sensor record.
std::string recordOf(const SimulatedSensor& sensor);

// Returns the identifier that ipmi_sim gives the record of a sensor of the simulated server.
int recordIdOf(const std::string& description);

// Returns the commands by which ipmi_sim makes such a machine.
std::string emulationOf(const std::vector<SimulatedSensor>& sensors);

// Returns the command that adds a record.
std::string additionOf(const std::string& record);

} // namespace Testing
