// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "factory/RequestTexts.h"
#include "model/Sensor.h"
#include "model/SensorEnabledLogCap.h"
#include "model/SensorIndex.h"

#include <cmpidt.h>

#include <map>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

class PropertySelection;

// Harvests the machine for one request and converts the records into CIM instances and object
// paths. A handler creates it on its stack. The CMPI objects belong to the broker and outlive it.
//
// Operations return 0 on success, 1 when nothing was found and 2 when the broker failed. They set
// the CMPIStatus only when the broker failed. `ref` is the request's object path, of which only
// the namespace is read; `properties` is the client's property list, null for all properties.
//
// For one thread. Operations throw only std::bad_alloc.
class SensorFactory {
public:
    // Creates an empty factory without a harvest.
    SensorFactory() = default;
    // Harvests sensors, capabilities or both; after a failed harvest there are none.
    SensorFactory(bool isSen, bool isCap);
    SensorFactory(const SensorFactory&) = delete;
    SensorFactory& operator=(const SensorFactory&) = delete;

    // Returns the name of the system, which is the host of the paths that the factory makes.
    const std::string& systemName() const { return texts.systemName(); }

    // Returns the number of device identifiers, truncated to 16 bits.
    unsigned short getNumberOfInstances();

    // Returns an instance of ZUMLO_NumericSensor, or null (or an instance without a handle) when
    // the broker made none. When the broker cannot make an array, the build ends or omits its
    // property; the partial instance is returned and rc holds the failure, so callers check rc
    // too. `isObjPath` selects the keys alone and matters only without a property list.
    // REQUIRES: rc is not null.
    CMPIInstance* makeSensorInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
        Sensor snsr, const char** properties, bool isObjPath, CMPIStatus* rc);

    // Appends one instance for each sensor, ordered by device identifier; an entry is null where
    // the broker made none. Returns 0.
    int getAllSensorCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
        const char** properties, bool isObjPath, std::vector<CMPIInstance*>& instances,
        CMPIStatus* rc);

    // Appends the instance of the sensor with exactly this device identifier. Returns 0, or 1 when
    // there is none.
    int getOneSensorCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
        CMPIString* key, const char** properties, std::vector<CMPIInstance*>& instances,
        CMPIStatus* rc);

    // Appends the object path of each sensor, ordered by device identifier. Returns 1 when
    // there is no sensor, 2 when a path cannot be made; the paths before it stay.
    int getAllSensorCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
        std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status);

    // Returns an instance of ZUMLO_SensorEnabledLogicalElementCapabilities, or null (or an instance
    // without a handle) when the broker made none. A property whose array cannot be made is
    // omitted, with the failure in rc, which may be null. `isObjPath` selects the keys alone and
    // matters only without a property list.
    CMPIInstance* makeSensorEnabledLogicalElementCapInstance(const CMPIBroker* broker,
        const CMPIObjectPath* ref, SensorEnabledLogCap snsrCap, const char** properties,
        bool isObjPath, CMPIStatus* rc);

    // These do the same for capabilities, ordered by instance identifier.
    int getAllSensorEnabledLogicalElementCapCMPIInstances(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char** properties, bool isObjPath,
        std::vector<CMPIInstance*>& instances, CMPIStatus* rc);
    int getOneSensorEnabledLogicalElementCapCMPIInstance(const CMPIBroker* broker,
        const CMPIObjectPath* ref, CMPIString* key, const char** properties,
        std::vector<CMPIInstance*>& instances, CMPIStatus* rc);
    int getAllSensorEnabledLogicalElementCapCMPIObjPaths(const CMPIBroker* broker,
        const CMPIObjectPath* ref, std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status);

    // Returns the class at the far end of the association `_RefLeftClass` from an object of the
    // path's class: a constant of ClassNames.h, or null when that class is no end of the
    // association. Case matters. `_RefRightClass` is only traced; both may be null. rc is passed
    // on to the broker and not written otherwise.
    static const char* get_assoc_targetClass_Name(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
        CMPIStatus* rc);

    // Returns a path of that class without keys, in the namespace of the request and with this
    // system as host, or null when there is no such class or the broker made no path.
    static CMPIObjectPath* get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
        CMPIStatus* rc);

private:
    void _createSensorMap();
    void _createEnabledLogicalElementCapMap();
    // Makes an instance as makeSensorInstance() does, and changes the record. The selection is that
    // of the properties for all instances of the request.
    CMPIInstance* makeInstance(const CMPIBroker* broker, const CMPIObjectPath* ref, Sensor& snsr,
        const char** properties, PropertySelection& selection, bool isObjPath, CMPIStatus* rc);

    const RequestTexts texts;

    std::vector<Sensor> vectSensor; // in the order of the harvest, with duplicates
    std::vector<SensorEnabledLogCap> vectSensorEnabledLogCap;

    SensorIndex sensorMap; // of the records in vectSensor
    std::map<std::string, SensorEnabledLogCap> sensorEnabledLogCapMap; // by instance identifier
};

} // namespace Vorn::SensorProfileProvider
