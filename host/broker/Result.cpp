// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Result.h"

#include "host/broker/Error.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/ResultSink.h"
#include "host/broker/Slot.h"
#include "host/broker/Value.h"

namespace Host {

// Every delivery goes through here: in turn, not after the end, and refusals are told.
template <typename Delivery>
void Result::deliver(Delivery delivery)
{
    const std::lock_guard lock(mutex_);
    try {
        if (isDone_)
            throw Refusal(CMPI_RC_ERR_FAILED, "the result is closed");
        delivery();
    } catch (const Refusal& refusal) {
        sink_.refused(refusal.code());
        throw;
    }
}

void Result::returnData(const CMPIValue* value, CMPIType type)
{
    deliver([&] { sink_.data(Value::from(Arena::required(), value, type)); });
}

void Result::returnInstance(const CMPIInstance* instance)
{
    deliver([&] { sink_.instance(required<Instance>(instance)); });
}

void Result::returnObjectPath(const CMPIObjectPath* path)
{
    deliver([&] { sink_.path(required<ObjectPath>(path)); });
}

void Result::returnDone()
{
    deliver([&] {
        sink_.done();
        isDone_ = true;
    });
}

void Result::returnError(const CMPIError* error)
{
    deliver([&] { sink_.error(required<Error>(error)); });
}

const CMPIResultFT Result::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&Result::release>,
    .clone = notOffered, // there is one answer
    .returnData = slot<&Result::returnData>,
    .returnInstance = slot<&Result::returnInstance>,
    .returnObjectPath = slot<&Result::returnObjectPath>,
    .returnDone = slot<&Result::returnDone>,
    .returnError = slot<&Result::returnError>,
};

} // namespace Host
