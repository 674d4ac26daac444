// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The result to which a provider delivers objects, behind a CMPIResult.

#pragma once

#include "host/broker/CollectedResult.h"
#include "host/broker/Object.h"

namespace Host {

// Constructed for one call of a provider, and used by the calling thread.
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
