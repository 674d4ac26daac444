// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/Manager.h"

#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/manager/ProviderCall.h"
#include "platform/logging/RynLogger.h"

#include <optional>
#include <utility>

namespace Host {

namespace {

constexpr int warningLevel = 7000;

template <typename Objects>
Enumeration& enumerationOf(const Objects& objects)
{
    std::vector<Value> elements;
    elements.reserve(objects.size());
    for (const auto* const object : objects)
        elements.push_back(Value::of(*object));
    return Enumeration::make(Arena::required(), elements);
}

class Upcalls : public BrokerUpcalls {
public:
    explicit Upcalls(const Manager& manager) : manager_(manager) {}

    Enumeration& enumerateInstanceNames(const Context& context, const ObjectPath& path) override
    {
        return enumerationOf(manager_.enumerateInstanceNames(context, path).paths());
    }
    Enumeration& enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties) override
    {
        return enumerationOf(manager_.enumerateInstances(context, path, properties).instances());
    }

private:
    const Manager& manager_;
};

[[noreturn]] void refuseMissing(const ObjectPath& path)
{
    throw Refusal(CMPI_RC_ERR_NOT_FOUND, "there is no " + path.toText());
}

// Writes a failure to the log, unless the provider merely does not support the operation.
void report(const ProviderRegistration& provider, const Refusal& refusal)
{
    if (refusal.code() == CMPI_RC_ERR_NOT_SUPPORTED)
        return;
    RynLog::RynLogger::logLevelMessage("askEach", "Manager", __LINE__, "Manager", warningLevel,
        nullptr, 0, 0,
        provider.providerName + " answers code " + std::to_string(refusal.code()) + ": " +
            refusal.what());
}

// Calls the providers in turn. Returns the objects of all; throws the first failure when there are
// none.
template <typename Ask>
CollectedResult askEach(const Routing::Registrations& providers, const Ask& ask)
{
    CollectedResult found;
    std::optional<Refusal> firstFailure;
    for (const ProviderRegistration* const provider : providers) {
        try {
            found.append(ask(*provider));
        } catch (const Refusal& refusal) {
            if (providers.size() > 1)
                report(*provider, refusal);
            if (!firstFailure)
                firstFailure = refusal;
        }
    }
    if (firstFailure && found.isEmpty())
        throw Refusal(*firstFailure);
    return found;
}

// Returns the association for an operation on references, whose result class is the class of the
// association itself.
Manager::Association ofReferences(const Manager::Association& association)
{
    return {association.resultClass, nullptr, association.role, nullptr};
}

} // namespace

Manager::Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations)
    : routing_(classes, load(std::move(registrations))), upcalls_(std::make_unique<Upcalls>(*this))
{
    broker_.setClassInformation(&classes);
    broker_.setUpcalls(upcalls_.get());
}

Manager::~Manager()
{
    broker_.setUpcalls(nullptr); // up-calls of a cleanup fail
}

std::vector<ProviderRegistration> Manager::load(std::vector<ProviderRegistration> registrations)
{
    for (ProviderRegistration& each : registrations) {
        if (each.libraryFile.empty())
            continue;
        ProviderLibrary& library =
            libraries_.try_emplace(each.libraryFile, broker_, each.libraryFile).first->second;
        each.instanceMI = &library.createInstanceMI(each.providerName);
        if (each.servesAssociations)
            each.associationMI = &library.createAssociationMI(each.providerName);
    }
    return registrations;
}

CollectedResult Manager::enumerateInstanceNames(
    const Context& context, const ObjectPath& path) const
{
    return askEach(routing_.providersBelow(path), [&](const ProviderRegistration& provider) {
        CMPIInstanceMI& mi = *provider.instanceMI;
        return callProvider(provider, "enumerating instance names", mi,
            mi.ft->enumerateInstanceNames, context, targetOf(path, provider.className));
    });
}

CollectedResult Manager::enumerateInstances(
    const Context& context, const ObjectPath& path, const char** properties) const
{
    return askEach(routing_.providersBelow(path), [&](const ProviderRegistration& provider) {
        CMPIInstanceMI& mi = *provider.instanceMI;
        return callProvider(provider, "enumerating instances", mi, mi.ft->enumerateInstances,
            context, targetOf(path, provider.className), properties);
    });
}

const Instance& Manager::getInstance(
    const Context& context, const ObjectPath& path, const char** properties) const
{
    const ProviderRegistration* const provider = routing_.findProviderOf(path);
    if (provider == nullptr)
        refuseMissing(path);
    CMPIInstanceMI& mi = *provider->instanceMI;
    const CollectedResult found = callProvider(*provider, "getting instances", mi,
        mi.ft->getInstance, context, targetOf(path, provider->className), properties);
    if (found.instances().empty())
        refuseMissing(path);
    return *found.instances().front();
}

// Calls the association providers. Returns those of their objects that are of the result class.
template <typename Ask>
CollectedResult Manager::askAssociations(const ObjectPath& source, const Association& association,
    const char* resultClass, const Ask& ask) const
{
    const auto providers = routing_.associationProviders(source, association);
    return askEach(providers, [&](const ProviderRegistration& provider) {
        CollectedResult found =
            ask(provider, *provider.associationMI, targetOf(source, routing_.classNameOf(source)));
        if (resultClass != nullptr)
            found.keepOnly([&](std::string_view nameSpace, std::string_view className) {
                return routing_.isA(nameSpace, className, resultClass);
            });
        return found;
    });
}

CollectedResult Manager::associators(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties) const
{
    return askAssociations(source, association, association.resultClass,
        [&](const auto& provider, auto& mi, const CMPIObjectPath* target) {
            return callProvider(provider, "following associations", mi, mi.ft->associators, context,
                target, provider.className.c_str(),
                routing_.resultClassFor(provider, source, association), association.role,
                association.resultRole, properties);
        });
}

CollectedResult Manager::associatorNames(
    const Context& context, const ObjectPath& source, const Association& association) const
{
    return askAssociations(source, association, association.resultClass,
        [&](const auto& provider, auto& mi, const CMPIObjectPath* target) {
            return callProvider(provider, "following associations", mi, mi.ft->associatorNames,
                context, target, provider.className.c_str(),
                routing_.resultClassFor(provider, source, association), association.role,
                association.resultRole);
        });
}

CollectedResult Manager::references(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties) const
{
    return askAssociations(source, ofReferences(association), association.resultClass,
        [&](const auto& provider, auto& mi, const CMPIObjectPath* target) {
            return callProvider(provider, "finding references", mi, mi.ft->references, context,
                target, provider.className.c_str(), association.role, properties);
        });
}

CollectedResult Manager::referenceNames(
    const Context& context, const ObjectPath& source, const Association& association) const
{
    return askAssociations(source, ofReferences(association), association.resultClass,
        [&](const auto& provider, auto& mi, const CMPIObjectPath* target) {
            return callProvider(provider, "finding references", mi, mi.ft->referenceNames, context,
                target, provider.className.c_str(), association.role);
        });
}

} // namespace Host
