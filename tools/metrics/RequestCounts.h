// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/OperationHandler.h"
#include "tools/metrics/Exposition.h"

#include <cstdint>
#include <map>
#include <memory>
#include <mutex>
#include <string_view>
#include <utility>

namespace Tools {

// Passes operations to a handler and counts them. Thread-safe.
class RequestCounts : public Host::CimXml::OperationHandler {
public:
    // The handler must outlive it.
    explicit RequestCounts(Host::CimXml::OperationHandler& handler);

    // Throws what the handler throws. Messages that are not loosely valid do not count.
    std::unique_ptr<Host::CimXml::Response> answer(
        const Host::CimXml::Message& message, const Host::CimXml::Caller& caller) override;

    void addTo(Exposition& exposition) const;

private:
    void count(std::string_view operation, std::string_view result);

    Host::CimXml::OperationHandler& handler_;
    mutable std::mutex mutex_;
    // By operation, in the spelling of DSP0200, and result.
    std::map<std::pair<std::string_view, std::string_view>, std::uint64_t> counts_;
};

} // namespace Tools
