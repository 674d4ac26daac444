// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The up-calls of providers, taken to the manager they run under.

#pragma once

#include "host/broker/BrokerUpcalls.h"

namespace Host {

class Manager;

class ManagerUpcalls : public BrokerUpcalls {
public:
    // The manager must outlive it.
    explicit ManagerUpcalls(Manager& manager) : manager_(manager) {}

    unsigned capabilities() const noexcept override;

    Enumeration& enumerateInstanceNames(const Context& context, const ObjectPath& path) override;
    Enumeration& enumerateInstances(
        const Context& context, const ObjectPath& path, const char** properties) override;
    Instance& getInstance(
        const Context& context, const ObjectPath& path, const char** properties) override;
    ObjectPath& createInstance(
        const Context& context, const ObjectPath& path, const Instance& instance) override;
    void modifyInstance(const Context& context, const ObjectPath& path, const Instance& instance,
        const char** properties) override;
    void deleteInstance(const Context& context, const ObjectPath& path) override;
    Enumeration& execQuery(const Context& context, const ObjectPath& path, const char* query,
        const char* language) override;
    Enumeration& associators(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties) override;
    Enumeration& associatorNames(
        const Context& context, const ObjectPath& source, const Association& association) override;
    Enumeration& references(const Context& context, const ObjectPath& source,
        const Association& association, const char** properties) override;
    Enumeration& referenceNames(
        const Context& context, const ObjectPath& source, const Association& association) override;

private:
    Manager& manager_;
};

} // namespace Host
