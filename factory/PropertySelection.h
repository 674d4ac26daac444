// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstring>

namespace Vorn::SensorProfileProvider {

// Selects the optional properties of a class for a request: exactly those in its property
// list (case matters); without a list all, or none when only an object path is needed.
class PropertySelection {
public:
    // `properties` is null or ends with a null entry; it must outlive the selection.
    PropertySelection(const char** properties, bool isObjPath)
        : properties_(properties), all_(properties == nullptr && !isObjPath)
    {
    }

    // A list is searched from its start: it has few names, and a selection serves one instance.
    bool selects(const char* name) const
    {
        for (const char** listed = properties_; listed != nullptr && *listed != nullptr; ++listed)
            if (**listed == *name && std::strcmp(*listed, name) == 0)
                return true;
        return all_;
    }

private:
    const char** properties_;
    bool all_;
};

} // namespace Vorn::SensorProfileProvider
