// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerates the instances of other providers through the object manager.

#pragma once

#include <cmpidt.h>

#include <string>
#include <vector>

namespace Vorn::Companion {

// The functions return objects of the broker, or none where no provider serves the class in the
// namespace. They throw RequestFailure, with the code and the message of the object manager, when
// it fails in another way.
class ProviderUpcalls {
public:
    ProviderUpcalls(const CMPIBroker* broker, const CMPIContext* context)
        : broker_(broker), context_(context)
    {
    }

    // Returns the paths of the class's instances. Each has its namespace.
    std::vector<CMPIObjectPath*> names(const std::string& nameSpace, const char* className) const;

    // Returns the class's instances. The list of properties ends with a null and is null for all
    // properties.
    std::vector<CMPIInstance*> instances(
        const std::string& nameSpace, const char* className, const char** properties) const;

private:
    // Calls `enumerate(path, status)` with the path of the class. Returns the elements of the type.
    template <typename Enumerate>
    std::vector<CMPIValue> elements(const std::string& nameSpace, const char* className,
        CMPIType type, const Enumerate& enumerate) const;

    const CMPIBroker* broker_;
    const CMPIContext* context_;
};

} // namespace Vorn::Companion
