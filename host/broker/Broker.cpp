// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Broker.h"

#include "host/broker/Tables.h"

namespace Host {

Broker::Broker()
    : Object(kindOfSelf), handle_{static_cast<Object*>(this), &upcallFunctions,
                              &encapsulationFunctions, &operatingSystemFunctions, &memoryFunctions}
{
}

const Broker* Broker::of(const CMPIBroker* handle) noexcept
{
    const Object* const object = behind(handle);
    if (object == nullptr || object->kind() != kindOfSelf)
        return nullptr;
    return static_cast<const Broker*>(object);
}

} // namespace Host
