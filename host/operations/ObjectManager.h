// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The embedded object manager as a whole, for whoever brings it the messages.

#pragma once

#include "host/manager/Manager.h"
#include "host/operations/Dispatcher.h"
#include "host/operations/InteropProvider.h"

#include <string>
#include <vector>

namespace Host {

class ObjectManager : public CimXml::OperationHandler {
public:
    // Serves the registered classes, and root/interop by itself. Libraries are loaded when they
    // are first needed, unless the manager was told to: one that cannot be used is the answer to
    // an operation. The classes must outlive it, and it must outlive its answers.
    ObjectManager(const Repository& classes, std::vector<ProviderRegistration> registrations,
        const HostName& hostName, const OperationLimits& limits = {});

    // What answers the operations, for the process itself.
    Manager& manager() noexcept { return manager_; }

    std::unique_ptr<CimXml::Response> answer(
        const CimXml::Message& message, const CimXml::Caller& caller) override
    {
        return dispatcher_.answer(message, caller);
    }

private:
    InteropProvider interop_;
    Manager manager_;
    Dispatcher dispatcher_;
};

} // namespace Host
