// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests for instances of ZUMLO_SensorSystemDevice: each computer system with each sensor.

#include "factory/ClassNames.h"
#include "providers/AssociationWalk.h"
#include "providers/SensorSystemDevice.h"

#include <array>

namespace Vorn::SensorProfileProvider {

using namespace SystemDevice;

namespace {

// The texts of failures in an iteration over all pairs. The runs of blanks are part of them, and so
// are the classes that they name.
struct PairFailures {
    FailureTexts system;
    FailureTexts sensor;
    FailureTexts association;
};

constexpr PairFailures instanceFailures = {
    {"Create CMPIObjectPath            failed.",
        "Create CMPIObjectPath failed for             ComputerSystemClass.", nullptr},
    {"CMPIObjectPath is NULL for Sensor Provider", "CMPIObjectPath is NULL for Sensor Provider",
        nullptr},
    {"Create CMPIObjectPath failed for HostedAccessPoint",
        "Create CMPIObjectPath failed for                     HostedAccessPoint.", nullptr},
};

constexpr PairFailures nameFailures = {
    {"Create CMPIObjectPath failed.", "Create CMPIObjectPath failed for ComputerSystemClass.",
        nullptr},
    {"CMPIObjectPath is NULL for Sensor", "CMPIObjectPath is NULL for Sensor Class", nullptr},
    {"Create CMPIObjectPath failed                     for SensorSystemDeviceProvider.",
        "Create CMPIObjectPath failed for                     SensorSystemDeviceClass.", nullptr},
};

// Where an iteration ended.
enum class WalkEnd { complete, withoutSystemPath, atUpcall, atSystem, atSensors, reported };

// Iterates over all pairs, system by system.
class PairWalk : public AssociationWalk {
public:
    PairWalk(const AssociationRequest& request, const PairFailures& failures,
        const CMPIContext* ctx, const CMPIObjectPath* op, CMPIStatus* status)
        : AssociationWalk(request, op, status), failures_(failures), ctx_(ctx)
    {
    }

    // Calls `visit` with the association's path, without keys, and its references.
    template <typename Visit>
    WalkEnd run(const Visit& visit)
    {
        const CMPIObjectPath* const systemClass = newSystemPath();
        if (!isUsable(systemClass)) {
            request().fail(failures_.system, status());
            return WalkEnd::withoutSystemPath;
        }
        const CMPIEnumeration* const systems =
            CBEnumInstanceNames(request().broker(), ctx_, systemClass, status());
        if (status()->rc != CMPI_RC_OK)
            return WalkEnd::atUpcall;
        WalkEnd end = WalkEnd::complete;
        const bool isWhole = forEachElement(systems, status(), [&](const CMPIData& element) {
            if (const CMPIObjectPath* const system = pathOf(element))
                end = walkSensors(system, visit);
            return end == WalkEnd::complete;
        });
        return isWhole ? end : WalkEnd::atSystem;
    }

private:
    CMPIObjectPath* newSystemPath() const
    {
        const char* const nameSpace = nameSpaceOf(op(), nullptr);
        if (nameSpace == nullptr || request().broker() == nullptr)
            return nullptr;
        return CMNewObjectPath(request().broker(), nameSpace, ComputerSystemClass, status());
    }

    template <typename Visit>
    WalkEnd walkSensors(const CMPIObjectPath* system, const Visit& visit)
    {
        std::vector<CMPIObjectPath*> sensors;
        if (!fetchSensors(sensors))
            return WalkEnd::atSensors;
        for (const CMPIObjectPath* const sensor : sensors) {
            if (!isUsable(sensor)) {
                request().fail(failures_.sensor, status());
                return WalkEnd::reported;
            }
            copyNameSpace(sensor, op(), nullptr);
            copyNameSpace(system, op(), nullptr);
            if (!visitPair(sensor, system, failures_.association, visit))
                return WalkEnd::reported;
        }
        return WalkEnd::complete;
    }

    const PairFailures& failures_;
    const CMPIContext* ctx_;
};

} // namespace

int sensorSystemDeviceCMPIInstances(const CMPIObjectPath* op, const char** properties,
    const CMPIContext* ctx, std::vector<CMPIInstance*>& out)
{
    const AssociationRequest request(served(), broker, "sensorSystemDeviceCMPIInstances");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    PairWalk walk(request, instanceFailures, ctx, op, &status);
    walk.reserve(out);
    std::array<const char*, 3> keys = {"GroupComponent", "PartComponent", nullptr};
    const WalkEnd end =
        walk.run([&](const CMPIObjectPath* association, const References& references) {
            out.push_back(
                newAssociation(request.broker(), association, references, properties, keys.data()));
        });
    // Only these two ends have an exit mark.
    if (end == WalkEnd::complete || end == WalkEnd::withoutSystemPath)
        request.marks().exit();
    return end == WalkEnd::complete ? 0 : 1;
}

CMPIStatus SensorSystemDevice_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext* ctx, const CMPIResult* rslt, const CMPIObjectPath* op)
{
    const AssociationRequest request(served(), broker, "SensorSystemDevice_EnumInstanceNames");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    PairWalk walk(request, nameFailures, ctx, op, &status);
    const WalkEnd end =
        walk.run([&](const CMPIObjectPath* association, const References& references) {
            addReferenceKeys(association, references);
            CMReturnObjectPath(rslt, association);
        });
    if (end == WalkEnd::atUpcall) {
        // An object manager without a provider of computer systems is not a failure here.
        CMSetStatusWithChars(request.broker(), &status, CMPI_RC_OK,
            "CBEnumInstanceNames Failed for the ZUMLO_ComputerSystem");
        return status;
    }
    const bool isAnswered = end == WalkEnd::complete || walk.foundNoSensors();
    if (isAnswered || end == WalkEnd::withoutSystemPath)
        request.marks().exit();
    if (isAnswered)
        CMReturnDone(rslt);
    return status;
}

CMPIStatus SensorSystemDevice_EnumInstances(CMPIInstanceMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties)
{
    const AssociationRequest request(served(), broker, "SensorSystemDevice_EnumInstances");
    return request.enumerateInstances(rslt, [&](std::vector<CMPIInstance*>& instances) {
        return sensorSystemDeviceCMPIInstances(op, properties, ctx, instances);
    });
}

CMPIStatus SensorSystemDevice_GetInstance(CMPIInstanceMI*, const CMPIContext* ctx,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties)
{
    const AssociationRequest request(served(), broker, "SensorSystemDevice_GetInstance");
    return request.getInstance(rslt, op, [&](std::vector<CMPIInstance*>& instances) {
        return sensorSystemDeviceCMPIInstances(op, properties, ctx, instances);
    });
}

} // namespace Vorn::SensorProfileProvider
