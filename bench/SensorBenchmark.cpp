// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures the requests of ZUMLO_NumericSensor, and the steps of an enumeration by themselves.

#include "bench/Handle.h"
#include "bench/ModelMachine.h"
#include "diagnostics/TracedOperation.h"
#include "factory/SensorFactory.h"
#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "model/SensorHarvest.h"
#include "platform/logging/LogSettings.h"
#include "tests/providers/Factories.h"

#include <benchmark/benchmark.h>

namespace {

using namespace Vorn::SensorProfileProvider;
using Bench::handle;
using Bench::ModelMachine;
using Bench::reportPerObject;
using Bench::testNameSpace;

constexpr const char* Class = "ZUMLO_NumericSensor";

void EnumInstanceNames(benchmark::State& state)
{
    handle(SensorProfileProvider_Create_InstanceMI, nullptr, Class, state.range(0), state,
        [](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->enumerateInstanceNames(
                mi, request.context().handle(), result.handle(), ref.handle());
        });
    reportPerObject(state, state.range(0));
}

void EnumInstances(benchmark::State& state)
{
    handle(SensorProfileProvider_Create_InstanceMI, nullptr, Class, state.range(0), state,
        [](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->enumerateInstances(
                mi, request.context().handle(), result.handle(), ref.handle(), nullptr);
        });
    reportPerObject(state, state.range(0));
}

void GetInstance(benchmark::State& state)
{
    const std::string deviceID = ModelMachine::someDeviceID(state.range(0));
    handle(SensorProfileProvider_Create_InstanceMI, nullptr, Class, 1, state,
        [&](auto* mi, auto& request, auto& result, auto& ref) {
            ref.addKey("DeviceID", Host::Value::text(request.arena(), deviceID));
            return mi->ft->getInstance(
                mi, request.context().handle(), result.handle(), ref.handle(), nullptr);
        });
    reportPerObject(state, state.range(0)); // the request harvests all sensors
}

// ---- The steps of EnumInstances ----

void Harvest(benchmark::State& state)
{
    const ModelMachine machine(state.range(0));
    for (auto _ : state) {
        std::vector<Sensor> sensors;
        getSensorInstances(sensors);
        benchmark::DoNotOptimize(sensors.data());
    }
    reportPerObject(state, state.range(0));
}

// Measures a factory's constructor, which harvests the sensors and indexes the records.
void Records(benchmark::State& state)
{
    const ModelMachine machine(state.range(0));
    for (auto _ : state) {
        SensorFactory factory(true, false);
        benchmark::DoNotOptimize(&factory);
    }
    reportPerObject(state, state.range(0));
}

void Building(benchmark::State& state)
{
    const ModelMachine machine(state.range(0));
    const Host::Broker broker;
    SensorFactory factory(true, false);
    for (auto _ : state) {
        const Host::Request request(broker);
        std::vector<CMPIInstance*> instances;
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        factory.getAllSensorCMPIInstances(broker.handle(),
            request.makePath(testNameSpace, Class).handle(), nullptr, false, instances, &status);
        benchmark::DoNotOptimize(instances.data());
    }
    reportPerObject(state, state.range(0));
}

// ---- One trace point ----

const std::string component = "Nimbrel.Bench";

void TracePoint(benchmark::State& state, const RynLog::LogSettings& configuration)
{
    RynLog::configure(configuration);
    const int object = 0;
    for (auto _ : state) {
        const Vorn::TracedOperation traced({component, "Bench"}, "makeSensorInstance", [&] {
            return Vorn::parameterList(" broker=", &object, " ref=", &object, " snsr=", &object,
                " properties=", &object, " isObjPath=", false, " rc=", &object);
        });
        traced.entering(269);
    }
    RynLog::configure({6000, "off", "off"});
}

void TracePointOff(benchmark::State& state)
{
    TracePoint(state, {6000, "off", "off"});
}

// Uses the default settings: messages only, to the system log.
void TracePointBelowLevel(benchmark::State& state)
{
    TracePoint(state, {6000, "syslog", "off"});
}

void TracePointWritten(benchmark::State& state)
{
    TracePoint(state, {3000, "file:/dev/null", "file:/dev/null"});
}

void sensorCounts(benchmark::internal::Benchmark* benchmark)
{
    for (const int sensors : {10, 100, 1000, 10000, 60000})
        benchmark->Arg(sensors);
    benchmark->Unit(benchmark::kMicrosecond);
}

BENCHMARK(EnumInstanceNames)->Apply(sensorCounts);
BENCHMARK(EnumInstances)->Apply(sensorCounts);
BENCHMARK(GetInstance)->Apply(sensorCounts);
BENCHMARK(Harvest)->Apply(sensorCounts);
BENCHMARK(Records)->Apply(sensorCounts);
BENCHMARK(Building)->Apply(sensorCounts);
BENCHMARK(TracePointOff);
BENCHMARK(TracePointBelowLevel);
BENCHMARK(TracePointWritten);

} // namespace
