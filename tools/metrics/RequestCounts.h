// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "tools/metrics/Exposition.h"

#include <cstdint>
#include <map>
#include <mutex>
#include <string_view>
#include <utility>

namespace Tools {

// Passes operations to a handler and counts them. Thread-safe.
class RequestCounts : public Host::CimXml::OperationHandler {
public:
    // The handler must outlive it.
    explicit RequestCounts(Host::CimXml::OperationHandler& handler) : handler_(handler) {}

    // Throws what the handler throws; such messages are no operations and do not count.
    std::unique_ptr<Host::CimXml::Response> answer(
        const Host::CimXml::Message& message, const Host::CimXml::Caller& caller) override;

    void addTo(Exposition& exposition) const;

private:
    Host::CimXml::OperationHandler& handler_;
    mutable std::mutex mutex_;
    // By operation, in the spelling of DSP0200, and status code.
    std::map<std::pair<std::string_view, unsigned>, std::uint64_t> counts_;
};

} // namespace Tools
