// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A broker that injects faults: it forwards the calls of a provider to the embedded broker, counts
// those of each kind, and makes the n-th call of a kind fail. It copies a whole CMPIValue from the
// address of each property, array element and key, as some object managers do, so that
// AddressSanitizer reports a value that is shorter.
//
// A test runs the provider once to count its calls of each kind, and then once for each call with a
// fault in it:
//
//     for (const BrokerCall call : allBrokerCalls())
//         for (const FaultManner manner : mannersOf(call))
//             for (unsigned n = 1; n <= counted[call]; ++n) {
//                 FaultyBroker faulty(broker);
//                 faulty.plan({call, n, manner});
//                 ...
//             }

#pragma once

#include "tests/support/BrokerCall.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <array>
#include <cstddef>
#include <span>
#include <string>
#include <vector>

namespace Host {
class Broker;
}

namespace Testing {

struct Fault {
    BrokerCall call;
    unsigned nth; // 1 is the first call of its kind
    FaultManner manner;
    // The code that is set in the status; CMPI_RC_OK leaves the status as the provider or the call
    // set it.
    CMPIrc code = CMPI_RC_ERR_FAILED;
};

// Active during its lifetime on the thread that constructed it; of several, the last one is active.
// Objects that it returned stay usable after its destruction, without faults.
class FaultyBroker {
public:
    // The broker must outlive this object.
    explicit FaultyBroker(const Host::Broker& broker);
    ~FaultyBroker();
    FaultyBroker(const FaultyBroker&) = delete;
    FaultyBroker& operator=(const FaultyBroker&) = delete;

    // Returns the broker to be given to the provider.
    const CMPIBroker* handle() const noexcept { return &handle_; }
    // Both return the same object with interposed functions, whose calls are counted and fail, too.
    const CMPIObjectPath* watch(const CMPIObjectPath* path) const;
    const CMPIResult* watch(const CMPIResult* result) const;

    // Adds a fault. The counts are not reset.
    void plan(const Fault& fault) { faults_.push_back(fault); }
    // Clears the faults, the counts and the calls.
    void reset();

    unsigned count(BrokerCall call) const;
    // Returns all calls in order.
    const std::vector<BrokerCall>& calls() const noexcept { return calls_; }
    // Returns all calls of functions of paths in order with the class of the path, such as "addKey
    // ZUMLO_NumericSensor".
    const std::vector<std::string>& pathCalls() const noexcept { return pathCalls_; }
    // Returns how many of the planned faults have occurred.
    unsigned fired() const noexcept { return fired_; }

    // Counts a call of an interposed function. Returns its fault; null when it is to succeed or no
    // faulty broker is active.
    static const Fault* arrived(BrokerCall call);
    // Does the same for a function of a path.
    static const Fault* arrived(BrokerCall call, const CMPIObjectPath* path);

private:
    CMPIBrokerFT upcalls_;
    CMPIBroker handle_;
    FaultyBroker* before_;
    std::vector<Fault> faults_;
    std::vector<BrokerCall> calls_;
    std::vector<std::string> pathCalls_;
    std::array<unsigned, brokerCallCount> counts_{};
    unsigned fired_ = 0;
};

} // namespace Testing
