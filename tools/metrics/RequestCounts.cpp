// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/RequestCounts.h"

#include "host/cimxml/Message.h"
#include "host/cimxml/OperationTable.h"
#include "host/cimxml/RequestError.h"

#include <array>
#include <vector>

namespace Tools {

namespace {

constexpr MetricFamily requests{"sensor_profile_requests_total",
    "CIM operations that were executed, by their result.", MetricFamily::Type::counter};
constexpr std::string_view exception = "error"; // the result of an operation that threw one

// The status codes of DSP0200, by their numbers.
constexpr std::array<std::string_view, 30> statusNames = {"ok", "CIM_ERR_FAILED",
    "CIM_ERR_ACCESS_DENIED", "CIM_ERR_INVALID_NAMESPACE", "CIM_ERR_INVALID_PARAMETER",
    "CIM_ERR_INVALID_CLASS", "CIM_ERR_NOT_FOUND", "CIM_ERR_NOT_SUPPORTED",
    "CIM_ERR_CLASS_HAS_CHILDREN", "CIM_ERR_CLASS_HAS_INSTANCES", "CIM_ERR_INVALID_SUPERCLASS",
    "CIM_ERR_ALREADY_EXISTS", "CIM_ERR_NO_SUCH_PROPERTY", "CIM_ERR_TYPE_MISMATCH",
    "CIM_ERR_QUERY_LANGUAGE_NOT_SUPPORTED", "CIM_ERR_INVALID_QUERY", "CIM_ERR_METHOD_NOT_AVAILABLE",
    "CIM_ERR_METHOD_NOT_FOUND", "18", "19", "CIM_ERR_NAMESPACE_NOT_EMPTY",
    "CIM_ERR_INVALID_ENUMERATION_CONTEXT", "CIM_ERR_INVALID_OPERATION_TIMEOUT",
    "CIM_ERR_PULL_HAS_BEEN_ABANDONED", "CIM_ERR_PULL_CANNOT_BE_ABANDONED",
    "CIM_ERR_FILTERED_ENUMERATION_NOT_SUPPORTED", "CIM_ERR_CONTINUATION_ON_ERROR_NOT_SUPPORTED",
    "CIM_ERR_SERVER_LIMITS_EXCEEDED", "CIM_ERR_SERVER_IS_SHUTTING_DOWN",
    "CIM_ERR_QUERY_FEATURE_NOT_SUPPORTED"};

// Clients choose the names of operations: those that are not offered count as one, so that the
// number of series is bounded.
std::string_view operationOf(const Host::CimXml::Message& message)
{
    const auto* const form =
        message.isIntrinsic() ? Host::CimXml::findOperation(message.methodName()) : nullptr;
    return form == nullptr ? "other" : form->name;
}

} // namespace

// The counters of the result "ok" are there from the start: one that begins with its first request
// has no rate that includes it. Those of other results begin when they occur, since all results of
// all operations would be too many series.
RequestCounts::RequestCounts(Host::CimXml::OperationHandler& handler) : handler_(handler)
{
    for (const auto& form : Host::CimXml::offeredOperations())
        counts_.try_emplace({form.name, statusNames.front()});
}

std::unique_ptr<Host::CimXml::Response> RequestCounts::answer(
    const Host::CimXml::Message& message, const Host::CimXml::Caller& caller)
{
    try {
        auto response = handler_.answer(message, caller);
        count(operationOf(message), statusNames.at(response->status()));
        return response;
    } catch (const Host::CimXml::RequestError&) {
        throw;
    } catch (...) {
        count(operationOf(message), exception);
        throw;
    }
}

void RequestCounts::count(std::string_view operation, std::string_view result)
{
    const std::lock_guard lock(mutex_);
    ++counts_[{operation, result}];
}

void RequestCounts::addTo(Exposition& exposition) const
{
    std::vector<Series> series;
    std::unique_lock lock(mutex_);
    for (const auto& [key, count] : counts_)
        series.push_back({Labels().add("operation", key.first).add("result", key.second),
            static_cast<double>(count)});
    lock.unlock();
    exposition.add(requests, series);
}

} // namespace Tools
