// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Determines the far end of an association.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"
#include "platform/utilities/ProviderUtilities.h"

#include <array>
#include <cstring>

namespace Vorn::SensorProfileProvider {

namespace {

struct AssociationEnd {
    const char* sourceClass;
    const char* associationClass;
    const char* targetClass;
    const char* provider;
    const char* traceText; // scripts match it; it may name another class than the target
    unsigned exitingLine;
};

constexpr const char* targetIsPackage = "Target Class is PhysicalPackageClass";
constexpr const char* targetIsSystem = "Target Class is ComputerSystemClass";

constexpr std::array<AssociationEnd, 4> associationEnds = {{
    {ComputerSystemClass, SensorSystemDeviceClass, SensorClass, SensorSystemDeviceProvider,
        targetIsPackage, FactoryLines::targetOfSystem},
    {SensorClass, SensorSystemDeviceClass, ComputerSystemClass, SensorSystemDeviceProvider,
        targetIsSystem, FactoryLines::targetOfSensorInSystem},
    {SensorClass, SensorElementCapabilitiesClass, SensorEnabledLogicalElementCapClass,
        SensorElementCapabilitiesProvider, targetIsPackage,
        FactoryLines::targetOfSensorWithCapabilities},
    {SensorEnabledLogicalElementCapClass, SensorElementCapabilitiesClass, SensorClass,
        SensorElementCapabilitiesProvider, targetIsSystem, FactoryLines::targetOfCapabilities},
}};

// Compares with regard to case; a name that is null is no class's.
bool isClass(const char* name, const char* className)
{
    return name != nullptr && std::strcmp(name, className) == 0;
}

// Reads the characters anew for each row, since a broker may move them.
const AssociationEnd* findEnd(
    const CMPIString* sourceClass, const char* associationClass, CMPIStatus* rc)
{
    for (const AssociationEnd& end : associationEnds)
        if (isClass(charactersOf(sourceClass, rc), end.sourceClass) &&
            isClass(associationClass, end.associationClass))
            return &end;
    return nullptr;
}

auto associationParameters(const CMPIBroker* const& broker, const CMPIObjectPath* const& ref,
    const char* const& left, const char* const& right, CMPIStatus* const& rc)
{
    return [&] {
        return parameterList(" broker=", broker, " ref=", ref, " _RefLeftClass=", left,
            " _RefRightClass=", right, " rc=", rc);
    };
}

} // namespace

const char* SensorFactory::get_assoc_targetClass_Name(const CMPIBroker* broker,
    const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
    CMPIStatus* rc)
{
    const TracedOperation traced(factoryModule(), "get_assoc_targetClass_Name",
        associationParameters(broker, ref, _RefLeftClass, _RefRightClass, rc));
    traced.entering(FactoryLines::targetNameEntry);
    const AssociationEnd* const end = findEnd(classNameOf(ref, rc), _RefLeftClass, rc);
    if (end == nullptr) {
        traced.exiting(FactoryLines::noTarget);
        return nullptr;
    }
    traceToBroker(broker, CMPI_LEV_INFO, end->provider, end->traceText);
    traced.exiting(end->exitingLine);
    return end->targetClass;
}

CMPIObjectPath* SensorFactory::get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
    const CMPIObjectPath* ref, const char* _RefLeftClass, const char* _RefRightClass,
    CMPIStatus* rc)
{
    const TracedOperation traced(factoryModule(), "get_assoc_targetClass_ObjectPath",
        associationParameters(broker, ref, _RefLeftClass, _RefRightClass, rc));
    traced.entering(FactoryLines::targetPath.entry);
    const char* const target =
        get_assoc_targetClass_Name(broker, ref, _RefLeftClass, _RefRightClass, rc);
    CMPIObjectPath* const path =
        target ? newPath(broker, ref, target, getSystemName(), rc, rc) : nullptr;
    traced.exiting(FactoryLines::targetPath.exit);
    return path;
}

} // namespace Vorn::SensorProfileProvider
