// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where the manager gets management interfaces (MIs) from.

#pragma once

#include "host/manager/ProviderLibrary.h"
#include "host/manager/ProviderRegistration.h"

#include <map>
#include <memory>
#include <mutex>
#include <string>

namespace Host {

class Broker;

// Asked from any thread, for every call of a provider. The MIs live as long as the source.
// Throws std::runtime_error with the reason when there is no such MI.
class ProviderSource {
public:
    virtual ~ProviderSource() = default;

    virtual CMPIInstanceMI& instanceMI(const ProviderRegistration& registration) = 0;
    virtual CMPIAssociationMI& associationMI(const ProviderRegistration& registration) = 0;
};

// Loads each library when the first of its MIs is asked for, and makes each MI once. A library
// that cannot be used is tried again the next time, so that it may be put in place later.
class LoadedProviders : public ProviderSource {
public:
    // The broker must outlive the providers.
    explicit LoadedProviders(const Broker& broker) : broker_(broker) {}

    CMPIInstanceMI& instanceMI(const ProviderRegistration& registration) override;
    CMPIAssociationMI& associationMI(const ProviderRegistration& registration) override;

private:
    ProviderLibrary* findLoaded(const std::string& file);
    ProviderLibrary& library(const std::string& file);

    const Broker& broker_;
    std::mutex mutex_; // of the map, and never held while a library is loaded or called
    std::map<std::string, std::unique_ptr<ProviderLibrary>> libraries_;
};

} // namespace Host
