// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of root/interop, which is part of the object manager.

#pragma once

#include "host/manager/ProviderRegistration.h"
#include "host/operations/HostName.h"
#include "host/operations/InteropObjects.h"

#include <cmpift.h>

#include <memory>
#include <string>
#include <vector>

namespace Host {

// Enumerates and gets instances. Thread-safe.
class InteropProvider {
public:
    // The classes must outlive it.
    InteropProvider(const Repository& classes, HostName hostName);
    InteropProvider(const InteropProvider&) = delete;
    InteropProvider& operator=(const InteropProvider&) = delete;

    // Returns the current objects.
    InteropObjects objects() const { return {classes_, hostName_()}; }

    // Returns the registrations of the classes it serves, for a manager that it must outlive.
    std::vector<ProviderRegistration> registrations();

private:
    const Repository& classes_;
    const HostName hostName_;
    CMPIInstanceMI mi_;
};

} // namespace Host
