// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The object manager: takes an operation to the providers of the classes it concerns.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/manager/ProviderRegistration.h"
#include "host/manager/ProviderSource.h"
#include "host/manager/Routing.h"

#include <functional>
#include <memory>
#include <vector>

namespace Host {

class ResultSink;

// After its construction used from any thread, by many at a time.
//
// An operation is called within a Request over the manager's broker on the calling thread, and
// with the request's context. Its answer goes to the sink, whose done() is called once when all
// went well. It throws Refusal when it fails:
//
//   CMPI_RC_ERR_INVALID_CLASS   the path, or a class name beside it, names an unknown class
//   CMPI_RC_ERR_NOT_SUPPORTED   no provider serves the class, or it does not support this
//   CMPI_RC_ERR_NOT_FOUND       there is no such object, as there is none to get of a class that no
//                               provider serves
//   CMPI_RC_ERR_FAILED          a provider cannot be loaded, or providers call up in a circle
//
// and with a provider's own code and message when that fails. What the sink has got before a
// failure is to be forgotten. How the answers of several providers become one, and when one
// that fails is passed over, gatherAnswers tells.
//
// Property lists end with a null and are null for all properties. They are the providers' to
// observe, by the filter on their instances. Class and role names that are null are not given.
//
// Providers call up through the broker and come back here, on the same thread, in the same
// request and with the context they hand over; no lock is held meanwhile.
class Manager {
public:
    using Association = BrokerUpcalls::Association;
    using SourceMaker = std::function<std::unique_ptr<ProviderSource>(const Broker&)>;

    // With providers loaded from the registered files. The classes must outlive the manager.
    Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations);
    // With providers of another origin.
    Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations,
        const SourceMaker& makeSource);
    // Lets providers clean up. REQUIRES: no request is running.
    ~Manager();
    Manager(const Manager&) = delete;
    Manager& operator=(const Manager&) = delete;

    const Broker& broker() const noexcept { return broker_; }

    // Loads all that is registered, which is otherwise loaded when it is first needed. Throws
    // Refusal (CMPI_RC_ERR_FAILED) for the first that cannot be used, naming it and the reason.
    void preload();

    // Of the path's class and of all classes below it.
    void enumerateInstanceNames(const Context& context, const ObjectPath& path, ResultSink& sink);
    void enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties, ResultSink& sink);

    // Lives as long as the request.
    const Instance& getInstance(
        const Context& context, const ObjectPath& path, const char** properties);
    const ObjectPath& createInstance(
        const Context& context, const ObjectPath& path, const Instance& instance);
    void modifyInstance(const Context& context, const ObjectPath& path, const Instance& instance,
        const char** properties);
    void deleteInstance(const Context& context, const ObjectPath& path);
    void execQuery(const Context& context, const ObjectPath& path, const char* query,
        const char* language, ResultSink& sink);

    // Each association class that leads away from the source is asked by its own name. Results
    // are of the result class or below it, whether their provider cares or not.
    void associators(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties, ResultSink& sink);
    void associatorNames(const Context& context, const ObjectPath& source,
        const Association& association, ResultSink& sink);
    // Of the association, resultClass, which is the association class here, and role count.
    void references(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties, ResultSink& sink);
    void referenceNames(const Context& context, const ObjectPath& source,
        const Association& association, ResultSink& sink);

private:
    CMPIInstanceMI& instanceMI(const ProviderRegistration& registration);
    CMPIAssociationMI& associationMI(const ProviderRegistration& registration);

    Routing routing_;
    std::unique_ptr<BrokerUpcalls> upcalls_;
    Broker broker_;
    std::unique_ptr<ProviderSource> source_; // goes first: providers hold the broker
};

} // namespace Host
