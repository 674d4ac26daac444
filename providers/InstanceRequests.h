// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The three requests of a class that has one instance for each record of the factory.

#pragma once

#include "diagnostics/TracedOperation.h"
#include "factory/SensorFactory.h"
#include "providers/TraceLines.h"

#include <cmpidt.h>

#include <vector>

namespace Vorn::SensorProfileProvider {

// The properties of such a class that its requests depend on.
struct RecordClass {
    TraceModule module;
    const char* provider; // the component of broker trace messages
    const char* key;      // names the record by itself
    bool isCap;           // harvests capabilities, otherwise sensors

    decltype(&SensorFactory::getAllSensorCMPIObjPaths) paths;
    decltype(&SensorFactory::getAllSensorCMPIInstances) instances;
    decltype(&SensorFactory::getOneSensorCMPIInstance) one;

    const char* pathsFailed;
    const char* instancesFailed;
    const char* oneFailed;
};

// Each handles one request from its entry to its exit mark. `function` is the name of the handler.
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
