// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Each up-call tests what it was handed and passes it to the host's BrokerUpcalls.

#include "host/broker/Attachments.h"
#include "host/broker/Broker.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Context.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/Tables.h"

namespace Host {

namespace {

Context& prepareAttachThread(const Broker& broker, const CMPIContext* context)
{
    return broker.attachments().prepare(required<Context>(context));
}

void attachThread(const Broker& broker, const CMPIContext* context)
{
    broker.attachments().attach(required<Context>(context));
}

void detachThread(const Broker& broker, const CMPIContext* context)
{
    broker.attachments().detach(required<Context>(context));
}

Enumeration& enumerateInstanceNames(
    const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path)
{
    return broker.upcalls().enumerateInstanceNames(
        required<Context>(context), required<ObjectPath>(path));
}

Enumeration& enumerateInstances(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char** properties)
{
    return broker.upcalls().enumerateInstances(
        required<Context>(context), required<ObjectPath>(path), properties);
}

Instance& getInstance(const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path,
    const char** properties)
{
    return broker.upcalls().getInstance(
        required<Context>(context), required<ObjectPath>(path), properties);
}

ObjectPath& createInstance(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const CMPIInstance* instance)
{
    return broker.upcalls().createInstance(
        required<Context>(context), required<ObjectPath>(path), required<Instance>(instance));
}

void modifyInstance(const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path,
    const CMPIInstance* instance, const char** properties)
{
    broker.upcalls().modifyInstance(required<Context>(context), required<ObjectPath>(path),
        required<Instance>(instance), properties);
}

void deleteInstance(const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path)
{
    broker.upcalls().deleteInstance(required<Context>(context), required<ObjectPath>(path));
}

Enumeration& execQuery(const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path,
    const char* query, const char* language)
{
    return broker.upcalls().execQuery(
        required<Context>(context), required<ObjectPath>(path), query, language);
}

Enumeration& associators(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char* associationClass, const char* resultClass,
    const char* role, const char* resultRole, const char** properties)
{
    return broker.upcalls().associators(required<Context>(context), required<ObjectPath>(path),
        {associationClass, resultClass, role, resultRole}, properties);
}

Enumeration& associatorNames(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char* associationClass, const char* resultClass,
    const char* role, const char* resultRole)
{
    return broker.upcalls().associatorNames(required<Context>(context), required<ObjectPath>(path),
        {associationClass, resultClass, role, resultRole});
}

Enumeration& references(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char* resultClass, const char* role, const char** properties)
{
    return broker.upcalls().references(required<Context>(context), required<ObjectPath>(path),
        {nullptr, resultClass, role, nullptr}, properties);
}

Enumeration& referenceNames(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char* resultClass, const char* role)
{
    return broker.upcalls().referenceNames(required<Context>(context), required<ObjectPath>(path),
        {nullptr, resultClass, role, nullptr});
}

} // namespace

const CMPIBrokerFT upcallFunctions = {
    .brokerCapabilities = 0,
    .brokerVersion = CMPIVersion200,
    .brokerName = "",
    .prepareAttachThread = slot<&prepareAttachThread>,
    .attachThread = slot<&attachThread>,
    .detachThread = slot<&detachThread>,
    .deliverIndication = notOffered,
    .enumerateInstanceNames = slot<&enumerateInstanceNames>,
    .getInstance = slot<&getInstance>,
    .createInstance = slot<&createInstance>,
    .modifyInstance = slot<&modifyInstance>,
    .deleteInstance = slot<&deleteInstance>,
    .execQuery = slot<&execQuery>,
    .enumerateInstances = slot<&enumerateInstances>,
    .associators = slot<&associators>,
    .associatorNames = slot<&associatorNames>,
    .references = slot<&references>,
    .referenceNames = slot<&referenceNames>,
    .invokeMethod = notOffered,
    .setProperty = notOffered,
    .getProperty = notOffered,
};

} // namespace Host
