// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ManagerUpcalls.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/manager/Manager.h"

namespace Host {

namespace {

// Runs the operation with a result of its own. All it makes lives in the caller's request.
template <typename Operation>
CollectedResult collected(const Operation& operation)
{
    CollectedResult answer;
    operation(answer);
    return answer;
}

} // namespace

unsigned ManagerUpcalls::capabilities() const noexcept
{
    return CMPI_MB_InstanceManipulation | CMPI_MB_AssociationTraversal | CMPI_MB_QueryExecution;
}

Enumeration& ManagerUpcalls::enumerateInstanceNames(const Context& context, const ObjectPath& path)
{
    return collected([&](ResultSink& sink) {
        manager_.enumerateInstanceNames(context, path, sink);
    }).pathEnumeration();
}

Enumeration& ManagerUpcalls::enumerateInstances(
    const Context& context, const ObjectPath& path, const char** properties)
{
    return collected([&](ResultSink& sink) {
        manager_.enumerateInstances(context, path, properties, sink);
    }).instanceEnumeration();
}

Instance& ManagerUpcalls::getInstance(
    const Context& context, const ObjectPath& path, const char** properties)
{
    // A copy is the caller's to change.
    return manager_.getInstance(context, path, properties).copiedTo(Arena::required());
}

ObjectPath& ManagerUpcalls::createInstance(
    const Context& context, const ObjectPath& path, const Instance& instance)
{
    return manager_.createInstance(context, path, instance).copiedTo(Arena::required());
}

void ManagerUpcalls::modifyInstance(const Context& context, const ObjectPath& path,
    const Instance& instance, const char** properties)
{
    manager_.modifyInstance(context, path, instance, properties);
}

void ManagerUpcalls::deleteInstance(const Context& context, const ObjectPath& path)
{
    manager_.deleteInstance(context, path);
}

Enumeration& ManagerUpcalls::execQuery(
    const Context& context, const ObjectPath& path, const char* query, const char* language)
{
    return collected([&](ResultSink& sink) {
        manager_.execQuery(context, path, query, language, sink);
    }).instanceEnumeration();
}

Enumeration& ManagerUpcalls::associators(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties)
{
    return collected([&](ResultSink& sink) {
        manager_.associators(context, source, association, properties, sink);
    }).instanceEnumeration();
}

Enumeration& ManagerUpcalls::associatorNames(
    const Context& context, const ObjectPath& source, const Association& association)
{
    return collected([&](ResultSink& sink) {
        manager_.associatorNames(context, source, association, sink);
    }).pathEnumeration();
}

Enumeration& ManagerUpcalls::references(const Context& context, const ObjectPath& source,
    const Association& association, const char** properties)
{
    return collected([&](ResultSink& sink) {
        manager_.references(context, source, association, properties, sink);
    }).instanceEnumeration();
}

Enumeration& ManagerUpcalls::referenceNames(
    const Context& context, const ObjectPath& source, const Association& association)
{
    return collected([&](ResultSink& sink) {
        manager_.referenceNames(context, source, association, sink);
    }).pathEnumeration();
}

} // namespace Host
