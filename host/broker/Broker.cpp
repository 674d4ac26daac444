// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Broker.h"

#include "host/broker/Tables.h"

namespace Host {

namespace {

// The address sanitizer finds uses of an ended request's objects only in memory that was freed.
#if defined(__SANITIZE_ADDRESS__)
constexpr std::size_t maximumKept = 0;
#elif defined(__has_feature)
constexpr std::size_t maximumKept = __has_feature(address_sanitizer) ? 0 : std::size_t{8} << 20;
#else
constexpr std::size_t maximumKept = std::size_t{8} << 20;
#endif

} // namespace

Broker::Broker()
    : Object(kindOfSelf), handle_{static_cast<Object*>(this), &upcallFunctions,
                              &encapsulationFunctions, &operatingSystemFunctions, &memoryFunctions},
      memory_(maximumKept)
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
