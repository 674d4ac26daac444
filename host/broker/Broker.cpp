// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Broker.h"

#include "host/broker/Attachments.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Tables.h"

namespace Host {

namespace {

// What the broker does whoever implements the up-calls.
constexpr unsigned ownCapabilities =
    CMPI_MB_OSEncapsulationSupport | CMPI_MB_Supports_Extended_Error;

// Says no to everything, and has no state: one for all brokers.
BrokerUpcalls noUpcalls;

} // namespace

Broker::Broker(BrokerOptions options)
    : Object(kindOfSelf, nullptr), name_(std::move(options.name)),
      upcallTable_(upcallFunctions), handle_{static_cast<Object*>(this), &upcallTable_,
                                         &encapsulationFunctions, &operatingSystemFunctions,
                                         options.hasMemoryServices ? &memoryFunctions : nullptr},
      upcalls_(&noUpcalls), attachments_(std::make_unique<Attachments>())
{
    upcallTable_.brokerName = name_.c_str();
    upcallTable_.brokerCapabilities = ownCapabilities;
}

Broker::~Broker() = default;

const Broker* Broker::of(const CMPIBroker* handle) noexcept
{
    const Object* const object = behind(handle);
    if (object == nullptr || object->kind() != kindOfSelf)
        return nullptr;
    return static_cast<const Broker*>(object);
}

void Broker::setUpcalls(BrokerUpcalls* upcalls)
{
    upcalls_ = upcalls == nullptr ? &noUpcalls : upcalls;
    upcallTable_.brokerCapabilities = ownCapabilities | upcalls_->capabilities();
}

} // namespace Host
