// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/PullOperations.h"

#include "host/broker/Refusal.h"
#include "host/operations/StatusCodes.h"

#include <algorithm>
#include <utility>

namespace Host {

using CimXml::Operation;
using CimXml::OperationKind;

namespace {

bool isOfPaths(OperationKind kind)
{
    return kind == OperationKind::openEnumerateInstancePaths ||
           kind == OperationKind::openAssociatorInstancePaths ||
           kind == OperationKind::openReferenceInstancePaths ||
           kind == OperationKind::pullInstancePaths;
}

EnumerationOwner ownerOf(const Operation& operation, const std::string& principal)
{
    return {principal, operation.nameSpace, isOfPaths(operation.kind)};
}

} // namespace

PullOperations::PullOperations(const OperationLimits& limits, OpenEnumerations::Clock clock)
    : limits_(limits), enumerations_(limits, std::move(clock))
{
}

bool PullOperations::isOpening(OperationKind kind)
{
    switch (kind) {
    case OperationKind::openEnumerateInstances:
    case OperationKind::openEnumerateInstancePaths:
    case OperationKind::openAssociatorInstances:
    case OperationKind::openAssociatorInstancePaths:
    case OperationKind::openReferenceInstances:
    case OperationKind::openReferenceInstancePaths:
        return true;
    default:
        return false;
    }
}

void PullOperations::checkOpening(const Operation& operation) const
{
    if (!operation.filterQuery.empty() || !operation.filterQueryLanguage.empty())
        throw Refusal(
            filteredEnumerationNotSupported, "enumerations cannot be filtered by a query");
    if (operation.continueOnError)
        throw Refusal(continuationOnErrorNotSupported, "an enumeration ends with its first error");
    const auto longest = static_cast<std::uint64_t>(limits_.maximumTimeout.count());
    const std::uint64_t wanted = operation.operationTimeout.value_or(1);
    if (wanted == 0 || wanted > longest)
        throw Refusal(invalidOperationTimeout, "parameter OperationTimeout: must be from 1 to " +
                                                   std::to_string(longest) + " seconds, not " +
                                                   std::to_string(wanted));
}

Continuation PullOperations::open(
    const Operation& operation, const std::string& principal, FoundObjects& found)
{
    FoundObjects first = found.takeFirst(countFor(operation));
    std::swap(first, found);
    FoundObjects& rest = first;
    if (rest.size() == 0)
        return {};
    const auto timeout = operation.operationTimeout.value_or(limits_.defaultTimeout.count());
    return {enumerations_.open({ownerOf(operation, principal), std::move(rest), operation.selection,
        std::chrono::seconds(timeout)})};
}

Continuation PullOperations::pull(
    Operation& operation, const std::string& principal, FoundObjects& found)
{
    auto pulled = enumerations_.pull(
        operation.enumerationContext, ownerOf(operation, principal), countFor(operation));
    found = std::move(pulled.objects);
    operation.selection = std::move(pulled.selection);
    return pulled.isOver ? Continuation{} : Continuation{operation.enumerationContext};
}

void PullOperations::close(const Operation& operation, const std::string& principal)
{
    enumerations_.close(operation.enumerationContext, ownerOf(operation, principal));
}

std::size_t PullOperations::countFor(const Operation& operation) const
{
    return std::min(operation.maxObjectCount, limits_.maximumObjectCount);
}

} // namespace Host
