// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerates sensors as CIM instances and object paths, ordered by device identifier.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/PropertySelection.h"
#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

namespace Vorn::SensorProfileProvider {

int SensorFactory::getAllSensorCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
    const char** properties, bool isObjPath, std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    const TracedOperation traced(factoryModule(), "getAllSensorCMPIInstances", [&] {
        // The last label has no leading blank.
        return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
            " isObjPath=", isObjPath, " instances=", &instances, "rc=", rc);
    });
    traced.entering();
    PropertySelection selection(properties, isObjPath);
    Sensor copy; // keeps its memory from record to record
    for (const Sensor* const sensor : sensorMap.inOrder()) {
        copy = *sensor;
        instances.push_back(makeInstance(broker, ref, copy, properties, selection, isObjPath, rc));
    }
    traced.exiting();
    return 0;
}

int SensorFactory::getOneSensorCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
    CMPIString* key, const char** properties, std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    const TracedOperation traced(factoryModule(), "getOneSensorCMPIInstance", [&] {
        return parameterList(" broker=", broker, " ref=", ref, " key=", key,
            " properties=", properties, " instances=", &instances, " rc=", rc);
    });
    traced.entering();
    const char* const deviceID = charactersOf(key, rc);
    const Sensor* const found = deviceID ? sensorMap.find(deviceID) : nullptr;
    if (found == nullptr)
        return 1; // without an exiting line
    instances.push_back(makeSensorInstance(broker, ref, *found, properties, false, rc));
    traced.exiting();
    return 0;
}

int SensorFactory::getAllSensorCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
    std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status)
{
    const TracedOperation traced(factoryModule(), "getAllSensorCMPIObjPaths", [&] {
        return parameterList(
            " broker=", broker, " ref=", ref, " objectPaths=", &objectPaths, " status=", status);
    });
    traced.entering();
    if (sensorMap.size() == 0) {
        traceToBroker(broker, CMPI_LEV_INFO, SensorProfileProvider, "***No instance found***");
        traced.exiting();
        return 1;
    }
    for (const Sensor* const sensor : sensorMap.inOrder()) {
        CMPIObjectPath* const path = newPath(broker, ref, SensorClass, texts.systemName(), status);
        if (path == nullptr) {
            reportFailure(broker, status, SensorProfileProvider, "Create CMPIObjectPath failed.",
                "Create CMPIObjectPath                     failed for RecordLogClass.");
            traced.exiting();
            return 2;
        }
        addTextKey(path, "CreationClassName", SensorClass);
        addTextKey(path, "DeviceID", sensor->getDeviceID().c_str());
        addTextKey(path, "SystemCreationClassName", ComputerSystemClass);
        addTextKey(path, "SystemName", texts.systemName().c_str());
        objectPaths.push_back(path);
    }
    traced.exiting();
    return 0;
}

} // namespace Vorn::SensorProfileProvider
