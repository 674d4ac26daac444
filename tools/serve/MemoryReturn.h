// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"

namespace Tools {

// Gives back to the system what is free when the answer of very many objects, or to a very large
// message, is dropped: the memory that each worker freed for itself would stay, and add up until
// all of them had such an operation.
class MemoryReturn : public Host::CimXml::OperationHandler {
public:
    // The handler must outlive it.
    explicit MemoryReturn(Host::CimXml::OperationHandler& handler) : handler_(handler) {}

    std::unique_ptr<Host::CimXml::Response> answer(
        const Host::CimXml::Message& message, const Host::CimXml::Caller& caller) override;

private:
    Host::CimXml::OperationHandler& handler_;
};

} // namespace Tools
