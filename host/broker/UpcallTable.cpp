// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Broker.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Context.h"
#include "host/broker/Enumeration.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/Tables.h"

namespace Host {

namespace {

BrokerUpcalls& upcallsOf(const Broker& broker, const char* operation)
{
    if (broker.upcalls() == nullptr)
        throw Refusal(CMPI_RC_ERR_NOT_SUPPORTED,
            std::string(operation) + " is not offered by this object manager");
    return *broker.upcalls();
}

Enumeration& enumerateInstanceNames(
    const Broker& broker, const CMPIContext* context, const CMPIObjectPath* path)
{
    return upcallsOf(broker, "enumerateInstanceNames")
        .enumerateInstanceNames(required<Context>(context), required<ObjectPath>(path));
}

Enumeration& enumerateInstances(const Broker& broker, const CMPIContext* context,
    const CMPIObjectPath* path, const char** properties)
{
    return upcallsOf(broker, "enumerateInstances")
        .enumerateInstances(required<Context>(context), required<ObjectPath>(path), properties);
}

} // namespace

const CMPIBrokerFT upcallFunctions = {
    // CMPI defines no lower capability than basic reading, although getInstance is not supported.
    .brokerCapabilities = CMPI_MB_BasicRead,
    .brokerVersion = CMPIVersion200,
    .brokerName = "sensor-profile",
    .prepareAttachThread = notOffered,
    .attachThread = notOffered,
    .detachThread = notOffered,
    .deliverIndication = notOffered,
    .enumerateInstanceNames = slot<&enumerateInstanceNames>,
    .getInstance = notOffered,
    .createInstance = notOffered,
    .modifyInstance = notOffered,
    .deleteInstance = notOffered,
    .execQuery = notOffered,
    .enumerateInstances = slot<&enumerateInstances>,
    .associators = notOffered,
    .associatorNames = notOffered,
    .references = notOffered,
    .referenceNames = notOffered,
    .invokeMethod = notOffered,
    .setProperty = notOffered,
    .getProperty = notOffered,
};

} // namespace Host
