// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_NumericSensor.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "providers/NotSupported.h"
#include "providers/RequestHandler.h"

#include <cmpimacs.h>

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

const CMPIBroker* broker = nullptr;

const std::string loggerSensorProvider = "Nimbrel.SensorProfileProvider";

TraceModule module()
{
    return {loggerSensorProvider, "SensorProvider"};
}

// The instance of one device identifier. False when the handler is to end here: there is no
// such sensor, which has been said in the trace.
bool returnByDeviceID(const HandlerMarks& marks, const CMPIResult* rslt, const CMPIObjectPath* ref,
    CMPIString* deviceID, const char** properties, CMPIStatus* status)
{
    SensorFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    instances.reserve(factory.getNumberOfInstances());
    if (factory.getOneSensorCMPIInstance(broker, ref, deviceID, properties, instances, status)) {
        marks.failure(220, "getOneSensorCMPIInstance failed");
        marks.exit(222);
        return false;
    }
    returnInstances(rslt, instances);
    return true;
}

// The instance whose object path equals the request's, for a path that names no device
// identifier. False as above.
bool returnByPath(const HandlerMarks& marks, const CMPIResult* rslt, const CMPIObjectPath* ref,
    const char** properties, CMPIStatus* status)
{
    SensorFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    instances.reserve(factory.getNumberOfInstances());
    if (factory.getAllSensorCMPIInstances(broker, ref, properties, false, instances, status)) {
        marks.failure(251, "getAllSensorCMPIInstances failed");
        marks.exit(253);
        return false;
    }
    returnInstanceAt(rslt, ref, instances, false, status);
    return true;
}

} // namespace

CMPIStatus Sensor_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt, const CMPIObjectPath* ref)
{
    const HandlerMarks marks(module(), "Sensor_EnumInstanceNames");
    marks.entry(74);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    std::vector<CMPIObjectPath*> paths;
    SensorFactory factory(true, false);
    paths.reserve(factory.getNumberOfInstances());
    if (factory.getAllSensorCMPIObjPaths(broker, ref, paths, &status)) {
        marks.failure(94, "getAllSensorCMPIObjPaths failed");
        marks.exit(96);
        return status; // OK and an open, empty result on a machine without sensors
    }
    returnPaths(rslt, ref, paths, &status);
    CMReturnDone(rslt);
    marks.exit(114);
    return status;
}

CMPIStatus Sensor_EnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties)
{
    const HandlerMarks marks(module(), "Sensor_EnumInstances");
    marks.entry(136);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    std::vector<CMPIInstance*> instances;
    SensorFactory factory(true, false);
    instances.reserve(factory.getNumberOfInstances());
    if (factory.getAllSensorCMPIInstances(broker, ref, properties, false, instances, &status)) {
        marks.failure(155, "getAllSensorCMPIInstances failed");
        marks.exit(157);
        return status;
    }
    returnInstances(rslt, instances);
    CMReturnDone(rslt);
    marks.exit(170);
    return status;
}

CMPIStatus Sensor_GetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties)
{
    const HandlerMarks marks(module(), "Sensor_GetInstance");
    marks.entry(192);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    if (keyCountOf(ref, &status) == 0) {
        reportFailure(broker, &status, SensorProfileProvider, NoKeyPassed, NoKeyPassed);
    } else if (CMPIString* const deviceID = textKey(ref, "DeviceID", &status)) {
        if (!returnByDeviceID(marks, rslt, ref, deviceID, properties, &status))
            return status; // OK without an instance when there is no such sensor
    } else if (!returnByPath(marks, rslt, ref, properties, &status)) {
        return status;
    }
    CMReturnDone(rslt);
    marks.exit(293);
    return status;
}

namespace {

constexpr auto Sensor_Cleanup = cleanUpNothing;
constexpr auto Sensor_CreateInstance = createNotSupported;
constexpr auto Sensor_ModifyInstance = modifyNotSupported;
constexpr auto Sensor_DeleteInstance = deleteNotSupported;
constexpr auto Sensor_ExecQuery = queryNotSupported;

const CMPIInstanceMIFT instMIFT__ = {200, 200, "instanceSensorProfileProvider", Sensor_Cleanup,
    Sensor_EnumInstanceNames, Sensor_EnumInstances, Sensor_GetInstance, Sensor_CreateInstance,
    Sensor_ModifyInstance, Sensor_DeleteInstance, Sensor_ExecQuery};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI* SensorProfileProvider_Create_InstanceMI(
    const CMPIBroker* theBroker, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi = {nullptr, &instMIFT__};
    broker = theBroker;
    return &mi;
}

} // namespace Vorn::SensorProfileProvider
