// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <limits>
#include <set>
#include <string>

namespace Vorn::SensorProfileProvider {

// Which of a class's optional properties a request wants: without a list all of them, or none
// when only an object path is needed; with a list exactly those it names, letter for letter.
class PropertySelection {
public:
    // `properties` is null or ends with a null entry.
    PropertySelection(const char** properties, bool isObjPath)
        : all_(properties == nullptr && !isObjPath)
    {
        if (properties == nullptr)
            return;
        constexpr auto last = std::numeric_limits<std::uint16_t>::max();
        for (std::uint16_t i = 0; properties[i] != nullptr && i < last; ++i)
            names_.insert(properties[i]);
    }

    bool wants(const char* name) const { return all_ || names_.contains(name); }

private:
    bool all_;
    std::set<std::string, std::less<>> names_;
};

} // namespace Vorn::SensorProfileProvider
