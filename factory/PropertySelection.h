// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <set>
#include <string>

namespace Vorn::SensorProfileProvider {

// Selects the optional properties of a class for a request: exactly those in its property
// list (case matters); without a list all, or none when only an object path is needed.
class PropertySelection {
public:
    // `properties` is null or ends with a null entry.
    PropertySelection(const char** properties, bool isObjPath)
        : all_(properties == nullptr && !isObjPath)
    {
        for (; properties != nullptr && *properties != nullptr; ++properties)
            names_.insert(*properties);
    }

    bool selects(const char* name) const { return all_ || names_.contains(name); }

private:
    bool all_;
    std::set<std::string, std::less<>> names_;
};

} // namespace Vorn::SensorProfileProvider
