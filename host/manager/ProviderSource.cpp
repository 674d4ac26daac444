// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ProviderSource.h"

#include "host/manager/MakingTurn.h"

namespace Host {

CMPIInstanceMI& LoadedProviders::instanceMI(const ProviderRegistration& registration)
{
    return library(registration.libraryFile).instanceMI(registration.providerName);
}

CMPIAssociationMI& LoadedProviders::associationMI(const ProviderRegistration& registration)
{
    return library(registration.libraryFile).associationMI(registration.providerName);
}

ProviderLibrary* LoadedProviders::findLoaded(const std::string& file)
{
    const std::lock_guard lock(mutex_);
    const auto place = libraries_.find(file);
    return place == libraries_.end() ? nullptr : place->second.get();
}

ProviderLibrary& LoadedProviders::library(const std::string& file)
{
    if (ProviderLibrary* const known = findLoaded(file))
        return *known;
    const MakingTurn turn(file);
    if (ProviderLibrary* const known = findLoaded(file))
        return *known;
    auto loaded = std::make_unique<ProviderLibrary>(broker_, file);
    const std::lock_guard lock(mutex_);
    return *libraries_.emplace(file, std::move(loaded)).first->second;
}

} // namespace Host
