// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a provider is handed to deliver its answer to, behind a CMPIResult.

#pragma once

#include "host/broker/Object.h"

#include <mutex>

namespace Host {

class ResultSink;

// Made by the host, on its stack, for one call of a provider. Several threads of the
// provider may deliver; the sink sees them one after another.
class Result : public Encapsulated<Result, CMPIResult, Object::Kind::result> {
public:
    // The sink must outlive the result.
    explicit Result(ResultSink& sink) : Encapsulated(nullptr), sink_(sink) {}

    static const CMPIResultFT functions;

private:
    void returnData(const CMPIValue* value, CMPIType type);
    void returnInstance(const CMPIInstance* instance);
    void returnObjectPath(const CMPIObjectPath* path);
    void returnDone();
    void returnError(const CMPIError* error);

    template <typename Delivery>
    void deliver(Delivery delivery);

    ResultSink& sink_;
    std::mutex mutex_;
    bool isDone_ = false;
};

} // namespace Host
