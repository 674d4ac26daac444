// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which providers an operation goes to.

#pragma once

#include "host/broker/BrokerUpcalls.h"
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
    using Association = BrokerUpcalls::Association;

    // The classes must outlive the routing.
    Routing(const ClassInformation& classes, std::vector<ProviderRegistration> registrations);

    const std::vector<ProviderRegistration>& registrations() const noexcept
    {
        return registrations_;
    }

    // Of the path's class itself: an object is of one class.
    const ProviderRegistration& providerOf(const ObjectPath& path) const;
    // The same; null where no provider serves the class.
    const ProviderRegistration* findProviderOf(const ObjectPath& path) const;

    // Of the path's class and of all below it, in the order of registration; never empty.
    Registrations providersBelow(const ObjectPath& path) const;

    // Of the association classes that can lead away from the source as the association says:
    // of its class or below it, referring by the role to the source's class or to one above
    // it, and by another reference, the result role, to what may be of the result class. May
    // be empty: where nothing can be found, there is nobody to ask.
    Registrations associationProviders(
        const ObjectPath& source, const Association& association) const;

    // The result class to hand to a provider that may know no superclasses: null instead of one
    // above all that the association leads to, since it excludes nothing there.
    const char* resultClassFor(const ProviderRegistration& registration, const ObjectPath& source,
        const Association& association) const;

    // The name of the path's class as it is registered; as it stands when it is not.
    std::string classNameOf(const ObjectPath& path) const;

    // Whether it is that class or one below it.
    bool isA(
        std::string_view nameSpace, std::string_view className, std::string_view ancestor) const;

private:
    void checkKnown(std::string_view nameSpace, std::string_view className) const;
    // The references at the other end from the source.
    std::vector<ReferenceProperty> farEnds(const ProviderRegistration& registration,
        const ObjectPath& source, const Association& association) const;
    bool canReach(std::string_view nameSpace, const ReferenceProperty& far,
        const Association& association) const;

    const ClassInformation& classes_;
    std::vector<ProviderRegistration> registrations_;
};

} // namespace Host
