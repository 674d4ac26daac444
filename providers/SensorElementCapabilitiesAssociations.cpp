// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What ZUMLO_SensorElementCapabilities leads to. Each sensor has all capabilities and all
// sensors have each of them: the source's keys do not matter.

#include "factory/ClassNames.h"
#include "providers/AssociationRequests.h"
#include "providers/SensorElementCapabilities.h"

namespace Vorn::SensorProfileProvider {

using namespace ElementCapabilities;

namespace {

constexpr const char* SensorsFailed = "getAllSensorCMPIInstances failed";
constexpr const char* SensorPathsFailed = "getAllSensorCMPIObjPaths failed";
constexpr const char* CapabilitiesPathsFailed =
    "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed";

// The text of a failed fetch; null when it did not fail.
using Failure = const char*;

// The paths of all objects of the target's class; none where this provider knows no such class.
Failure fetchPaths(SensorFactory& factory, const CMPIObjectPath* op, const CMPIObjectPath* target,
    bool leadsToSensors, std::vector<CMPIObjectPath*>& paths, CMPIStatus* status)
{
    if (leadsToSensors)
        return factory.getAllSensorCMPIObjPaths(broker, op, paths, status) ? SensorPathsFailed
                                                                           : nullptr;
    if (isOfClass(target, SensorEnabledLogicalElementCapClass, status))
        return factory.getAllSensorEnabledLogicalElementCapCMPIObjPaths(broker, op, paths, status)
                   ? CapabilitiesPathsFailed
                   : nullptr;
    return nullptr;
}

// The same for the objects themselves. Both failures are reported alike.
Failure fetchInstances(SensorFactory& factory, const CMPIObjectPath* op,
    const CMPIObjectPath* target, const char** properties, std::vector<CMPIInstance*>& instances,
    CMPIStatus* status)
{
    int result = 0;
    if (isOfClass(target, SensorClass, status))
        result =
            factory.getAllSensorCMPIInstances(broker, op, properties, false, instances, status);
    else if (isOfClass(target, SensorEnabledLogicalElementCapClass, status))
        result = factory.getAllSensorEnabledLogicalElementCapCMPIInstances(
            broker, op, properties, false, instances, status);
    return result ? SensorsFailed : nullptr;
}

CMPIStatus references(const char* function, Answer answer, const CMPIResult* rslt,
    const CMPIObjectPath* op, const char* withoutTarget)
{
    const AssociationRequest request(served(), broker, function);
    return request.references(answer, rslt, op, withoutTarget,
        [op](SensorFactory& factory, const CMPIObjectPath* target, bool leadsToSensors,
            std::vector<CMPIObjectPath*>& farEnds, CMPIStatus* status) {
            return FetchFailure{fetchPaths(factory, op, target, leadsToSensors, farEnds, status)};
        });
}

} // namespace

CMPIStatus SensorElementCapabilities_Associators(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*, const char** properties)
{
    const AssociationRequest request(served(), broker, "SensorElementCapabilities_Associators");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    SensorFactory factory(true, true);
    std::vector<CMPIInstance*> instances;
    instances.reserve(factory.getNumberOfInstances());
    const CMPIObjectPath* const target = SensorFactory::get_assoc_targetClass_ObjectPath(
        broker, op, namedOrOwn(assocClass, SensorElementCapabilitiesClass), resultClass, &status);
    if (!isUsable(target)) {
        request.failWithoutTarget("Object Path is NULL in Associators", &status);
        return status;
    }
    if (const Failure failure = fetchInstances(factory, op, target, properties, instances, &status))
        request.marks().failure(failure);
    else
        returnInstances(rslt, instances);
    request.marks().exit();
    return status;
}

CMPIStatus SensorElementCapabilities_AssociatorNames(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*)
{
    const AssociationRequest request(served(), broker, "SensorElementCapabilities_AssociatorNames");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    SensorFactory factory(true, true);
    std::vector<CMPIObjectPath*> paths;
    paths.reserve(factory.getNumberOfInstances());
    const CMPIObjectPath* const target = SensorFactory::get_assoc_targetClass_ObjectPath(
        broker, op, namedOrOwn(assocClass, SensorElementCapabilitiesClass), resultClass, &status);
    if (!isUsable(target)) {
        request.failWithoutTarget("Object Path is NULL in AssociatorsNames", &status);
        return status;
    }
    const bool leadsToSensors = isOfClass(target, SensorClass, &status);
    if (const Failure failure = fetchPaths(factory, op, target, leadsToSensors, paths, &status))
        request.marks().failure(failure);
    else
        returnPaths(rslt, op, paths, &status);
    request.marks().exit();
    return status;
}

CMPIStatus SensorElementCapabilities_References(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*, const char**)
{
    return references("SensorElementCapabilities_References", Answer::instances, rslt, op,
        "Object Path is NULL in References");
}

CMPIStatus SensorElementCapabilities_ReferenceNames(CMPIAssociationMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*)
{
    return references("SensorElementCapabilities_ReferenceNames", Answer::paths, rslt, op,
        "Object Path is NULL in ReferenceNames");
}

} // namespace Vorn::SensorProfileProvider
