// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Dispatches each operation to the component that carries it out.

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "host/operations/HostName.h"
#include "host/operations/PullOperations.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>

namespace Host {

class Manager;
class Repository;
class Request;

class Dispatcher : public CimXml::OperationHandler {
public:
    // The host's name is for paths that do not have one of their own. Classes and manager must
    // outlive the dispatcher and its responses.
    Dispatcher(const Repository& classes, Manager& manager, HostName hostName,
        const OperationLimits& limits = {},
        OpenEnumerations::Clock clock = std::chrono::steady_clock::now);

    // REQUIRES: no request is active on this thread.
    // An operation that ends in a Refusal returns an error response with its code; codes that
    // DSP0200 does not have become CIM_ERR_FAILED.
    std::unique_ptr<CimXml::Response> answer(
        const CimXml::Message& message, const CimXml::Caller& caller) override;

    // Returns the number of objects in the memory of open enumerations.
    std::size_t heldObjects() const { return pulls_.heldObjects(); }

private:
    std::unique_ptr<CimXml::Response> carryOut(
        const CimXml::Message& message, const CimXml::Caller& caller);
    std::optional<Continuation> run(CimXml::Operation& operation, Request& request,
        const std::string& principal, FoundObjects& found);
    // Gives the source of an association the host's name, which the far end has: providers return
    // the source as the near end.
    void addHost(ObjectPath* source) const;
    void runToTheEnd(const CimXml::Operation& operation, Request& request, FoundObjects& found);

    const Repository& classes_;
    Manager& manager_;
    const HostName hostName_;
    PullOperations pulls_;
};

} // namespace Host
