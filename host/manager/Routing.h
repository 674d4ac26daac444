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

    // Returns the providers of the path's class and of all below it, in the order of registration;
    // never empty.
    Registrations providersBelow(const ObjectPath& path) const;

    // Returns the providers of the association classes that can lead away from the source: those
    // of the named class or below it that refer by the role to the source's class or to one above
    // it, and by another reference, the result role, to what may be of the result class. May be
    // empty.
    Registrations associationProviders(
        const ObjectPath& source, const Association& association) const;

    // Returns the result class for a provider that may know no superclasses: null instead of one
    // above all that the association leads to, since it excludes nothing there.
    const char* resultClassFor(const ProviderRegistration& registration, const ObjectPath& source,
        const Association& association) const;

    // Returns the name of the path's class as it is registered; as it stands when it is not.
    std::string classNameOf(const ObjectPath& path) const;

    // Whether the class is the other one or below it.
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
