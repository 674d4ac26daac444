// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Builds an instance of ZUMLO_SensorEnabledLogicalElementCapabilities from a record.

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/InstanceWriter.h"
#include "factory/PropertySelection.h"
#include "factory/SensorFactory.h"
#include "factory/TraceLines.h"

#include <cmpimacs.h>

#include <array>

namespace Vorn::SensorProfileProvider {

namespace {

// Makes an instance with its property filter. Returns what the broker returned when that is not
// usable.
CMPIInstance* newCapabilitiesInstance(const CMPIBroker* broker, const CMPIObjectPath* ref,
    const std::string& host, const char** properties, CMPIStatus* rc)
{
    const CMPIObjectPath* const path =
        newPath(broker, ref, SensorEnabledLogicalElementCapClass, host, rc);
    if (path == nullptr)
        return nullptr;
    CMPIInstance* const instance = CMNewInstance(broker, path, nullptr);
    if (isUsable(instance)) {
        std::array<const char*, 2> keys = {"InstanceID", nullptr};
        CMSetPropertyFilter(instance, properties, keys.data());
    }
    return instance;
}

} // namespace

CMPIInstance* SensorFactory::makeSensorEnabledLogicalElementCapInstance(const CMPIBroker* broker,
    const CMPIObjectPath* ref, SensorEnabledLogCap snsrCap, const char** properties, bool isObjPath,
    CMPIStatus* rc)
{
    const TracedOperation traced(
        factoryModule(), "makeSensorEnabledLogicalElementCapInstance", [&] {
            return parameterList(" broker=", broker, " ref=", ref, " snsrCap=", &snsrCap,
                " properties=", properties, " IsObjPath=", isObjPath, " rc=", rc);
        });
    traced.entering(FactoryLines::makeCapabilitiesInstance.entry);
    PropertySelection selection(properties, isObjPath);
    CMPIInstance* const instance =
        newCapabilitiesInstance(broker, ref, texts.systemName(), properties, rc);
    if (isUsable(instance)) {
        const InstanceWriter writer(broker, instance);
        writer.setText("InstanceID", snsrCap.getInstanceID());
        if (selection.selects("RequestedStatesSupported") &&
            !writer.setCodes("RequestedStatesSupported", snsrCap.getStatesSupported(), rc))
            // The texts differ in one letter.
            reportFailure(broker, rc, SensorEnabledLogicalElementCapabilitiesProvider,
                "Creating array for Property                         "
                "RequestedStatesSupported failed.",
                "Creating Array for Property                         "
                "RequestedStatesSupported failed.");
        writer.setFlag("ElementNameEditSupported", snsrCap.getElementNameEditSupported());
    }
    traced.exiting(FactoryLines::makeCapabilitiesInstance.exit);
    return instance;
}

} // namespace Vorn::SensorProfileProvider
