// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/Manager.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/manager/Answers.h"
#include "host/manager/ManagerUpcalls.h"
#include "host/manager/ProviderCall.h"

#include <exception>
#include <string>
#include <utility>

namespace Host {

namespace {

// What cannot be loaded is no reason to end: it is an answer like others.
template <typename Load>
auto& loaded(const Load& load)
{
    try {
        return load();
    } catch (const std::exception& error) {
        throw Refusal(CMPI_RC_ERR_FAILED, error.what());
    }
}

[[noreturn]] void refuseMissing(const ObjectPath& path)
{
    throw Refusal(CMPI_RC_ERR_NOT_FOUND, "there is no " + path.toText());
}

// The objects that references finds are of the association class itself.
Manager::Association ofReferences(const Manager::Association& association)
{
    return {association.resultClass, nullptr, association.role, nullptr};
}

} // namespace

Manager::Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations)
    : Manager(classes, std::move(registrations),
          [](const Broker& broker) { return std::make_unique<LoadedProviders>(broker); })
{
}

Manager::Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations,
    const SourceMaker& makeSource)
    : routing_(classes, std::move(registrations)), upcalls_(std::make_unique<ManagerUpcalls>(*this))
{
    broker_.setClassInformation(&classes);
    broker_.setUpcalls(upcalls_.get());
    source_ = makeSource(broker_);
}

Manager::~Manager()
{
    broker_.setUpcalls(nullptr); // a cleanup that calls up finds nobody
}

void Manager::preload()
{
    for (const ProviderRegistration& registration : routing_.registrations()) {
        if (registration.servesInstances)
            instanceMI(registration);
        if (registration.servesAssociations)
            associationMI(registration);
    }
}

CMPIInstanceMI& Manager::instanceMI(const ProviderRegistration& registration)
{
    return loaded([&]() -> CMPIInstanceMI& { return source_->instanceMI(registration); });
}

CMPIAssociationMI& Manager::associationMI(const ProviderRegistration& registration)
{
    return loaded([&]() -> CMPIAssociationMI& { return source_->associationMI(registration); });
}

void Manager::enumerateInstanceNames(
    const Context& context, const ObjectPath& path, ResultSink& sink)
{
    gatherAnswers(routing_.providersBelow(path), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIInstanceMI& mi = instanceMI(provider);
            callProvider(provider, "enumerating instance names", mi, mi.ft->enumerateInstanceNames,
                context, answer, targetOf(path, provider.className));
        });
}

void Manager::enumerateInstances(
    const Context& context, const ObjectPath& path, const char** properties, ResultSink& sink)
{
    gatherAnswers(routing_.providersBelow(path), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIInstanceMI& mi = instanceMI(provider);
            callProvider(provider, "enumerating instances", mi, mi.ft->enumerateInstances, context,
                answer, targetOf(path, provider.className), properties);
        });
}

const Instance& Manager::getInstance(
    const Context& context, const ObjectPath& path, const char** properties)
{
    // Where nobody serves the class there are no objects of it.
    const ProviderRegistration* const served = routing_.findProviderOf(path);
    if (served == nullptr)
        refuseMissing(path);
    const ProviderRegistration& provider = *served;
    CMPIInstanceMI& mi = instanceMI(provider);
    CollectedResult answer;
    callProvider(provider, "getting instances", mi, mi.ft->getInstance, context, answer,
        targetOf(path, provider.className), properties);
    if (answer.instances().empty())
        refuseMissing(path);
    return *answer.instances().front();
}

const ObjectPath& Manager::createInstance(
    const Context& context, const ObjectPath& path, const Instance& instance)
{
    const ProviderRegistration& provider = routing_.providerOf(path);
    CMPIInstanceMI& mi = instanceMI(provider);
    CollectedResult answer;
    callProvider(provider, "creating instances", mi, mi.ft->createInstance, context, answer,
        targetOf(path, provider.className), instance.handle());
    if (answer.paths().empty())
        throw Refusal(CMPI_RC_ERR_FAILED, provider.providerName + " does not say what it made");
    return *answer.paths().front();
}

void Manager::modifyInstance(const Context& context, const ObjectPath& path,
    const Instance& instance, const char** properties)
{
    const ProviderRegistration& provider = routing_.providerOf(path);
    CMPIInstanceMI& mi = instanceMI(provider);
    CollectedResult answer;
    callProvider(provider, "modifying instances", mi, mi.ft->modifyInstance, context, answer,
        targetOf(path, provider.className), instance.handle(), properties);
}

void Manager::deleteInstance(const Context& context, const ObjectPath& path)
{
    const ProviderRegistration& provider = routing_.providerOf(path);
    CMPIInstanceMI& mi = instanceMI(provider);
    CollectedResult answer;
    callProvider(provider, "deleting instances", mi, mi.ft->deleteInstance, context, answer,
        targetOf(path, provider.className));
}

void Manager::execQuery(const Context& context, const ObjectPath& path, const char* query,
    const char* language, ResultSink& sink)
{
    gatherAnswers({&routing_.providerOf(path)}, sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIInstanceMI& mi = instanceMI(provider);
            callProvider(provider, "queries", mi, mi.ft->execQuery, context, answer,
                targetOf(path, provider.className), query, language);
        });
}

void Manager::associators(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties, ResultSink& sink)
{
    gatherAnswers(routing_.associationProviders(source, association), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIAssociationMI& mi = associationMI(provider);
            AnswerOfClass wanted(answer, routing_, source.nameSpace(), association.resultClass);
            callProvider(provider, "following associations", mi, mi.ft->associators, context,
                wanted, targetOf(source, routing_.classNameOf(source)), provider.className.c_str(),
                routing_.resultClassFor(provider, source, association), association.role,
                association.resultRole, properties);
        });
}

void Manager::associatorNames(const Context& context, const ObjectPath& source,
    const Association& association, ResultSink& sink)
{
    gatherAnswers(routing_.associationProviders(source, association), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIAssociationMI& mi = associationMI(provider);
            AnswerOfClass wanted(answer, routing_, source.nameSpace(), association.resultClass);
            callProvider(provider, "following associations", mi, mi.ft->associatorNames, context,
                wanted, targetOf(source, routing_.classNameOf(source)), provider.className.c_str(),
                routing_.resultClassFor(provider, source, association), association.role,
                association.resultRole);
        });
}

void Manager::references(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties, ResultSink& sink)
{
    gatherAnswers(routing_.associationProviders(source, ofReferences(association)), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIAssociationMI& mi = associationMI(provider);
            AnswerOfClass wanted(answer, routing_, source.nameSpace(), association.resultClass);
            callProvider(provider, "finding references", mi, mi.ft->references, context, wanted,
                targetOf(source, routing_.classNameOf(source)), provider.className.c_str(),
                association.role, properties);
        });
}

void Manager::referenceNames(const Context& context, const ObjectPath& source,
    const Association& association, ResultSink& sink)
{
    gatherAnswers(routing_.associationProviders(source, ofReferences(association)), sink,
        [&](const ProviderRegistration& provider, ResultSink& answer) {
            CMPIAssociationMI& mi = associationMI(provider);
            AnswerOfClass wanted(answer, routing_, source.nameSpace(), association.resultClass);
            callProvider(provider, "finding references", mi, mi.ft->referenceNames, context, wanted,
                targetOf(source, routing_.classNameOf(source)), provider.className.c_str(),
                association.role);
        });
}

} // namespace Host
