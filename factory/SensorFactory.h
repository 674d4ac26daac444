// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "model/Sensor.h"
#include "model/SensorEnabledLogCap.h"

#include <cmpidt.h>

#include <map>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

// What one request needs to answer: built on the handler's stack, it harvests the machine and
// turns the records into CIM instances and object paths. Nothing outlives it but the CMPI
// objects, which belong to the broker.
//
// Operations return 0 for success, 1 when nothing was found and 2 when the broker failed, and
// write the CMPIStatus they are given only on a failure of the broker. A nothing-found outcome
// leaves it as it was. Parameters named `ref` are the request's object path, of which only the
// namespace is read; `properties` is the client's property list, null for all properties.
//
// Used by one thread. Throws nothing but for lack of memory.
class SensorFactory {
public:
    // Empty; harvests nothing.
    SensorFactory() = default;
    // Harvests sensors, capabilities or both. A failed harvest leaves the factory without
    // them.
    SensorFactory(bool isSen, bool isCap);
    SensorFactory(const SensorFactory&) = delete;
    SensorFactory& operator=(const SensorFactory&) = delete;

    // How many sensors there are, counted by device identifier and cut to 16 bits.
    unsigned short getNumberOfInstances();

    // One instance of ZUMLO_NumericSensor, or null (or a handle-less instance) when the broker
    // made none. An array the broker cannot make ends the build or leaves its property out;
    // the instance built so far is returned and the failure stands in rc, which must be looked
    // at as well. `isObjPath` asks for the keys alone and matters only without a property list.
    // REQUIRES: rc is not null.
    CMPIInstance* makeSensorInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
        Sensor snsr, const char** properties, bool isObjPath, CMPIStatus* rc);

    // Appends one instance for each sensor, ordered by device identifier; entries may be null
    // when the broker made none. Always returns 0.
    int getAllSensorCMPIInstances(const CMPIBroker* broker, const CMPIObjectPath* ref,
        const char** properties, bool isObjPath, std::vector<CMPIInstance*>& instances,
        CMPIStatus* rc);

    // Appends the instance of the sensor with exactly this device identifier. Returns 0 when
    // there is one, otherwise 1.
    int getOneSensorCMPIInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
        CMPIString* key, const char** properties, std::vector<CMPIInstance*>& instances,
        CMPIStatus* rc);

    // Appends the object path of each sensor, ordered by device identifier. Returns 1 when
    // there is no sensor, 2 when a path cannot be made; the paths before it stay.
    int getAllSensorCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
        std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status);

    // One instance of ZUMLO_SensorEnabledLogicalElementCapabilities, or null (or a handle-less
    // instance) when the broker made none. An array the broker cannot make is left out; the
    // failure stands in rc, which must be looked at as well and may be null. `isObjPath` as
    // above.
    CMPIInstance* makeSensorEnabledLogicalElementCapInstance(const CMPIBroker* broker,
        const CMPIObjectPath* ref, SensorEnabledLogCap snsrCap, const char** properties,
        bool isObjPath, CMPIStatus* rc);

    // The same three operations for the capabilities, ordered by instance identifier.
    int getAllSensorEnabledLogicalElementCapCMPIInstances(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char** properties, bool isObjPath,
        std::vector<CMPIInstance*>& instances, CMPIStatus* rc);
    int getOneSensorEnabledLogicalElementCapCMPIInstance(const CMPIBroker* broker,
        const CMPIObjectPath* ref, CMPIString* key, const char** properties,
        std::vector<CMPIInstance*>& instances, CMPIStatus* rc);
    int getAllSensorEnabledLogicalElementCapCMPIObjPaths(const CMPIBroker* broker,
        const CMPIObjectPath* ref, std::vector<CMPIObjectPath*>& objectPaths, CMPIStatus* status);

    // The class at the far end of the association `_RefLeftClass` from an object of the path's
    // class: one of the constants of ClassNames.h, or null when the path's class is no end of
    // that association. Names are compared letter for letter. `_RefRightClass` is only traced;
    // both may be null. rc goes to the broker and is not written otherwise.
    static const char* get_assoc_targetClass_Name(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
        CMPIStatus* rc);

    // A path without keys of that class, in the namespace of the request and on this system.
    // Null when there is no such class or the broker made no path.
    static CMPIObjectPath* get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
        const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
        CMPIStatus* rc);

private:
    void _createSensorMap();
    void _createEnabledLogicalElementCapMap();

    // In harvest order, duplicates included; their content is in the maps once these are made.
    std::vector<Sensor> vectSensor;
    std::vector<SensorEnabledLogCap> vectSensorEnabledLogCap;
    std::map<std::string, Sensor> sensorMap; // by device identifier; the later duplicate wins
    std::map<std::string, SensorEnabledLogCap> sensorEnabledLogCapMap; // by instance identifier
};

} // namespace Vorn::SensorProfileProvider
