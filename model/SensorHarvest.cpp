// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorHarvest.h"

#include "diagnostics/ProviderException.h"
#include "model/TraceLines.h"
#include "platform/instrumentation/Instrumentation.h"
#include "platform/logging/PipeSignal.h"

#include <array>
#include <atomic>
#include <exception>
#include <string>
#include <utility>

namespace Vorn::SensorProfileProvider {

namespace {

using NodeLexicon::NodeType;
using NodeLexicon::Properties;

const std::string loggerSensor = "Nimbrel.Sensor";

TraceModule module()
{
    return {loggerSensor, "Sensor"};
}

constexpr std::array<NodeType, 3> harvestedTypes = {
    NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer};

// The state that is requested of every sensor.
constexpr unsigned requestedEnabled = 1;

struct ScaledProperty {
    Properties property;
    bool (Sensor::*set)(double);
    const char* refusal;
};

// The properties in the order in which they are read.
constexpr std::array<ScaledProperty, 7> scaledProperties = {{
    {Properties::Reading, &Sensor::setCurrentReading, "Failed while setting Current Reading"},
    {Properties::LowerNonCritical, &Sensor::setLowerThresholdNonCritical,
        "Failed while setting LowerThresholdNonCritical"},
    {Properties::UpperNonCritical, &Sensor::setUpperThresholdNonCritical,
        "Failed while setting UpperThresholdNonCritical"},
    {Properties::LowerCritical, &Sensor::setLowerThresholdCritical,
        "Failed while setting LowerThresholdCritical"},
    {Properties::UpperCritical, &Sensor::setUpperThresholdCritical,
        "Failed while setting UpperThresholdCritical"},
    {Properties::LowerFatal, &Sensor::setLowerThresholdFatal,
        "Failed while setting LowerThresholdFatal"},
    {Properties::UpperFatal, &Sensor::setUpperThresholdFatal,
        "Failed while setting UpperThresholdFatal"},
}};

void require(bool accepted, const char* refusal)
{
    if (!accepted)
        throw ProviderException(refusal);
}

void setIdentity(Sensor& sensor, const Instrumentation& node)
{
    const std::string path = node.convertPathToString(node.getPathToNode());
    std::string description = node.getNodeDescription();
    std::string deviceID;
    deviceID.reserve(description.size() + 1 + path.size());
    deviceID.append(description).append(1, ':').append(path);
    require(sensor.setDeviceID(std::move(deviceID)), "Failed while setting Device ID");
    require(sensor.setElementName(std::move(description)), "Failed while setting Element Name");
    require(sensor.setSensorType(node.getSensorType()), "Failed while setting Sensor Type");
}

// Leaves the states at their defaults when the node reports no status.
void setStatus(Sensor& sensor, unsigned status)
{
    if (status == 0)
        return;
    require(sensor.setCurrentState(status), "Failed while setting Current State");
    require(sensor.setEnabledState(status), "Failed while setting Enabled State");
    require(sensor.setOperationalStatus(status), "Failed while setting Operational Status");
    require(sensor.setHealthState(status), "Failed while setting Health State");
}

void setProperties(Sensor& sensor, Instrumentation& node, std::vector<unsigned>& possibleStates)
{
    possibleStates.clear();
    if (node.getProperty(Properties::PossibleStates, possibleStates))
        require(sensor.setPossibleStates(possibleStates), "Failed while setting Possible States");

    double number = 0.0;
    for (const ScaledProperty& scaled : scaledProperties)
        if (node.getProperty(scaled.property, number))
            require((sensor.*scaled.set)(number), scaled.refusal);

    unsigned baseUnits = 0;
    if (node.getProperty(Properties::BaseUnits, baseUnits))
        require(sensor.setBaseUnits(baseUnits), "Failed while setting Requested State");
}

void setRecord(Sensor& sensor, Instrumentation& node, std::vector<unsigned>& possibleStates)
{
    setIdentity(sensor, node);
    setStatus(sensor, node.getNodeStatus());
    require(sensor.setRequestedState(requestedEnabled), "Failed while setting Requested State");
    setProperties(sensor, node, possibleStates);
}

// Returns whether there are nodes of the type. All of them are read.
bool harvestType(NodeType type, std::vector<Sensor>& vectSensor)
{
    Instrumentation instrumentation;
    instrumentation.selectNode(type);
    if (!instrumentation)
        return false;
    return !setVector(vectSensor, instrumentation);
}

} // namespace

bool getSensorInstances(std::vector<Sensor>& vectSensor)
{
    const TracedOperation traced(
        module(), "getSensorInstances", [&] { return parameterList(" vectSensor=", &vectSensor); });
    traced.entering(HarvestLines::getSensorInstances.entry);
    // The number of sensors at the last time. Most machines have as many again, so that the records
    // need not be moved.
    static std::atomic<std::size_t> expected = 0;
    bool nothing = true;
    for (const NodeType type : harvestedTypes) {
        try {
            vectSensor.reserve(expected);
            if (harvestType(type, vectSensor))
                nothing = false;
        } catch (const std::exception& error) {
            // The text printed is deliberately the generic one of the base class.
            RynLog::reportToStandardError(std::string(error.std::exception::what()) + '\n');
        }
    }
    expected = vectSensor.size();
    traced.exiting(HarvestLines::getSensorInstances.exit);
    return nothing;
}

bool setVector(std::vector<Sensor>& vectSensor, Vorn::Instrumentation& instrumentation)
{
    const TracedOperation traced(module(), "setVector", [&] {
        return parameterList(" vectSensor=", &vectSensor, " instrumentation=", &instrumentation);
    });
    traced.entering(HarvestLines::setVector.entry);
    std::vector<unsigned> possibleStates;
    for (; instrumentation; ++instrumentation) {
        Sensor& sensor = vectSensor.emplace_back();
        try {
            setRecord(sensor, instrumentation, possibleStates);
        } catch (...) {
            vectSensor.pop_back();
            throw;
        }
    }
    traced.exiting(HarvestLines::setVector.exit);
    return false;
}

bool getSensorEnabledLogCapInstances(std::vector<SensorEnabledLogCap>& vectSensorEnabledLogCap)
{
    const TracedOperation traced(module(), "getSensorEnabledLogCapInstances",
        [&] { return parameterList(" vectSensorEnabledLogCap=", &vectSensorEnabledLogCap); });
    traced.entering(HarvestLines::getSensorEnabledLogCapInstances.entry);
    try {
        vectSensorEnabledLogCap.emplace_back();
    } catch (const std::exception& error) {
        RynLog::reportToStandardError(std::string(error.what()) + '\n');
        traced.exiting(HarvestLines::getSensorEnabledLogCapInstancesFailed);
        return true;
    }
    traced.exiting(HarvestLines::getSensorEnabledLogCapInstances.exit);
    return false;
}

} // namespace Vorn::SensorProfileProvider
