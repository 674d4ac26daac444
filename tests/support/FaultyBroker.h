// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A broker that fails on demand: it stands between a provider and the embedded broker,
// counts the calls of each kind, and makes the n-th call of a kind fail. It copies a whole
// CMPIValue from each address of a property, an array element or a key, as some object managers do:
// AddressSanitizer reports a value that is shorter.
//
// A test runs the provider once to learn how many calls of each kind it makes, then once for
// each of them with a fault planned:
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
    // What the status says; CMPI_RC_OK leaves it as the provider handed it over, or as the
    // call left it.
    CMPIrc code = CMPI_RC_ERR_FAILED;
};

// In force on the thread it was made on, while it lives; the one made last counts. Objects
// that came through it keep working after its end, without faults.
class FaultyBroker {
public:
    // The broker must outlive this object.
    explicit FaultyBroker(const Host::Broker& broker);
    ~FaultyBroker();
    FaultyBroker(const FaultyBroker&) = delete;
    FaultyBroker& operator=(const FaultyBroker&) = delete;

    // What the provider gets for its broker.
    const CMPIBroker* handle() const noexcept { return &handle_; }
    // The same objects; calls made through them are counted and fail, too.
    const CMPIObjectPath* watch(const CMPIObjectPath* path) const;
    const CMPIResult* watch(const CMPIResult* result) const;

    // Adds a fault. Counting goes on from where it stands.
    void plan(const Fault& fault) { faults_.push_back(fault); }
    // Forgets faults, counts and calls.
    void reset();

    unsigned count(BrokerCall call) const;
    // Every call in order.
    const std::vector<BrokerCall>& calls() const noexcept { return calls_; }
    // Every call of a path's function in order with the class of the path, such as
    // "addKey ZUMLO_NumericSensor".
    const std::vector<std::string>& pathCalls() const noexcept { return pathCalls_; }
    // How many planned faults came true.
    unsigned fired() const noexcept { return fired_; }

    // For the interposed functions: counts a call and says how it fails; null when it is to
    // succeed, or when no faulty broker is in force.
    static const Fault* arrived(BrokerCall call);
    // The same for a function of a path.
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
