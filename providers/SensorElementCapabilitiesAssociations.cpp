// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests along ZUMLO_SensorElementCapabilities. Every sensor is associated with all capabilities,
// so the keys of the source are not read.

#include "factory/ClassNames.h"
#include "providers/AssociationRequests.h"
#include "providers/SensorElementCapabilities.h"

namespace Vorn::SensorProfileProvider {

using namespace ElementCapabilities;

namespace {

// Appends the paths of all objects of the target's class, if this provider leads to it.
FetchFailure fetchPaths(const AssociationRequest& request, SensorFactory& factory,
    const CMPIObjectPath* op, const CMPIObjectPath* target, bool leadsToSensors,
    std::vector<CMPIObjectPath*>& paths, CMPIStatus* status)
{
    if (leadsToSensors)
        return request.fetchSensorPaths(factory, op, paths, status);
    if (isExactlyOfClass(target, SensorEnabledLogicalElementCapClass) &&
        factory.getAllSensorEnabledLogicalElementCapCMPIObjPaths(
            request.broker(), op, paths, status))
        return {capabilitiesPathsFailed};
    return {nullptr};
}

// Appends the objects themselves. Both failures have the same text.
FetchFailure fetchInstances(const AssociationRequest& request, SensorFactory& factory,
    const CMPIObjectPath* op, const CMPIObjectPath* target, const char** properties,
    std::vector<CMPIInstance*>& instances, CMPIStatus* status)
{
    int result = 0;
    if (isExactlyOfClass(target, SensorClass))
        result = factory.getAllSensorCMPIInstances(
            request.broker(), op, properties, false, instances, status);
    else if (isExactlyOfClass(target, SensorEnabledLogicalElementCapClass))
        result = factory.getAllSensorEnabledLogicalElementCapCMPIInstances(
            request.broker(), op, properties, false, instances, status);
    return {result ? sensorsFailed : nullptr};
}

// `withoutTarget` is the failure text for a source whose class has no far end.
CMPIStatus associators(const char* function, ResultKind kind, const CMPIResult* rslt,
    const CMPIObjectPath* op, const char* assocClass, const char* resultClass,
    const char** properties, const char* withoutTarget)
{
    const AssociationRequest request(served(), broker, function);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    SensorFactory factory(true, true);
    std::vector<CMPIInstance*> instances;
    std::vector<CMPIObjectPath*> paths;
    const bool wantsInstances = kind == ResultKind::instances;
    const unsigned short count = factory.getNumberOfInstances();
    wantsInstances ? instances.reserve(count) : paths.reserve(count);
    const CMPIObjectPath* const target =
        SensorFactory::get_assoc_targetClass_ObjectPath(request.broker(), op,
            namedOrOwn(assocClass, SensorElementCapabilitiesClass), resultClass, &status);
    if (!isUsable(target)) {
        request.failWithoutTarget(withoutTarget, &status);
        return status;
    }
    const FetchFailure failure =
        wantsInstances
            ? fetchInstances(request, factory, op, target, properties, instances, &status)
            : fetchPaths(request, factory, op, target, isExactlyOfClass(target, SensorClass), paths,
                  &status);
    if (failure.text != nullptr) {
        request.marks().failure(failure.text);
    } else {
        returnInstances(rslt, instances);
        returnPaths(rslt, op, paths, nullptr);
    }
    request.marks().exit();
    return status;
}

CMPIStatus references(const char* function, ResultKind kind, const CMPIResult* rslt,
    const CMPIObjectPath* op, const char* withoutTarget)
{
    const AssociationRequest request(served(), broker, function);
    return request.references(kind, rslt, op, withoutTarget,
        [&](SensorFactory& factory, const CMPIObjectPath* target, bool leadsToSensors,
            std::vector<CMPIObjectPath*>& farEnds, CMPIStatus* status) {
            return fetchPaths(request, factory, op, target, leadsToSensors, farEnds, status);
        });
}

} // namespace

CMPIStatus SensorElementCapabilities_Associators(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*, const char** properties)
{
    return associators("SensorElementCapabilities_Associators", ResultKind::instances, rslt, op,
        assocClass, resultClass, properties, "Object Path is NULL in Associators");
}

CMPIStatus SensorElementCapabilities_AssociatorNames(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*)
{
    return associators("SensorElementCapabilities_AssociatorNames", ResultKind::paths, rslt, op,
        assocClass, resultClass, nullptr, "Object Path is NULL in AssociatorsNames");
}

CMPIStatus SensorElementCapabilities_References(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*, const char**)
{
    return references("SensorElementCapabilities_References", ResultKind::instances, rslt, op,
        "Object Path is NULL in References");
}

CMPIStatus SensorElementCapabilities_ReferenceNames(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*)
{
    return references("SensorElementCapabilities_ReferenceNames", ResultKind::paths, rslt, op,
        "Object Path is NULL in ReferenceNames");
}

} // namespace Vorn::SensorProfileProvider
