// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Result.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"

namespace Host {

// Runs a delivery unless the result is closed, and counts those that are refused.
template <typename Delivery>
void Result::deliver(const Delivery& delivery)
{
    try {
        if (collected_.isDone())
            throw Refusal(CMPI_RC_ERR_FAILED, "the result is closed");
        delivery();
    } catch (const Refusal&) {
        collected_.addRefusal();
        throw;
    }
}

// Providers may change an object after they delivered it, hence the copies.
void Result::returnInstance(const CMPIInstance* instance)
{
    deliver([&] { collected_.add(required<Instance>(instance).copiedTo(Arena::required())); });
}

void Result::returnObjectPath(const CMPIObjectPath* path)
{
    deliver([&] { collected_.add(required<ObjectPath>(path).copiedTo(Arena::required())); });
}

void Result::returnDone()
{
    deliver([&] { collected_.close(); });
}

const CMPIResultFT Result::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .returnData = notOffered,
    .returnInstance = slot<&Result::returnInstance>,
    .returnObjectPath = slot<&Result::returnObjectPath>,
    .returnDone = slot<&Result::returnDone>,
    .returnError = notOffered,
};

} // namespace Host
