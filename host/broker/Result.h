// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a provider delivers its answer to, behind a CMPIResult.

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Object.h"

namespace Host {

// Made by the host, on its stack, for one call of a provider. Used by the thread that calls.
class Result : public Encapsulated<Result, CMPIResult, Object::Kind::result> {
public:
    // The collection must outlive the result.
    explicit Result(CollectedResult& collected) : collected_(collected) {}

    static const CMPIResultFT functions;

private:
    void returnInstance(const CMPIInstance* instance);
    void returnObjectPath(const CMPIObjectPath* path);
    void returnDone();

    template <typename Delivery>
    void deliver(const Delivery& delivery);

    CollectedResult& collected_;
};

} // namespace Host
