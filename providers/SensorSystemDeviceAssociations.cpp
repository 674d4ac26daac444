// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests along ZUMLO_SensorSystemDevice. Every computer system is associated with all sensors, so
// the keys of the source are not read. No request closes its result.

#include "factory/ClassNames.h"
#include "platform/utilities/ProviderUtilities.h"
#include "providers/AssociationRequests.h"
#include "providers/SensorSystemDevice.h"

namespace Vorn::SensorProfileProvider {

using namespace SystemDevice;

namespace {

constexpr const char* upcallFailed = "Call to CBEnumInstances of target Class Failed.";

// Returns whether the result class of a request is absent, the class or its standard superclass.
bool isIncluded(const char* resultClass, const char* className, const char* standardClass)
{
    return resultClass == nullptr || isSameName(resultClass, className) ||
           isSameName(resultClass, standardClass);
}

// Returns the objects of the target's class that an up-call finds. Returns false when the up-call
// fails; a failure while its enumeration is read is only set in the status.
bool returnSystems(const AssociationRequest& request, ResultKind kind, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* target, CMPIStatus* status)
{
    const bool wantsInstances = kind == ResultKind::instances;
    const CMPIEnumeration* const systems =
        wantsInstances ? CBEnumInstances(request.broker(), ctx, target, nullptr, status)
                       : CBEnumInstanceNames(request.broker(), ctx, target, status);
    if (status->rc != CMPI_RC_OK)
        return false;
    forEachElement(systems, status, [&](const CMPIData& element) {
        const CMPIInstance* const instance = wantsInstances ? instanceOf(element) : nullptr;
        const CMPIObjectPath* const path = wantsInstances ? nullptr : pathOf(element);
        if (instance != nullptr)
            CMReturnInstance(rslt, instance);
        else if (path != nullptr)
            CMReturnObjectPath(rslt, path);
        return true;
    });
    return true;
}

// Returns the sensors to the object manager.
FetchFailure returnSensors(const AssociationRequest& request, ResultKind kind,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties,
    SensorFactory& factory, CMPIStatus* status)
{
    if (kind == ResultKind::instances) {
        std::vector<CMPIInstance*> instances;
        instances.reserve(factory.getNumberOfInstances());
        if (factory.getAllSensorCMPIInstances(
                request.broker(), op, properties, false, instances, status))
            return {sensorsFailed};
        returnInstances(rslt, instances);
        return {nullptr};
    }
    std::vector<CMPIObjectPath*> paths;
    paths.reserve(factory.getNumberOfInstances());
    const FetchFailure failure = request.fetchSensorPaths(factory, op, paths, status);
    if (failure.text == nullptr)
        returnPaths(rslt, op, paths, nullptr);
    return failure;
}

CMPIStatus associators(const char* function, ResultKind kind, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char** properties)
{
    constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};
    const AssociationRequest request(served(), broker, function);
    CMPIStatus status = ok;
    SensorFactory factory(true, false);
    const CMPIObjectPath* const target =
        SensorFactory::get_assoc_targetClass_ObjectPath(request.broker(), op,
            namedOrOwn(assocClass, SensorSystemDeviceClass), resultClass, &status);
    if (!isUsable(target)) {
        request.marks().exit();
        return ok; // another provider's source or association
    }
    if (isExactlyOfClass(target, ComputerSystemClass)) {
        if (!isIncluded(resultClass, ComputerSystemClass, "CIM_ComputerSystem"))
            return ok; // without an exit mark
        if (!returnSystems(request, kind, ctx, rslt, target, &status)) {
            request.marks().failure(upcallFailed);
            return status; // without an exit mark
        }
    } else if (isExactlyOfClass(target, SensorClass)) {
        if (!isIncluded(resultClass, SensorClass, "CIM_NumericSensor"))
            return ok; // without an exit mark
        const FetchFailure failure =
            returnSensors(request, kind, rslt, op, properties, factory, &status);
        if (failure.text != nullptr)
            request.marks().failure(failure.text);
    }
    request.marks().exit();
    return status;
}

// Appends the far ends of the source's associations. After a failed up-call there is no exit mark,
// as in requests for associated objects.
FetchFailure fetchFarEnds(const AssociationRequest& request, const CMPIContext* ctx,
    const CMPIObjectPath* op, const CMPIObjectPath* target, bool leadsToSensors,
    SensorFactory& factory, std::vector<CMPIObjectPath*>& farEnds, CMPIStatus* status)
{
    if (leadsToSensors)
        return request.fetchSensorPaths(factory, op, farEnds, status);
    if (!isExactlyOfClass(target, ComputerSystemClass))
        return {nullptr};
    const CMPIEnumeration* const systems =
        CBEnumInstanceNames(request.broker(), ctx, target, status);
    const bool isWhole =
        status->rc == CMPI_RC_OK && forEachElement(systems, status, [&](const CMPIData& element) {
            if (CMPIObjectPath* const system = pathOf(element))
                farEnds.push_back(system);
            return true;
        });
    return {isWhole ? nullptr : upcallFailed, isWhole};
}

CMPIStatus references(const char* function, ResultKind kind, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* withoutTarget)
{
    const AssociationRequest request(served(), broker, function);
    return request.references(kind, rslt, op, withoutTarget,
        [&](SensorFactory& factory, const CMPIObjectPath* target, bool leadsToSensors,
            std::vector<CMPIObjectPath*>& farEnds, CMPIStatus* status) {
            return fetchFarEnds(request, ctx, op, target, leadsToSensors, factory, farEnds, status);
        });
}

} // namespace

CMPIStatus SensorSystemDevice_Associators(CMPIAssociationMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*, const char** properties)
{
    return associators("SensorSystemDevice_Associators", ResultKind::instances, ctx, rslt, op,
        assocClass, resultClass, properties);
}

CMPIStatus SensorSystemDevice_AssociatorNames(CMPIAssociationMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char* assocClass,
    const char* resultClass, const char*, const char*)
{
    return associators("SensorSystemDevice_AssociatorNames", ResultKind::paths, ctx, rslt, op,
        assocClass, resultClass, nullptr);
}

CMPIStatus SensorSystemDevice_References(CMPIAssociationMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*, const char**)
{
    return references("SensorSystemDevice_References", ResultKind::instances, ctx, rslt, op,
        "Object Path is NULL in References");
}

CMPIStatus SensorSystemDevice_ReferenceNames(CMPIAssociationMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char*, const char*)
{
    return references("SensorSystemDevice_ReferenceNames", ResultKind::paths, ctx, rslt, op,
        "Object Path is NULL in ReferenceNames");
}

} // namespace Vorn::SensorProfileProvider
