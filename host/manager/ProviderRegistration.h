// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>

#include <string>

namespace Host {

// Which provider serves a class, and where it is found. A class has one registration.
struct ProviderRegistration {
    std::string className;
    // What the names of the provider's factory functions begin with.
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
