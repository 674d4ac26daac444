// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Selects the providers that an operation is dispatched to.

#pragma once

#include "host/broker/ClassInformation.h"
#include "host/manager/ProviderRegistration.h"

#include <string>
#include <string_view>
#include <vector>

namespace Host {

class ObjectPath;

// Immutable. Its operations throw Refusal: CMPI_RC_ERR_INVALID_CLASS for a class that is not
// known, CMPI_RC_ERR_NOT_SUPPORTED for one that is known but that no provider serves.
class Routing {
public:
    using Registrations = std::vector<const ProviderRegistration*>;
    // The filters of an association operation (DSP0200, Associators); null for those that are
    // absent.
    struct Association {
        const char* associationClass = nullptr;
        const char* resultClass = nullptr;
        const char* role = nullptr;
        const char* resultRole = nullptr;
    };

    // The classes must outlive the routing.
    Routing(const ClassInformation& classes, std::vector<ProviderRegistration> registrations);

    // Returns the provider of the path's class itself; null where no provider serves it.
    const ProviderRegistration* findProviderOf(const ObjectPath& path) const;

    // Returns the providers of the path's class and of its subclasses, in the order of
    // registration; never empty.
    Registrations providersBelow(const ObjectPath& path) const;

    // Returns the providers of the association classes that can lead from the source: the named
    // class or its subclasses that refer by the role to the source's class or a superclass, and by
    // another reference, the result role, to objects that may be of the result class. May be empty.
    Registrations associationProviders(
        const ObjectPath& source, const Association& association) const;

    // Returns the result class for a provider that may not support superclasses: null instead of a
    // superclass of all far ends, since that excludes nothing.
    const char* resultClassFor(const ProviderRegistration& registration, const ObjectPath& source,
        const Association& association) const;

    // Returns the name of the path's class as it is registered, or unchanged when it is not.
    std::string classNameOf(const ObjectPath& path) const;

    // Returns whether the class is the other one or derived from it.
    bool isA(
        std::string_view nameSpace, std::string_view className, std::string_view ancestor) const;

private:
    void checkKnown(std::string_view nameSpace, std::string_view className) const;
    // Returns the references to the end opposite the source.
    std::vector<ReferenceProperty> farEnds(const ProviderRegistration& registration,
        const ObjectPath& source, const Association& association) const;
    bool canReach(std::string_view nameSpace, const ReferenceProperty& far,
        const Association& association) const;

    const ClassInformation& classes_;
    std::vector<ProviderRegistration> registrations_;
};

} // namespace Host
