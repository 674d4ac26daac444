// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerates capabilities as CIM instances and object paths, ordered by instance identifier.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

namespace Vorn::SensorProfileProvider {

int SensorFactory::getAllSensorEnabledLogicalElementCapCMPIInstances(const CMPIBroker* broker,
    const CMPIObjectPath* ref, const char** properties, bool isObjPath,
    std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    const TracedOperation traced(
        factoryModule(), "getAllSensorEnabledLogicalElementCapCMPIInstances", [&] {
            return parameterList(" broker=", broker, " ref=", ref, " properties=", properties,
                " isObjPath=", isObjPath, " instances=", &instances, " rc=", rc);
        });
    traced.entering(FactoryLines::getAllCapabilitiesInstances.entry);
    for (const auto& [instanceID, capabilities] : sensorEnabledLogCapMap)
        instances.push_back(makeSensorEnabledLogicalElementCapInstance(
            broker, ref, capabilities, properties, isObjPath, rc));
    traced.exiting(FactoryLines::getAllCapabilitiesInstances.exit);
    return 0;
}

int SensorFactory::getOneSensorEnabledLogicalElementCapCMPIInstance(const CMPIBroker* broker,
    const CMPIObjectPath* ref, CMPIString* key, const char** properties,
    std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    const TracedOperation traced(
        factoryModule(), "getOneSensorEnabledLogicalElementCapCMPIInstance", [&] {
            return parameterList(" broker=", broker, " ref=", ref, " key=", key,
                " properties=", properties, " instances=", &instances, " rc=", rc);
        });
    traced.entering(FactoryLines::getOneCapabilitiesInstance.entry);
    const char* const instanceID = charactersOf(key, nullptr); // an unknown key leaves rc as it is
    const auto found =
        instanceID ? sensorEnabledLogCapMap.find(instanceID) : sensorEnabledLogCapMap.end();
    if (found == sensorEnabledLogCapMap.end())
        return 1; // without an exiting line
    instances.push_back(makeSensorEnabledLogicalElementCapInstance(
        broker, ref, found->second, properties, false, rc));
    traced.exiting(FactoryLines::getOneCapabilitiesInstance.exit);
    return 0;
}

int SensorFactory::getAllSensorEnabledLogicalElementCapCMPIObjPaths(const CMPIBroker* broker,
    const CMPIObjectPath* ref, std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status)
{
    const TracedOperation traced(
        factoryModule(), "getAllSensorEnabledLogicalElementCapCMPIObjPaths", [&] {
            return parameterList(" broker=", broker, " ref=", ref, " objectPaths=", &objectPaths,
                " status=", status);
        });
    traced.entering(FactoryLines::getAllCapabilitiesPaths.entry);
    if (sensorEnabledLogCapMap.empty()) {
        traceToBroker(broker, CMPI_LEV_WARNING, SensorEnabledLogicalElementCapabilitiesProvider,
            "***No instance found***");
        traced.exiting(FactoryLines::getAllCapabilitiesPathsOfNone);
        return 1;
    }
    for (auto [instanceID, capabilities] : sensorEnabledLogCapMap) {
        CMPIObjectPath* const path =
            newPath(broker, ref, SensorEnabledLogicalElementCapClass, texts.systemName(), status);
        if (path == nullptr) {
            reportFailure(broker, status, SensorEnabledLogicalElementCapabilitiesProvider,
                "Create CMPIObjectPath failed",
                "Create CMPIObjectPath failed for                     "
                "SensorEnabledLogicalElementCapabilities class");
            return 2; // without an exiting line
        }
        addTextKey(path, "InstanceID", capabilities.getInstanceID().c_str());
        objectPaths.push_back(path);
    }
    traced.exiting(FactoryLines::getAllCapabilitiesPaths.exit);
    return 0;
}

} // namespace Vorn::SensorProfileProvider
