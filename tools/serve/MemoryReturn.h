// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"

namespace Tools {

// Passes operations to a handler, and returns free memory to the system when an answer with very
// many objects, or to a very large message, is destroyed. Otherwise each arena of the allocator
// would keep what its largest operation freed: at 10,000 sensors and with two workers, 11 to 26 MiB
// more would stay resident.
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
