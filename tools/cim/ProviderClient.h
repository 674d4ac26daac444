// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A client of the providers, through the embedded object manager.

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
    std::optional<std::string> computerSystem; // nothing when no provider serves that class
};

using Instances = std::vector<const Host::Instance*>;

// Owns a request and the objects that it returns. At most one client may exist at a time. The
// constructor throws std::runtime_error when the classes cannot be compiled, the operations when
// a library cannot be used, a provider returns an error or its answer is incomplete.
class ProviderClient {
public:
    explicit ProviderClient(const ProviderFiles& files);

    // Returns the class's name as it is declared in any namespace; nothing for an unknown class.
    std::optional<std::string> declaredClass(std::string_view className) const;
    // Returns the names of the association classes that are served.
    const std::vector<std::string>& associationClasses() const { return associations_; }

    // Returns the instances of the class and its subclasses in the provider's order, with those
    // properties of a list that ends with a null; with all where there is no list.
    Instances instances(const std::string& className, const char** properties = nullptr);
    // Returns null when there is none.
    const Host::Instance* instance(const Host::ObjectPath& path);

    // Returns the component that calls the providers.
    const Host::Manager& manager() const { return manager_; }

    // Begins another request, which frees the objects of the one before.
    void beginRequest();

    // Returns the class of an object, which the client owns; null for an unknown class.
    const Host::ClassDeclaration* classOf(const Host::Instance& object) const;

    // Returns the path, which the request owns, or null when the text is no path of a known class.
    // Throws UsageError when the path is malformed.
    const Host::ObjectPath* readPath(std::string_view text) const;

private:
    std::unique_ptr<const Host::Repository> classes_;
    std::vector<std::string> associations_;
    Host::Manager manager_;
    std::optional<Host::Request> request_;
};

} // namespace Tools
