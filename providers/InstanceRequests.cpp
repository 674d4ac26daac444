// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "providers/InstanceRequests.h"

#include "factory/BrokerCalls.h"
#include "providers/RequestHandler.h"

#include <cmpimacs.h>

namespace Vorn::SensorProfileProvider {

namespace {

template <typename Object>
void reserve(const RecordClass& served, SensorFactory& factory, std::vector<Object*>& objects)
{
    if (!served.isCap)
        objects.reserve(factory.getNumberOfInstances());
}

// Traces the failure of the factory and the exit; the result stays open.
void giveUp(const HandlerMarks& marks, const FailureLines& lines, const char* text)
{
    marks.failure(text, lines.message);
    marks.exit(lines.exit);
}

// Returns the instance with the key to the object manager. Returns false after it traced that there
// is no such record; the result stays open.
bool returnByKey(const RecordClass& served, const CMPIBroker* broker, const HandlerMarks& marks,
    const FailureLines& lines, const CMPIResult* rslt, const CMPIObjectPath* ref, CMPIString* key,
    const char** properties, CMPIStatus* status)
{
    SensorFactory factory(!served.isCap, served.isCap);
    std::vector<CMPIInstance*> instances;
    reserve(served, factory, instances);
    if ((factory.*served.one)(broker, ref, key, properties, instances, status)) {
        giveUp(marks, lines, served.oneFailed);
        return false;
    }
    returnInstances(rslt, instances);
    return true;
}

// Returns the instance whose object path equals the request's, for a path without the key. The
// factory always harvests sensors, so that such a path never finds capabilities. Returns false
// after it traced that the enumeration failed; the result stays open.
bool returnByPath(const RecordClass& served, const CMPIBroker* broker, const HandlerMarks& marks,
    const FailureLines& lines, const CMPIResult* rslt, const CMPIObjectPath* ref,
    const char** properties, CMPIStatus* status)
{
    SensorFactory factory(true, false);
    std::vector<CMPIInstance*> instances;
    reserve(served, factory, instances);
    if ((factory.*served.instances)(broker, ref, properties, false, instances, status)) {
        giveUp(marks, lines, served.instancesFailed);
        return false;
    }
    returnInstanceAt(rslt, ref, instances, false, status);
    return true;
}

} // namespace

CMPIStatus enumerateInstanceNames(const RecordClass& served, const CMPIBroker* broker,
    const char* function, const EnumerationLines& lines, const CMPIResult* rslt,
    const CMPIObjectPath* ref)
{
    const HandlerMarks marks(served.module, function);
    marks.entry(lines.entry);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    std::vector<CMPIObjectPath*> paths;
    SensorFactory factory(!served.isCap, served.isCap);
    reserve(served, factory, paths);
    if ((factory.*served.paths)(broker, ref, paths, &status)) {
        giveUp(marks, lines.failure, served.pathsFailed);
        return status; // OK and an open, empty result where there are no records
    }
    returnPaths(rslt, ref, paths, &status);
    CMReturnDone(rslt);
    marks.exit(lines.exit);
    return status;
}

CMPIStatus enumerateInstances(const RecordClass& served, const CMPIBroker* broker,
    const char* function, const EnumerationLines& lines, const CMPIResult* rslt,
    const CMPIObjectPath* ref, const char** properties)
{
    const HandlerMarks marks(served.module, function);
    marks.entry(lines.entry);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    std::vector<CMPIInstance*> instances;
    SensorFactory factory(!served.isCap, served.isCap);
    reserve(served, factory, instances);
    if ((factory.*served.instances)(broker, ref, properties, false, instances, &status)) {
        giveUp(marks, lines.failure, served.instancesFailed);
        return status;
    }
    returnInstances(rslt, instances);
    CMReturnDone(rslt);
    marks.exit(lines.exit);
    return status;
}

CMPIStatus getInstance(const RecordClass& served, const CMPIBroker* broker, const char* function,
    const GetInstanceLines& lines, const CMPIResult* rslt, const CMPIObjectPath* ref,
    const char** properties)
{
    const HandlerMarks marks(served.module, function);
    marks.entry(lines.entry);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    if (keyCountOf(ref, &status) == 0) {
        reportFailure(broker, &status, served.provider, noKeyPassed, noKeyPassed);
    } else if (CMPIString* const key = textKey(ref, served.key, &status)) {
        if (!returnByKey(
                served, broker, marks, lines.noSuchKey, rslt, ref, key, properties, &status))
            return status; // OK without an instance when there is no such record
    } else if (!returnByPath(
                   served, broker, marks, lines.enumeration, rslt, ref, properties, &status)) {
        return status;
    }
    CMReturnDone(rslt);
    marks.exit(lines.exit);
    return status;
}

} // namespace Vorn::SensorProfileProvider
