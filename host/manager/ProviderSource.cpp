// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ProviderSource.h"

namespace Host {

CMPIInstanceMI& LoadedProviders::instanceMI(const ProviderRegistration& registration)
{
    const std::lock_guard lock(mutex_);
    return library(registration.libraryFile).instanceMI(registration.providerName);
}

CMPIAssociationMI& LoadedProviders::associationMI(const ProviderRegistration& registration)
{
    const std::lock_guard lock(mutex_);
    return library(registration.libraryFile).associationMI(registration.providerName);
}

ProviderLibrary& LoadedProviders::library(const std::string& file)
{
    return libraries_.try_emplace(file, broker_, file).first->second;
}

} // namespace Host
