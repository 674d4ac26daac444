// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Memory that goes with the request: freeing it early changes nothing, except for clones.

#include "host/broker/Arguments.h"
#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/DateTime.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Tables.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace Host {

namespace {

// Stands before each block, so that it can be reallocated.
struct alignas(std::max_align_t) Header {
    std::size_t size;
};

void* allocate(const Broker&, std::size_t size)
{
    if (size > std::numeric_limits<std::size_t>::max() - sizeof(Header))
        throw Refusal(CMPI_RC_ERR_FAILED, "no such amount of memory");
    auto* const header = static_cast<Header*>(Arena::required().bytes(sizeof(Header) + size));
    header->size = size;
    return header + 1;
}

void* allocateZeroed(const Broker& broker, std::size_t count, std::size_t size)
{
    if (size != 0 && count > std::numeric_limits<std::size_t>::max() / size)
        throw Refusal(CMPI_RC_ERR_FAILED, "no such amount of memory");
    return std::memset(allocate(broker, count * size), 0, count * size);
}

void* reallocate(const Broker& broker, void* block, std::size_t size)
{
    void* const moved = allocate(broker, size);
    if (block != nullptr)
        std::memcpy(moved, block, std::min(size, (static_cast<Header*>(block) - 1)->size));
    return moved;
}

char* duplicate(const Broker& broker, const char* text)
{
    const std::size_t size = requiredText(text, "the text").size() + 1;
    return static_cast<char*>(std::memcpy(allocate(broker, size), text, size));
}

void forget(const Broker&, void*) {}

template <typename Self>
void release(const Broker&, typename Self::Handle* handle)
{
    required<Self>(handle).release();
}

} // namespace

const CMPIBrokerMemFT memoryFunctions = {
    .ftVersion = CMPIVersion200,
    .mark = notOffered,
    .release = notOffered,
    .cmpiMalloc = slot<&allocate>,
    .cmpiCalloc = slot<&allocateZeroed>,
    .cmpiRealloc = slot<&reallocate>,
    .cmpiStrDup = slot<&duplicate>,
    .cmpiFree = slot<&forget>,
    .freeInstance = slot<&release<Instance>>,
    .freeObjectPath = slot<&release<ObjectPath>>,
    .freeArgs = slot<&release<Arguments>>,
    .freeString = slot<&release<String>>,
    .freeArray = slot<&release<Array>>,
    .freeDateTime = slot<&release<DateTime>>,
    .freeSelectExp = notOffered,
};

} // namespace Host
