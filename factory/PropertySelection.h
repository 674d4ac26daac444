// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <cstring>
#include <vector>

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

    // REQUIRES: the name is a string literal. Its address identifies it when it is asked for again.
    bool selects(const char* name)
    {
        if (properties_ == nullptr)
            return all_;
        // The same names are asked for in the same order for each instance.
        for (std::size_t tried = 0; tried < verdicts_.size(); ++tried) {
            const Verdict& next = verdicts_[next_];
            next_ = next_ + 1 == verdicts_.size() ? 0 : next_ + 1;
            if (next.name == name)
                return next.isListed;
        }
        return verdicts_.emplace_back(Verdict{name, isListed(name)}).isListed;
    }

private:
    struct Verdict {
        const char* name;
        bool isListed;
    };

    bool isListed(const char* name) const
    {
        for (const char** listed = properties_; *listed != nullptr; ++listed)
            if (std::strcmp(*listed, name) == 0)
                return true;
        return false;
    }

    const char** properties_;
    bool all_;
    std::vector<Verdict> verdicts_;
    std::size_t next_ = 0; // where the search in them begins
};

} // namespace Vorn::SensorProfileProvider
