// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

#include <string>

namespace Host {

// The provider of a class and its library. A class has one registration.
struct ProviderRegistration {
    std::string className;
    // The prefix of the names of the provider's factory functions.
    std::string providerName;
    // With its folder; empty for a provider inside the process.
    std::string libraryFile;
    bool servesAssociations = false;

    // The provider's management interfaces (MIs). The manager sets them for providers that it
    // loads.
    CMPIInstanceMI* instanceMI = nullptr;
    CMPIAssociationMI* associationMI = nullptr;
};

} // namespace Host
