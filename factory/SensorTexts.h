// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/utilities/ProviderUtilities.h"

#include <string>

namespace Vorn::SensorProfileProvider {

// What the sensors of one request have in common: the name of their system, and the localised
// texts, in the language that the process has when it is constructed. Thread-safe.
class SensorTexts {
public:
    SensorTexts();

    const std::string& systemName() const { return systemName_; }

    // Return the text for a sensor of that name, of at most 511 characters.
    std::string caption(const std::string& elementName) const;
    std::string description(const std::string& elementName) const;

private:
    std::string systemName_ = getSystemName();
    std::wstring captionFormat_;
    std::wstring descriptionFormat_;
};

} // namespace Vorn::SensorProfileProvider
