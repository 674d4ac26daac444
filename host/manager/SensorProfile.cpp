// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/SensorProfile.h"

namespace Host {

std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary)
{
    std::vector<ProviderRegistration> providers = {
        {"ZUMLO_NumericSensor", "SensorProfileProvider", sensorLibrary},
        {"ZUMLO_SensorEnabledLogicalElementCapabilities",
            "SensorEnabledLogicalElementCapabilitiesProvider", sensorLibrary},
        {"ZUMLO_SensorElementCapabilities", "SensorElementCapabilitiesProvider", sensorLibrary,
            true},
        {"ZUMLO_SensorSystemDevice", "SensorSystemDeviceProvider", sensorLibrary, true}};
    if (computerSystemLibrary)
        providers.push_back(
            {"ZUMLO_ComputerSystem", "ComputerSystemProvider", *computerSystemLibrary});
    return providers;
}

std::vector<ProviderRegistration> registeredProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary)
{
    auto providers = sensorProfileProviders(sensorLibrary, computerSystemLibrary);
    if (computerSystemLibrary) {
        providers.push_back({"ZUMLO_SensorRegisteredProfile", "SensorRegisteredProfileProvider",
            *computerSystemLibrary});
        providers.push_back({"ZUMLO_SensorElementConformsToProfile",
            "SensorElementConformsToProfileProvider", *computerSystemLibrary, true});
    }
    return providers;
}

} // namespace Host
