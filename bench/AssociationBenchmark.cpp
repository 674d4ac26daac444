// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures the requests of the two association classes over the number of sensors and, for
// ZUMLO_SensorSystemDevice, of computer systems.

#include "bench/Handle.h"
#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/Value.h"
#include "tests/providers/Factories.h"

#include <cmpift.h>

#include <string>
#include <string_view>
#include <vector>

namespace {

using Bench::handle;
using Bench::reportPerObject;

constexpr const char* SensorClass = "ZUMLO_NumericSensor";
constexpr const char* SystemClass = "ZUMLO_ComputerSystem";
constexpr const char* CapabilitiesClass = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* elementCapabilities = "ZUMLO_SensorElementCapabilities";
constexpr const char* systemDevice = "ZUMLO_SensorSystemDevice";

// Answers up-calls with the given number of computer systems.
class Systems : public Host::BrokerUpcalls {
public:
    explicit Systems(std::int64_t count) : count_(count) {}

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context&, const Host::ObjectPath& path) override
    {
        return fill(path, [](const Host::ObjectPath& name) { return Host::Value::of(name); });
    }

    Host::Enumeration& enumerateInstances(
        const Host::Context&, const Host::ObjectPath& path, const char**) override
    {
        return fill(path, [](const Host::ObjectPath& name) {
            return Host::Value::of(Host::Instance::make(Host::Arena::required(), name, nullptr));
        });
    }

private:
    template <typename Element>
    Host::Enumeration& fill(const Host::ObjectPath& path, const Element& element)
    {
        Host::Arena& arena = Host::Arena::required();
        std::vector<Host::Value> elements;
        for (std::int64_t i = 0; i < count_; ++i) {
            Host::ObjectPath& name = path.copiedTo(arena);
            name.addKey("Name", Host::Value::text(arena, "system" + std::to_string(i)));
            elements.push_back(element(name));
        }
        return Host::Enumeration::make(arena, elements);
    }

    std::int64_t count_;
};

// Measures the enumeration of an association's own instances. Its arguments are the numbers of
// sensors and of systems.
template <typename Handler>
void enumerateAssociation(benchmark::State& state, const char* className, const Handler& handler)
{
    Systems systems(state.range(1));
    const auto create = std::string_view(className) == systemDevice
                            ? SensorSystemDeviceProvider_Create_InstanceMI
                            : SensorElementCapabilitiesProvider_Create_InstanceMI;
    const std::int64_t objects = state.range(0) * state.range(1);
    handle(create, &systems, className, objects, state, handler);
    reportPerObject(state, objects);
}

void enumerateNames(benchmark::State& state, const char* className)
{
    enumerateAssociation(state, className, [](auto* mi, auto& request, auto& result, auto& ref) {
        return mi->ft->enumerateInstanceNames(
            mi, request.context().handle(), result.handle(), ref.handle());
    });
}

void enumerateInstances(benchmark::State& state, const char* className)
{
    enumerateAssociation(state, className, [](auto* mi, auto& request, auto& result, auto& ref) {
        return mi->ft->enumerateInstances(
            mi, request.context().handle(), result.handle(), ref.handle(), nullptr);
    });
}

// ---- Objects associated with one object ----

// Measures a request along an association. `objects` is the number of objects in the answer.
template <typename Handler>
void associate(benchmark::State& state, const char* sourceClass, const char* associationClass,
    std::int64_t objects, const Handler& handler)
{
    Systems systems(state.range(1));
    const auto create = std::string_view(associationClass) == systemDevice
                            ? SensorSystemDeviceProvider_Create_AssociationMI
                            : SensorElementCapabilitiesProvider_Create_AssociationMI;
    handle(create, &systems, sourceClass, objects, state, handler);
    reportPerObject(state, objects);
}

void associators(benchmark::State& state, const char* sourceClass, const char* associationClass)
{
    associate(state, sourceClass, associationClass, state.range(0),
        [=](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->associators(mi, request.context().handle(), result.handle(),
                ref.handle(), associationClass, nullptr, nullptr, nullptr, nullptr);
        });
}

void associatorNames(benchmark::State& state, const char* sourceClass, const char* associationClass)
{
    associate(state, sourceClass, associationClass, state.range(0),
        [=](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->associatorNames(mi, request.context().handle(), result.handle(),
                ref.handle(), associationClass, nullptr, nullptr, nullptr);
        });
}

void references(benchmark::State& state, const char* sourceClass, const char* associationClass)
{
    associate(state, sourceClass, associationClass, state.range(0),
        [](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->references(mi, request.context().handle(), result.handle(), ref.handle(),
                nullptr, nullptr, nullptr);
        });
}

void referenceNames(benchmark::State& state, const char* sourceClass, const char* associationClass)
{
    associate(state, sourceClass, associationClass, state.range(0),
        [](auto* mi, auto& request, auto& result, auto& ref) {
            return mi->ft->referenceNames(
                mi, request.context().handle(), result.handle(), ref.handle(), nullptr, nullptr);
        });
}

void capabilitiesSizes(benchmark::internal::Benchmark* benchmark)
{
    benchmark->ArgsProduct({{10, 100, 1000, 10000}, {1}})->Unit(benchmark::kMicrosecond);
}

void systemSizes(benchmark::internal::Benchmark* benchmark)
{
    benchmark->ArgsProduct({{10, 100, 1000, 10000}, {1, 4}})->Unit(benchmark::kMicrosecond);
}

BENCHMARK_CAPTURE(enumerateNames, ElementCapabilities, elementCapabilities)
    ->Apply(capabilitiesSizes);
BENCHMARK_CAPTURE(enumerateInstances, ElementCapabilities, elementCapabilities)
    ->Apply(capabilitiesSizes);
BENCHMARK_CAPTURE(associators, ElementCapabilities, CapabilitiesClass, elementCapabilities)
    ->Apply(capabilitiesSizes);
BENCHMARK_CAPTURE(associatorNames, ElementCapabilities, CapabilitiesClass, elementCapabilities)
    ->Apply(capabilitiesSizes);
BENCHMARK_CAPTURE(references, ElementCapabilities, CapabilitiesClass, elementCapabilities)
    ->Apply(capabilitiesSizes);
BENCHMARK_CAPTURE(referenceNames, ElementCapabilities, CapabilitiesClass, elementCapabilities)
    ->Apply(capabilitiesSizes);

BENCHMARK_CAPTURE(enumerateNames, SystemDevice, systemDevice)->Apply(systemSizes);
BENCHMARK_CAPTURE(enumerateInstances, SystemDevice, systemDevice)->Apply(systemSizes);
BENCHMARK_CAPTURE(associators, SystemDevice, SystemClass, systemDevice)->Apply(systemSizes);
BENCHMARK_CAPTURE(associatorNames, SystemDevice, SystemClass, systemDevice)->Apply(systemSizes);
BENCHMARK_CAPTURE(references, SystemDevice, SystemClass, systemDevice)->Apply(systemSizes);
BENCHMARK_CAPTURE(referenceNames, SystemDevice, SystemClass, systemDevice)->Apply(systemSizes);

} // namespace
