// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/utilities/ProviderUtilities.h"

#include <string>

namespace Vorn::SensorProfileProvider {

// The texts that the objects of one request share: the name of the system, and the formats of the
// localised texts in the language that the process has at construction. Immutable after that.
class RequestTexts {
public:
    RequestTexts();

    const std::string& systemName() const { return systemName_; }

    // Return the text for a sensor with this name, of at most 511 characters.
    std::string caption(const std::string& elementName) const;
    std::string description(const std::string& elementName) const;

private:
    struct Format {
        explicit Format(const std::wstring& text);

        std::wstring wide;
        std::string before; // the insert, in UTF-8
        std::string after;
    };

    explicit RequestTexts(const std::wstring& library);
    static std::string filledIn(const Format& format, const std::string& elementName);

    std::string systemName_ = getSystemName();
    Format caption_;
    Format description_;
};

} // namespace Vorn::SensorProfileProvider
