// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFileNode.h"
#include "tools/collect/Bmc.h"
#include "tools/collect/SdrRepository.h"
#include "tools/collect/SensorAnswer.h"
#include "tools/collect/SensorKind.h"

#include <chrono>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace Ipmi {

// Deviations of controllers from the standard.
struct Workarounds {
    bool readsDiscrete = false;   // sensors with an analog reading have a discrete event type
    bool ignoresScanning = false; // all sensors are said not to be scanned
    bool assumesBmcOwner = false; // sensors have another owner, but the BMC answers for them
};

// Collects the temperatures, voltages and fans of a BMC as nodes of a model file. Records are read
// again when the repository changes, and a share of the thresholds in each pass, so that all are
// read again within five minutes. Used by one thread.
class Collector {
public:
    explicit Collector(Workarounds workarounds) : workarounds_(workarounds) {}

    // Reads all sensors once: one command for each, one for the repository, and those of the
    // thresholds that are due where passes begin at an interval of that length. Throws SilentBmc
    // and what the transport and readRepository() throw; the caller calls loseAll() then.
    void pass(Transport& transport, std::chrono::duration<double> interval);

    // Makes all nodes sensors that have lost communication.
    void loseAll();

    const std::vector<Vorn::MachineFileNode>& nodes() const { return nodes_; }

    // Returns the nodes without those of sensors that are unavailable and have never been read.
    std::vector<Vorn::MachineFileNode> presentNodes() const;

private:
    using Clock = std::chrono::steady_clock;

    struct Sensor {
        SensorRecord record;
        SensorKind kind;
        Limits limits{};
        std::map<std::uint8_t, Factors> factors = {}; // by raw reading, where they depend on it
        bool isAbsent = false;                        // is unavailable and has never been read
    };

    void readRecords(Bmc& bmc);
    void nameNodes();
    void readThresholds(Bmc& bmc, std::size_t index);
    void readSensor(Bmc& bmc, std::size_t index);
    void readSilentSensors(Bmc& bmc);
    std::optional<double> valueOf(Bmc& bmc, Sensor& sensor, std::uint8_t raw);
    Bytes request(Bmc& bmc, const Sensor& sensor, CommandCode code, Bytes more = {});

    Workarounds workarounds_;
    RepositoryStamp repository_; // when the records were read
    std::vector<Sensor> sensors_;
    std::vector<Vorn::MachineFileNode> nodes_; // one for each sensor, at the same index
    std::set<SensorAddress> readBefore_;
    std::map<SensorAddress, Clock::time_point> askAgain_; // sensors at which the BMC fell silent
    std::size_t nextThresholds_ = 0;
};

} // namespace Ipmi
