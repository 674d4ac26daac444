// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/SensorProfile.h"

namespace Host {

std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary)
{
    std::vector<ProviderRegistration> providers = {
        {"ZUMLO_NumericSensor", "SensorProfileProvider", sensorLibrary, true, false},
        {"ZUMLO_SensorEnabledLogicalElementCapabilities",
            "SensorEnabledLogicalElementCapabilitiesProvider", sensorLibrary, true, false},
        {"ZUMLO_SensorElementCapabilities", "SensorElementCapabilitiesProvider", sensorLibrary,
            true, true},
        {"ZUMLO_SensorSystemDevice", "SensorSystemDeviceProvider", sensorLibrary, true, true}};
    if (computerSystemLibrary)
        providers.push_back({"ZUMLO_ComputerSystem", "ComputerSystemProvider",
            *computerSystemLibrary, true, false});
    return providers;
}

} // namespace Host
