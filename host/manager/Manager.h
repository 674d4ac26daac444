// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Dispatches an operation to the providers of the classes that it concerns.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/broker/CollectedResult.h"
#include "host/manager/ProviderLibrary.h"
#include "host/manager/ProviderRegistration.h"
#include "host/manager/Routing.h"

#include <map>
#include <memory>
#include <string>
#include <vector>

namespace Host {

// Thread-safe after its construction.
//
// An operation is called within a Request over the manager's broker on the calling thread, and with
// the request's context. The returned objects live as long as the request. It throws Refusal when
// it fails:
//
//   CMPI_RC_ERR_INVALID_CLASS   the path, or a class name beside it, names an unknown class
//   CMPI_RC_ERR_NOT_SUPPORTED   no provider serves the class, or it does not support this
//   CMPI_RC_ERR_NOT_FOUND       there is no such object, as there is none to get of a class that no
//                               provider serves
//   CMPI_RC_ERR_FAILED          providers call up in a circle
//
// and with a provider's own code and message when that fails. Where several providers are called, a
// failure of one is logged and the objects of the others are returned. Where none of them returned
// an object, the first failure is thrown, since an empty result would be wrong.
//
// Property lists end with a null and are null for all properties. The providers apply them, by the
// filter of their instances. Class and role names are null where a client left them out.
//
// Up-calls of providers call the manager on the same thread, in the same request and with the
// context that they pass; no lock is held meanwhile.
class Manager {
public:
    using Association = Routing::Association;

    // Loads the registered libraries and creates all management interfaces; up-calls of a factory
    // fail. Throws std::runtime_error naming the library that cannot be used and why. The classes
    // must outlive the manager.
    Manager(const ClassInformation& classes, std::vector<ProviderRegistration> registrations);
    // Calls the providers' cleanups. REQUIRES: no request is running.
    ~Manager();
    Manager(const Manager&) = delete;
    Manager& operator=(const Manager&) = delete;

    const Broker& broker() const noexcept { return broker_; }

    // Both return the objects of the path's class and of all its subclasses.
    CollectedResult enumerateInstanceNames(const Context& context, const ObjectPath& path) const;
    CollectedResult enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties) const;

    const Instance& getInstance(
        const Context& context, const ObjectPath& path, const char** properties) const;

    // The provider of each association class that refers to the source's class is called with that
    // class's name. Results of other classes than the result class and its subclasses are removed.
    CollectedResult associators(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties) const;
    CollectedResult associatorNames(
        const Context& context, const ObjectPath& source, const Association& association) const;
    // Of the association, only resultClass (here the association class) and role are used.
    CollectedResult references(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties) const;
    CollectedResult referenceNames(
        const Context& context, const ObjectPath& source, const Association& association) const;

private:
    std::vector<ProviderRegistration> load(std::vector<ProviderRegistration> registrations);
    template <typename Ask>
    CollectedResult askAssociations(const ObjectPath& source, const Association& association,
        const char* resultClass, const Ask& ask) const;

    Broker broker_;
    std::map<std::string, ProviderLibrary> libraries_; // by file; they hold the broker
    Routing routing_;
    std::unique_ptr<BrokerUpcalls> upcalls_;
};

} // namespace Host
