// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The way from a provider back into the object manager: what the host implements so that a
// provider can ask for objects of other providers.

#pragma once

#include <cmpidt.h>

#include <cstddef>

namespace Host {

class Broker;
class Context;
class Enumeration;
class Instance;
class ObjectPath;
class Value;

// Called on the provider's thread with the provider's context, and without any lock of the
// broker held: an operation may call providers in turn, from a request nested in the
// caller's. Answers live in the current arena. An operation says no by throwing Refusal with
// the status code; what is not overridden answers CMPI_RC_ERR_NOT_SUPPORTED.
//
// Property lists end with a null and are null for all properties; class, role and result
// class names are null when the caller named none.
class BrokerUpcalls {
public:
    struct Association {
        const char* associationClass = nullptr;
        const char* resultClass = nullptr;
        const char* role = nullptr;
        const char* resultRole = nullptr;
    };

    virtual ~BrokerUpcalls() = default;

    // The CMPI_MB_ bits this implementation earns the broker.
    virtual unsigned capabilities() const noexcept { return 0; }

    virtual Enumeration& enumerateInstanceNames(const Context& context, const ObjectPath& path);
    virtual Enumeration& enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties);
    virtual Instance& getInstance(
        const Context& context, const ObjectPath& path, const char** properties);
    virtual ObjectPath& createInstance(
        const Context& context, const ObjectPath& path, const Instance& instance);
    virtual void modifyInstance(const Context& context, const ObjectPath& path,
        const Instance& instance, const char** properties);
    virtual void deleteInstance(const Context& context, const ObjectPath& path);
    virtual Enumeration& execQuery(
        const Context& context, const ObjectPath& path, const char* query, const char* language);
    virtual Enumeration& associators(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties);
    virtual Enumeration& associatorNames(
        const Context& context, const ObjectPath& source, const Association& association);
    // Of the association, resultClass and role count.
    virtual Enumeration& references(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties);
    virtual Enumeration& referenceNames(
        const Context& context, const ObjectPath& source, const Association& association);
};

} // namespace Host
