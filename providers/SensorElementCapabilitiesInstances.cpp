// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests for instances of ZUMLO_SensorElementCapabilities: each sensor with each capabilities
// instance.

#include "factory/ClassNames.h"
#include "providers/AssociationWalk.h"
#include "providers/SensorElementCapabilities.h"

#include <array>

namespace Vorn::SensorProfileProvider {

using namespace ElementCapabilities;

namespace {

// The texts of failures in an iteration over all pairs. The runs of blanks are part of them.
struct PairFailures {
    FailureTexts sensor;
    FailureTexts capabilities;
    FailureTexts association;
};

constexpr PairFailures instanceFailures = {
    {"CMPIObjectPath is                 NULL for Sensor", "CMPIObjectPath is NULL for Sensor",
        "CMPIObjectPath is NULL for Sensor"},
    {"CMPIObjectPath is                     NULL for EnabledLogicalElementCap",
        "CMPIObjectPath is NULL for EnabledLogicalElementCap",
        "CMPIObjectPath is NULL for EnabledLogicalElementCap"},
    {"Create CMPIObjectPath failed for ElementCapabilities",
        "Create CMPIObjectPath failed for ElementCapabilities.",
        "Create CMPIObjectPath failed for ElementCapabilities"},
};

constexpr PairFailures nameFailures = {
    {"CMPIObjectPath is NULL for Sensor class", "CMPIObjectPath is NULL for Sensor class",
        "CMPIObjectPath is NULL for Sensor class"},
    {"CMPIObjectPath is                     NULL for SensorEnabledLogicalElementCap",
        "CMPIObjectPath is NULL for                     EnabledLogicalElementCap",
        "CMPIObjectPath is                     NULL for SensorEnabledLogicalElementCap"},
    {"Create CMPIObjectPath failed                     for ElementCapabilities",
        "Create CMPIObjectPath failed                     for ElementCapabilities.",
        "Create CMPIObjectPath failed                     for ElementCapabilities"},
};

// Where an iteration ended.
enum class WalkEnd { complete, atSensors, atCapabilities, reported };

// Iterates over all pairs, sensor by sensor.
class PairWalk : public AssociationWalk {
public:
    PairWalk(const AssociationRequest& request, const PairFailures& failures,
        const CMPIObjectPath* op, CMPIStatus* status)
        : AssociationWalk(request, op, status), failures_(failures)
    {
    }

    // Calls `visit` with the association's path, without keys, and its references.
    template <typename Visit>
    WalkEnd run(const Visit& visit)
    {
        std::vector<CMPIObjectPath*> sensors;
        if (!fetchSensors(sensors))
            return WalkEnd::atSensors;
        for (const CMPIObjectPath* const sensor : sensors) {
            const WalkEnd end = walkCapabilities(sensor, visit);
            if (end != WalkEnd::complete)
                return end;
        }
        return WalkEnd::complete;
    }

private:
    template <typename Visit>
    WalkEnd walkCapabilities(const CMPIObjectPath* sensor, const Visit& visit)
    {
        if (!isUsable(sensor))
            return report(failures_.sensor);
        copyNameSpace(sensor, op(), nullptr);
        std::vector<CMPIObjectPath*> capabilities;
        if (!fetchCapabilities(capabilities))
            return WalkEnd::atCapabilities;
        for (const CMPIObjectPath* const path : capabilities) {
            if (!isUsable(path))
                return report(failures_.capabilities);
            copyNameSpace(path, op(), nullptr);
            copyNameSpace(sensor, op(), nullptr);
            if (!visitPair(sensor, path, failures_.association, visit))
                return WalkEnd::reported;
        }
        return WalkEnd::complete;
    }

    WalkEnd report(const FailureTexts& texts)
    {
        request().fail(texts, status());
        return WalkEnd::reported;
    }

    const PairFailures& failures_;
};

} // namespace

int sensorElementCapabilitiesCMPIInstances(
    const CMPIObjectPath* op, const char** properties, std::vector<CMPIInstance*>& out)
{
    const AssociationRequest request(served(), broker, "sensorElementCapabilitiesCMPIInstances");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    PairWalk walk(request, instanceFailures, op, &status);
    walk.reserve(out);
    // The filter's keys deliberately differ from the references of this association.
    std::array<const char*, 3> keys = {"Antecedent", "Dependent", nullptr};
    const WalkEnd end =
        walk.run([&](const CMPIObjectPath* association, const References& references) {
            out.push_back(
                newAssociation(request.broker(), association, references, properties, keys.data()));
        });
    if (end == WalkEnd::atSensors) {
        traceToBroker(request.broker(), CMPI_LEV_WARNING, SensorElementCapabilitiesProvider,
            "***Can't get Sensor ObjectPaths.             Exiting EnumerateInstanceNames***");
        request.marks().failure(sensorPathsFailed);
    } else if (end == WalkEnd::atCapabilities) {
        traceToBroker(request.broker(), CMPI_LEV_WARNING, SensorElementCapabilitiesProvider,
            "***Can't get ObjectPaths for                 EnabledLogicalElementCap"
            "                 Exiting EnumerateInstanceNames***");
        request.marks().failure(capabilitiesPathsFailed);
    }
    request.marks().exit();
    return end == WalkEnd::complete ? 0 : 1;
}

CMPIStatus SensorElementCapabilities_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult* rslt, const CMPIObjectPath* op)
{
    const AssociationRequest request(
        served(), broker, "SensorElementCapabilities_EnumInstanceNames");
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    PairWalk walk(request, nameFailures, op, &status);
    const WalkEnd end =
        walk.run([&](const CMPIObjectPath* association, const References& references) {
            addReferenceKeys(association, references);
            CMReturnObjectPath(rslt, association);
        });
    const bool isAnswered = end == WalkEnd::complete || walk.foundNoSensors();
    if (isAnswered || end == WalkEnd::reported)
        request.marks().exit(); // only these ends have an exit mark
    if (isAnswered)
        CMReturnDone(rslt);
    return status;
}

CMPIStatus SensorElementCapabilities_EnumInstances(CMPIInstanceMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties)
{
    const AssociationRequest request(served(), broker, "SensorElementCapabilities_EnumInstances");
    return request.enumerateInstances(rslt, [&](std::vector<CMPIInstance*>& instances) {
        return sensorElementCapabilitiesCMPIInstances(op, properties, instances);
    });
}

CMPIStatus SensorElementCapabilities_GetInstance(CMPIInstanceMI*, const CMPIContext*,
    const CMPIResult* rslt, const CMPIObjectPath* op, const char** properties)
{
    const AssociationRequest request(served(), broker, "SensorElementCapabilities_GetInstance");
    return request.getInstance(rslt, op, [&](std::vector<CMPIInstance*>& instances) {
        return sensorElementCapabilitiesCMPIInstances(op, properties, instances);
    });
}

} // namespace Vorn::SensorProfileProvider
