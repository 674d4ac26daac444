// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The three reading requests of a class whose instances come from the factory's records, one
// for each record.

#pragma once

#include "diagnostics/TracedOperation.h"
#include "factory/SensorFactory.h"
#include "providers/TraceLines.h"

#include <cmpidt.h>

#include <vector>

namespace Vorn::SensorProfileProvider {

// What one such class differs in from another.
struct RecordClass {
    TraceModule module;
    const char* provider; // the component of broker trace messages
    const char* key;      // names the record by itself
    bool isCap;           // harvests capabilities, otherwise sensors
    bool reservesForEachSensor;

    decltype(&SensorFactory::getAllSensorCMPIObjPaths) paths;
    decltype(&SensorFactory::getAllSensorCMPIInstances) instances;
    decltype(&SensorFactory::getOneSensorCMPIInstance) one;

    const char* pathsFailed;
    const char* instancesFailed;
    const char* oneFailed;
};

// Each answers one request from its entry to its exit mark. `function` is the handler's name.
CMPIStatus enumerateInstanceNames(const RecordClass& served, const CMPIBroker* broker,
    const char* function, const EnumerationLines& lines, const CMPIResult* rslt,
    const CMPIObjectPath* ref);
CMPIStatus enumerateInstances(const RecordClass& served, const CMPIBroker* broker,
    const char* function, const EnumerationLines& lines, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties);
CMPIStatus getInstance(const RecordClass& served, const CMPIBroker* broker, const char* function,
    const GetInstanceLines& lines, const CMPIResult* rslt, const CMPIObjectPath* ref,
    const char** properties);

} // namespace Vorn::SensorProfileProvider
