// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A provider library in memory, asked as an object manager asks it.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/ClassInformation.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/Request.h"
#include "host/manager/ProviderLibrary.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Tools {

inline constexpr const char* nameSpace = "root/cimv2";
inline constexpr const char* sensorClass = "ZUMLO_NumericSensor";

// One request from its making to its end: the instances it returns last as long as it does.
// Stays on the stack; one at a time. Its operations throw std::runtime_error when the provider
// answers with an error or leaves a part of its answer out.
class ProviderClient {
public:
    // Loads the library. Throws std::runtime_error when it cannot be used.
    explicit ProviderClient(const std::string& providerFile);

    // In the provider's order.
    std::vector<const Host::Instance*> sensors();
    // Null when there is none with that DeviceID.
    const Host::Instance* sensor(std::string_view deviceId);

private:
    CMPIInstanceMI& sensorMI();

    Host::ClassTable classes_;
    Host::Broker broker_;
    Host::ProviderLibrary library_;
    std::optional<Host::Request> request_; // begins once the broker is ready
};

// Host and key values included, as a path is written in a URI.
std::string pathOf(const Host::Instance& instance);

} // namespace Tools
