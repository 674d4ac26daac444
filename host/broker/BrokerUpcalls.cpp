// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/BrokerUpcalls.h"

#include "host/broker/Refusal.h"

namespace Host {

namespace {

[[noreturn]] void refuse(const char* operation)
{
    throw Refusal(CMPI_RC_ERR_NOT_SUPPORTED,
        std::string(operation) + " is not offered by this object manager");
}

} // namespace

Enumeration& BrokerUpcalls::enumerateInstanceNames(const Context&, const ObjectPath&)
{
    refuse("enumerateInstanceNames");
}

Enumeration& BrokerUpcalls::enumerateInstances(const Context&, const ObjectPath&, const char**)
{
    refuse("enumerateInstances");
}

Instance& BrokerUpcalls::getInstance(const Context&, const ObjectPath&, const char**)
{
    refuse("getInstance");
}

ObjectPath& BrokerUpcalls::createInstance(const Context&, const ObjectPath&, const Instance&)
{
    refuse("createInstance");
}

void BrokerUpcalls::modifyInstance(const Context&, const ObjectPath&, const Instance&, const char**)
{
    refuse("modifyInstance");
}

void BrokerUpcalls::deleteInstance(const Context&, const ObjectPath&)
{
    refuse("deleteInstance");
}

Enumeration& BrokerUpcalls::execQuery(const Context&, const ObjectPath&, const char*, const char*)
{
    refuse("execQuery");
}

Enumeration& BrokerUpcalls::associators(
    const Context&, const ObjectPath&, const Association&, const char**)
{
    refuse("associators");
}

Enumeration& BrokerUpcalls::associatorNames(const Context&, const ObjectPath&, const Association&)
{
    refuse("associatorNames");
}

Enumeration& BrokerUpcalls::references(
    const Context&, const ObjectPath&, const Association&, const char**)
{
    refuse("references");
}

Enumeration& BrokerUpcalls::referenceNames(const Context&, const ObjectPath&, const Association&)
{
    refuse("referenceNames");
}

} // namespace Host
