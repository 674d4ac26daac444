// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The up-calls that the shipped providers make: requests for objects of other providers.

#pragma once

namespace Host {

class Context;
class Enumeration;
class ObjectPath;

// Called on the provider's thread with the provider's context; an implementation may call
// providers in turn. The objects returned are in the thread's current arena. An operation fails by
// throwing Refusal with the status code.
class BrokerUpcalls {
public:
    virtual ~BrokerUpcalls() = default;

    virtual Enumeration& enumerateInstanceNames(const Context& context, const ObjectPath& path) = 0;
    // The list of properties ends with a null and is null for all properties.
    virtual Enumeration& enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties) = 0;
};

} // namespace Host
