// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/Collector.h"

#include "platform/instrumentation/NodeStatus.h"
#include "tools/collect/SensorName.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <utility>

namespace Ipmi {

namespace NodeStatus = Vorn::NodeStatus;

namespace {

constexpr std::uint8_t thresholdEvents = 1; // the event type of a sensor with thresholds

constexpr std::chrono::minutes thresholdPeriod{5};
constexpr std::chrono::minutes pauseAfterSilence{5};

// Returns an address as paths and names contain it, such as "20/0/17" or "7-2c/0/1".
std::string textOf(const SensorAddress& address)
{
    std::array<char, 4> owner{};
    std::snprintf(owner.data(), owner.size(), "%02x", static_cast<unsigned>(address.owner));
    return (address.channel == 0 ? "" : std::to_string(address.channel) + "-") + owner.data() +
           "/" + std::to_string(address.lun) + "/" + std::to_string(address.number);
}

std::optional<double>& limitOf(Vorn::NodeReading& values, std::size_t threshold)
{
    switch (threshold) {
    case lowerNonCritical:
        return values.lowerNonCritical;
    case lowerCritical:
        return values.lowerCritical;
    case lowerNonRecoverable:
        return values.lowerFatal;
    case upperNonCritical:
        return values.upperNonCritical;
    case upperCritical:
        return values.upperCritical;
    default:
        return values.upperFatal;
    }
}

void lose(Vorn::MachineFileNode& node)
{
    node.values.status = NodeStatus::lostCommunication;
    node.values.reading.reset();
}

} // namespace

void Collector::pass(Transport& transport, std::chrono::duration<double> interval)
{
    Bmc bmc(transport);
    const RepositoryStamp stamp = stampOfRepository(bmc);
    if (stamp != repository_) {
        readRecords(bmc);
        repository_ = stamp;
    } else {
        const double share = std::min(interval / thresholdPeriod, 1.0);
        const auto due = std::ceil(static_cast<double>(sensors_.size()) * share);
        for (auto count = static_cast<std::size_t>(due); count > 0; --count)
            readThresholds(bmc, nextThresholds_++ % sensors_.size());
    }
    for (std::size_t index = 0; index < sensors_.size(); ++index)
        if (!askAgain_.contains(sensors_[index].record.address))
            readSensor(bmc, index);
    readSilentSensors(bmc);
}

void Collector::readRecords(Bmc& bmc)
{
    std::vector<Sensor> sensors;
    for (SensorRecord& record : readRepository(bmc)) {
        const auto kind = kindOf(record);
        const bool belongsToSoftware = (record.address.owner & 1U) != 0;
        if (!kind || (belongsToSoftware && !workarounds_.assumesBmcOwner) ||
            (record.eventType != thresholdEvents && !workarounds_.readsDiscrete))
            continue;
        Sensor sensor{std::move(record), *kind};
        // A sensor without factors would have neither a reading nor a reason why there is none.
        const bool lacksFactors =
            needsFactors(sensor.record.linearization) &&
            !askAgain_.contains(sensor.record.address) &&
            meansUnavailable(
                request(bmc, sensor, CommandCode::getSensorReadingFactors, {0}).front());
        if (!lacksFactors)
            sensors.push_back(std::move(sensor));
    }
    sensors_ = std::move(sensors);
    nodes_.assign(sensors_.size(), {});
    nameNodes();
    for (std::size_t index = 0; index < sensors_.size(); ++index)
        readThresholds(bmc, index);
}

void Collector::nameNodes()
{
    std::map<std::pair<Vorn::NodeLexicon::NodeType, std::string>, int> namesakes;
    std::map<std::string, int> paths;
    for (const Sensor& sensor : sensors_)
        ++namesakes[{sensor.kind.type, sensor.record.name}];
    for (std::size_t index = 0; index < sensors_.size(); ++index) {
        const SensorRecord& record = sensors_[index].record;
        const SensorKind& kind = sensors_[index].kind;
        Vorn::MachineFileNode& node = nodes_[index];
        node.type = kind.type;
        node.sensorType = static_cast<unsigned>(kind.type);
        node.path = "/ipmi/" + textOf(record.address);
        if (const int count = ++paths[node.path]; count > 1)
            node.path.append("#").append(std::to_string(count));
        if (record.name.empty())
            node.description = "Sensor " + textOf(record.address);
        else if (namesakes[{kind.type, record.name}] > 1)
            node.description = entityName(record.entity, record.entityInstance) + " " + record.name;
        else
            node.description = record.name;
        node.values.status = NodeStatus::lostCommunication;
        node.values.baseUnits = kind.baseUnits();
        node.values.possibleStates =
            possibleStates(record.eventType == thresholdEvents ? record.readable | record.reported
                                                               : ThresholdMask());
    }
}

void Collector::readThresholds(Bmc& bmc, std::size_t index)
{
    Sensor& sensor = sensors_[index];
    const SensorRecord& record = sensor.record;
    if (record.access == ThresholdAccess::none || record.eventType != thresholdEvents ||
        askAgain_.contains(record.address))
        return;
    ThresholdMask present =
        record.access == ThresholdAccess::fixed ? record.reported : record.readable;
    RawThresholds raw = record.thresholds;
    if (record.access != ThresholdAccess::fixed) {
        const Bytes answer = request(bmc, sensor, CommandCode::getSensorThresholds);
        if (answer.front() == CompletionCode::success && answer.size() >= 2 + thresholdCount) {
            present = answer[1];
            std::copy_n(answer.begin() + 2, thresholdCount, raw.begin());
        } else if (!meansUnavailable(answer.front()) && sensor.limits != Limits{}) {
            return; // a failure does not replace the known limits by those of the record
        }
    }
    for (std::size_t threshold = 0; threshold < thresholdCount; ++threshold) {
        auto& limit = sensor.limits[threshold];
        limit = present[threshold] ? valueOf(bmc, sensor, raw[threshold]) : std::nullopt;
        limitOf(nodes_[index].values, threshold) = limit;
    }
}

void Collector::readSensor(Bmc& bmc, std::size_t index)
{
    using Kind = SensorAnswer::Kind;
    Sensor& sensor = sensors_[index];
    const SensorAddress& address = sensor.record.address;
    Vorn::NodeReading& values = nodes_[index].values;
    const SensorAnswer answer = interpret(
        request(bmc, sensor, CommandCode::getSensorReading), workarounds_.ignoresScanning);
    const bool hasReading = answer.kind == Kind::reading;
    const bool hasThresholds = sensor.record.eventType == thresholdEvents;
    if (hasReading)
        readBefore_.insert(address);
    sensor.isAbsent = answer.kind == Kind::unavailable && !readBefore_.contains(address);
    values.reading = hasReading ? valueOf(bmc, sensor, answer.raw) : std::nullopt;
    // The time between the pulses of a fan that stands has no reciprocal. Only the alarm
    // distinguishes it from a time that was not measured.
    const bool isSlowFan = hasReading && hasThresholds && isLow(answer.crossed.value_or(0)) &&
                           sensor.kind.type == Vorn::NodeLexicon::NodeType::Tachometer;
    if (!values.reading && isSlowFan && sensor.record.linearization == reciprocal)
        values.reading = 0;
    if (sensor.isAbsent)
        values.status = NodeStatus::noContact;
    else if (answer.kind == Kind::disabled)
        values.status = NodeStatus::disabled;
    else if (!values.reading)
        values.status = NodeStatus::lostCommunication;
    else if (!hasThresholds)
        values.status = NodeStatus::normal; // the bits of a discrete sensor are not thresholds
    else
        values.status =
            statusOf(answer.crossed.value_or(crossedBy(*values.reading, sensor.limits)));
}

std::optional<double> Collector::valueOf(Bmc& bmc, Sensor& sensor, std::uint8_t raw)
{
    const SensorRecord& record = sensor.record;
    Factors factors = record.factors;
    if (needsFactors(record.linearization)) {
        auto known = sensor.factors.find(raw);
        if (known == sensor.factors.end()) {
            constexpr std::size_t factorsAt = 2;
            const Bytes answer = request(bmc, sensor, CommandCode::getSensorReadingFactors, {raw});
            if (answer.front() != CompletionCode::success ||
                answer.size() < factorsAt + factorBytes)
                return std::nullopt;
            const auto bytes = std::span(answer).subspan<factorsAt, factorBytes>();
            known = sensor.factors.emplace(raw, factorsOf(bytes)).first;
        }
        factors = known->second;
    }
    const auto value = convert(raw, record.format, factors, record.linearization);
    const double published = value ? sensor.kind.inBaseUnit(*value) : std::nan("");
    return std::isfinite(published) ? std::optional(published) : std::nullopt;
}

Bytes Collector::request(Bmc& bmc, const Sensor& sensor, CommandCode code, Bytes more)
{
    const SensorAddress& address = sensor.record.address;
    const bool isBmc =
        workarounds_.assumesBmcOwner || (address.owner == bmcOwner && address.channel == 0);
    Bytes data{address.number};
    data.insert(data.end(), more.begin(), more.end());
    try {
        return bmc.ask(
            {{isBmc, address.channel, address.owner, address.lun}, code, std::move(data)});
    } catch (const SilentBmc&) {
        askAgain_.try_emplace(address, Clock::now());
        throw;
    }
}

// Some controllers answer every command but those for a certain sensor. Such a sensor is read after
// the others, where silence loses no other one, and rarely.
void Collector::readSilentSensors(Bmc& bmc)
{
    for (std::size_t index = 0; index < sensors_.size(); ++index) {
        const auto silent = askAgain_.find(sensors_[index].record.address);
        if (silent == askAgain_.end() || silent->second > Clock::now())
            continue;
        try {
            readSensor(bmc, index);
            askAgain_.erase(silent);
        } catch (const SilentBmc&) {
            silent->second = Clock::now() + pauseAfterSilence;
            lose(nodes_[index]);
            return;
        }
    }
}

std::vector<Vorn::MachineFileNode> Collector::presentNodes() const
{
    std::vector<Vorn::MachineFileNode> present;
    for (std::size_t index = 0; index < nodes_.size(); ++index)
        if (!sensors_[index].isAbsent)
            present.push_back(nodes_[index]);
    return present;
}

void Collector::loseAll()
{
    for (Vorn::MachineFileNode& node : nodes_)
        lose(node);
}

} // namespace Ipmi
