// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The embedded object manager as a whole.

#pragma once

#include "host/manager/Manager.h"
#include "host/operations/Dispatcher.h"
#include "host/operations/InteropProvider.h"

#include <string>
#include <vector>

namespace Host {

class ObjectManager : public CimXml::OperationHandler {
public:
    // Serves the registered classes and root/interop. Throws as the manager's constructor does. The
    // classes must outlive the object manager, which must outlive its responses.
    ObjectManager(const Repository& classes, std::vector<ProviderRegistration> registrations,
        const HostName& hostName, const OperationLimits& limits = {});

    // The component that calls providers, for use within the process.
    Manager& manager() noexcept { return manager_; }

    std::unique_ptr<CimXml::Response> answer(
        const CimXml::Message& message, const CimXml::Caller& caller) override
    {
        return dispatcher_.answer(message, caller);
    }

    // Returns the number of objects in the memory of open enumerations.
    std::size_t heldObjects() const { return dispatcher_.heldObjects(); }

private:
    InteropProvider interop_;
    Manager manager_;
    Dispatcher dispatcher_;
};

} // namespace Host
