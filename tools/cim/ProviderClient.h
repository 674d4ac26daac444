// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The providers under the embedded object manager, asked as a CIM client asks.

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Request.h"
#include "host/manager/Manager.h"
#include "host/repository/Repository.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Tools {

inline constexpr const char* nameSpace = "root/cimv2";
inline constexpr const char* sensorClass = "ZUMLO_NumericSensor";
inline constexpr const char* computerSystemClass = "ZUMLO_ComputerSystem";
inline constexpr const char* capabilitiesClass = "ZUMLO_SensorEnabledLogicalElementCapabilities";

struct ProviderFiles {
    std::string sensors;
    std::optional<std::string> computerSystem; // nothing when nobody serves that class
};

using Instances = std::vector<const Host::Instance*>;

// One request from its making to its end: the objects it returns last as long as it does.
// Stays on the stack; one at a time. It throws std::runtime_error when the classes cannot be
// compiled, its operations when a library cannot be used, when a provider answers with an error or
// leaves a part of its answer out.
class ProviderClient {
public:
    explicit ProviderClient(const ProviderFiles& files);

    // The class's name as it is declared; nothing for a class that is not known.
    std::optional<std::string> declaredClass(std::string_view className) const;
    // For messages: those that are served here.
    const std::vector<std::string>& servedClasses() const { return served_; }
    // Those of them that are associations.
    const std::vector<std::string>& associationClasses() const { return associations_; }

    // Of the class and those below it, in the provider's order.
    Instances instances(const std::string& className);
    // Null when there is none.
    const Host::Instance* instance(const Host::ObjectPath& path);

    Instances sensors() { return instances(sensorClass); }
    // Null when there is none with that DeviceID.
    const Host::Instance* sensor(std::string_view deviceId);

    // The path that the text means, in the request; null when it is no path of a known class.
    // Throws UsageError when it is one with a mistake in it.
    const Host::ObjectPath* readPath(std::string_view text) const;

private:
    std::unique_ptr<const Host::Repository> classes_;
    std::vector<std::string> served_;
    std::vector<std::string> associations_;
    Host::Manager manager_;
    std::optional<Host::Request> request_;
};

} // namespace Tools
