// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures the calls of a provider, each in a request of the embedded broker.

#pragma once

#include "bench/ModelMachine.h"
#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"

#include <benchmark/benchmark.h>

#include <cstdint>

namespace Bench {

inline constexpr const char* testNameSpace = "root/cimv2";

inline void reportPerObject(benchmark::State& state, std::int64_t objects)
{
    state.counters["per_object"] = benchmark::Counter(static_cast<double>(objects),
        benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

// Runs the handler on a machine whose number of sensors is the first range. `create` is the
// provider's factory, `upcalls` answers its up-calls (null for none), and `objects` is the number
// of objects in the answer; any other number ends the benchmark with an error. The measured time
// includes the end of the request.
template <typename Create, typename Handler>
void handle(const Create& create, Host::BrokerUpcalls* upcalls, const char* className,
    std::int64_t objects, benchmark::State& state, const Handler& handler)
{
    const ModelMachine machine(state.range(0));
    Host::Broker broker;
    broker.setUpcalls(upcalls);
    auto* const mi = create(broker.handle(), nullptr, nullptr);
    for (auto _ : state) {
        Host::Request request(broker);
        Host::CollectedResult answer;
        Host::Result result(answer);
        const CMPIStatus status =
            handler(mi, request, result, request.makePath(testNameSpace, className));
        const auto answered = answer.instances().size() + answer.paths().size();
        if (status.rc != CMPI_RC_OK || answered != static_cast<std::size_t>(objects)) {
            state.SkipWithError("the request failed or its answer is not whole");
            break;
        }
    }
}

} // namespace Bench
