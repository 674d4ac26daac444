// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace Host {

// Which provider serves a class, and where it is found. A class has one registration.
struct ProviderRegistration {
    std::string className;
    // What the names of the provider's factory functions begin with.
    std::string providerName;
    // With its folder; of no meaning where providers do not come from files.
    std::string libraryFile;
    bool servesInstances = true;
    bool servesAssociations = false;
};

} // namespace Host
