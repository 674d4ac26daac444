// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/ObjectManager.h"

#include "host/repository/Repository.h"

#include <utility>

namespace Host {

namespace {

std::vector<ProviderRegistration> withInterop(
    std::vector<ProviderRegistration> registrations, InteropProvider& interop)
{
    for (ProviderRegistration& each : interop.registrations())
        registrations.push_back(std::move(each));
    return registrations;
}

} // namespace

ObjectManager::ObjectManager(const Repository& classes,
    std::vector<ProviderRegistration> registrations, const HostName& hostName,
    const OperationLimits& limits)
    : interop_(classes, hostName),
      manager_(classes, withInterop(std::move(registrations), interop_)),
      dispatcher_(classes, manager_, hostName, limits)
{
}

} // namespace Host
