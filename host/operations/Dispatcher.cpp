// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/Dispatcher.h"

#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/cimxml/Message.h"
#include "host/manager/Manager.h"
#include "host/operations/AssociationOperations.h"
#include "host/operations/ClassOperations.h"
#include "host/operations/InstanceOperations.h"
#include "host/operations/Selections.h"

#include <utility>

namespace Host {

using CimXml::Operation;
using Kind = CimXml::OperationKind;

namespace {

// CMPI has codes beside those of DSP0200, for use between providers and brokers.
CMPIrc statusCode(CMPIrc code)
{
    constexpr auto last = CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED;
    const bool isOfProtocol = code > CMPI_RC_OK && code <= last && code != CMPI_RC_NO_MORE_ELEMENTS;
    return isOfProtocol ? code : CMPI_RC_ERR_FAILED;
}

} // namespace

Dispatcher::Dispatcher(const Repository& classes, Manager& manager, HostName hostName,
    const OperationLimits& limits, OpenEnumerations::Clock clock)
    : classes_(classes), manager_(manager), hostName_(std::move(hostName)),
      pulls_(limits, std::move(clock))
{
}

std::unique_ptr<CimXml::Response> Dispatcher::answer(
    const CimXml::Message& message, const CimXml::Caller& caller)
{
    pulls_.removeExpired();
    try {
        return carryOut(message, caller);
    } catch (const Refusal& refusal) {
        const CMPIrc code = statusCode(refusal.code());
        return std::make_unique<WrittenResponse>(
            errorResponse(message, code, refusal.what()), code);
    }
}

std::unique_ptr<CimXml::Response> Dispatcher::carryOut(
    const CimXml::Message& message, const CimXml::Caller& caller)
{
    Request request(manager_.broker());
    Operation operation = readOperation(message, classes_);
    operation.selection = effectiveSelection(operation, classes_);
    FoundObjects found(request.shareArena());
    const auto continuation = run(operation, request, caller.principal, found);
    return std::make_unique<ObjectResponse>(message, operation.kind, classes_,
        CimXml::Location{hostName_(), operation.nameSpace}, std::move(operation.selection),
        std::move(found), continuation);
}

std::optional<Continuation> Dispatcher::run(
    Operation& operation, Request& request, const std::string& principal, FoundObjects& found)
{
    if (PullOperations::isOpening(operation.kind)) {
        pulls_.checkOpening(operation);
        runToTheEnd(operation, request, found);
        return pulls_.open(operation, principal, found);
    }
    switch (operation.kind) {
    case Kind::pullInstancesWithPath:
    case Kind::pullInstancePaths:
        return pulls_.pull(operation, principal, found);
    case Kind::closeEnumeration:
        pulls_.close(operation, principal);
        return std::nullopt;
    default:
        runToTheEnd(operation, request, found);
        return std::nullopt;
    }
}

void Dispatcher::addHost(ObjectPath* source) const
{
    if (source != nullptr && source->host().empty())
        source->setHost(hostName_().c_str());
}

void Dispatcher::runToTheEnd(const Operation& operation, Request& request, FoundObjects& found)
{
    switch (operation.kind) {
    case Kind::getInstance:
        return getInstance(manager_, operation, request, found);
    case Kind::enumerateInstances:
    case Kind::openEnumerateInstances:
        return enumerateInstances(manager_, operation, request, found);
    case Kind::enumerateInstanceNames:
    case Kind::openEnumerateInstancePaths:
        return enumerateInstanceNames(manager_, operation, request, found);
    case Kind::getProperty:
        return getProperty(manager_, classes_, operation, request, found);
    case Kind::associators:
    case Kind::openAssociatorInstances:
        return associators(manager_, classes_, operation, request, found);
    case Kind::associatorNames:
    case Kind::openAssociatorInstancePaths:
        return associatorNames(manager_, classes_, operation, request, found);
    case Kind::references:
    case Kind::openReferenceInstances:
        addHost(operation.path);
        return references(manager_, classes_, operation, request, found);
    case Kind::referenceNames:
    case Kind::openReferenceInstancePaths:
        addHost(operation.path);
        return referenceNames(manager_, classes_, operation, request, found);
    case Kind::getClass:
        return getClass(classes_, operation, found);
    case Kind::enumerateClasses:
        return enumerateClasses(classes_, operation, found);
    case Kind::enumerateClassNames:
        return enumerateClassNames(classes_, operation, found);
    case Kind::getQualifier:
        return getQualifier(classes_, operation, found);
    case Kind::enumerateQualifiers:
        return enumerateQualifiers(classes_, operation, found);
    case Kind::pullInstancesWithPath:
    case Kind::pullInstancePaths:
    case Kind::closeEnumeration:
        break; // of an enumeration that has run already
    }
}

} // namespace Host
