// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures requests on machines with chips, and reads of the same attributes by the kernel's files,
// by libsensors and by the program `sensors`. Prints a table of medians for each machine.
//
//     bench_hwmon [rounds]
//
// `bench_hwmon list` is one of the programs of the table: it does what no program that lists the
// sensors by libsensors can do without.

#include "bench/HwmonTree.h"
#include "bench/Median.h"
#include "bench/ProcessorTime.h"
#include "bench/ServerProcess.h"
#include "bench/Skim.h"
#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "model/SensorHarvest.h"
#include "platform/logging/LogSettings.h"
#include "platform/utilities/Descriptor.h"
#include "tests/providers/Factories.h"
#include "tests/support/CimCall.h"
#include "tests/support/Environment.h"
#include "tests/support/HttpClient.h"
#include "tests/tools/ChildProcess.h"
#include "tools/serve/FreedMemory.h"

#include <fcntl.h>
#include <sensors/sensors.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <functional>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

namespace {

using Bench::HwmonTree;
using Clock = std::chrono::steady_clock;

constexpr const char* className = "ZUMLO_NumericSensor";

struct Cost {
    double cpu; // milliseconds
    double wall;
};

double milliseconds(Clock::duration duration)
{
    return std::chrono::duration<double, std::milli>(duration).count();
}

Cost costOf(const std::function<void()>& work)
{
    const double cpu = Bench::processorTime();
    const auto wall = Clock::now();
    work();
    return {Bench::processorTime() - cpu, milliseconds(Clock::now() - wall)};
}

// Returns what the work costs the server, with the time that it takes to free the answer.
Cost costOf(const std::function<void()>& work, const Bench::ServerProcess& server)
{
    const ::clockid_t clock = Bench::clockOf(server.id());
    const double cpu = Bench::processorTime(clock);
    const auto begin = Clock::now();
    work();
    const double wall = milliseconds(Clock::now() - begin);
    std::this_thread::sleep_for(std::chrono::milliseconds(5));
    return {Bench::processorTime(clock) - cpu, wall};
}

void expect(bool holds, const char* what)
{
    if (!holds)
        throw std::runtime_error(std::string("unexpected: ") + what);
}

// ---- In this process ----

// Reads each attribute from the descriptor of its chip's folder.
class RawReads {
public:
    explicit RawReads(const HwmonTree& tree) : tree_(&tree)
    {
        for (const HwmonTree::Chip& chip : tree.chips())
            folders_.emplace_back(::open(chip.folder.c_str(), O_RDONLY | O_DIRECTORY));
    }

    void operator()() const
    {
        std::array<char, 64> text{};
        for (std::size_t i = 0; i < folders_.size(); ++i)
            for (const std::string& attribute : tree_->chips()[i].attributes) {
                const int file = ::openat(folders_[i].number(), attribute.c_str(), O_RDONLY);
                expect(::read(file, text.data(), text.size()) > 0, "an unreadable attribute");
                ::close(file);
            }
    }

private:
    const HwmonTree* tree_;
    std::vector<Vorn::Descriptor> folders_;
};

// Reads each attribute through libsensors, whose list of chips the requests have initialised.
void readBySubfeatures(std::size_t attributes)
{
    std::size_t read = 0;
    int chipNumber = 0;
    while (const auto* const chip = sensors_get_detected_chips(nullptr, &chipNumber)) {
        int featureNumber = 0;
        while (const auto* const feature = sensors_get_features(chip, &featureNumber)) {
            int number = 0;
            while (const auto* const each = sensors_get_all_subfeatures(chip, feature, &number)) {
                double value = 0.0;
                expect(sensors_get_value(chip, each->number, &value) == 0, "an unreadable value");
                ++read;
            }
        }
    }
    expect(read == attributes, "another number of subfeatures");
}

// Lists the chips and labels by libsensors, as it finds its configuration, and reads each attribute
// from the descriptor of its chip's folder.
void listAndRead()
{
    expect(sensors_init(nullptr) == 0, "a failed sensors_init");
    std::array<char, 64> text{};
    int chipNumber = 0;
    while (const auto* const chip = sensors_get_detected_chips(nullptr, &chipNumber)) {
        const Vorn::Descriptor folder(::open(chip->path, O_RDONLY | O_DIRECTORY));
        int featureNumber = 0;
        while (const auto* const feature = sensors_get_features(chip, &featureNumber)) {
            const std::unique_ptr<char, decltype(&std::free)> label(
                sensors_get_label(chip, feature), &std::free);
            expect(label != nullptr, "a feature without a label");
            int number = 0;
            while (const auto* const each = sensors_get_all_subfeatures(chip, feature, &number)) {
                const Vorn::Descriptor file(::openat(folder.number(), each->name, O_RDONLY));
                expect(
                    ::read(file.number(), text.data(), text.size()) > 0, "an unreadable attribute");
            }
        }
    }
    sensors_cleanup();
}

void harvest(std::size_t sensors)
{
    std::vector<Vorn::SensorProfileProvider::Sensor> records;
    Vorn::SensorProfileProvider::getSensorInstances(records);
    expect(records.size() == sensors, "another number of records");
}

class Provider {
public:
    template <typename Handler>
    void request(std::size_t objects, const Handler& handler) const
    {
        Host::Request request(broker_);
        Host::CollectedResult answer;
        Host::Result result(answer);
        auto& path = request.makePath("root/cimv2", className);
        const CMPIStatus status = handler(mi_, request, result.handle(), path);
        expect(status.rc == CMPI_RC_OK, "a failed request");
        expect(answer.instances().size() + answer.paths().size() == objects,
            "another number of objects");
    }

private:
    Host::Broker broker_;
    CMPIInstanceMI* mi_ =
        SensorProfileProvider_Create_InstanceMI(broker_.handle(), nullptr, nullptr);
};

// ---- Other processes ----

// Returns the processor time of the child processes that have ended.
double childrenTime()
{
    ::rusage usage{};
    ::getrusage(RUSAGE_CHILDREN, &usage);
    const auto of = [](const ::timeval& time) {
        return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_usec) / 1e3;
    };
    return of(usage.ru_utime) + of(usage.ru_stime);
}

Cost program(const std::string& file, const std::vector<std::string>& arguments)
{
    using Testing::RunOptions;
    const double cpu = childrenTime();
    const auto begin = Clock::now();
    const Testing::Ended ended = Testing::run(
        arguments, {.program = file, .out = RunOptions::Out::file, .outFile = "/dev/null"});
    const double wall = milliseconds(Clock::now() - begin);
    expect(ended.code == 0, "a program that fails");
    return {childrenTime() - cpu, wall};
}

// ---- The table ----

struct Row {
    const char* name;
    const char* peer; // an earlier row
    std::function<Cost()> measure;
    Cost median = {};
};

// Measures the rows in turn, so that what disturbs the machine meets all of them.
void measure(std::vector<Row>& rows, std::size_t rounds)
{
    std::vector<std::vector<double>> cpu(rows.size());
    std::vector<std::vector<double>> wall(rows.size());
    for (std::size_t round = 0; round <= rounds; ++round)
        for (std::size_t i = 0; i < rows.size(); ++i) {
            const Cost cost = rows[i].measure();
            if (round == 0) // fills caches
                continue;
            cpu[i].push_back(cost.cpu);
            wall[i].push_back(cost.wall);
        }
    for (std::size_t i = 0; i < rows.size(); ++i)
        rows[i].median = {Bench::median(cpu[i]), Bench::median(wall[i])};
}

void print(const std::vector<Row>& rows, std::size_t sensors)
{
    for (const Row& row : rows) {
        const auto peer = std::find_if(rows.begin(), rows.end(),
            [&](const Row& other) { return std::string(other.name) == row.peer; });
        std::printf("| %zu | %s | %.2f | %.2f | %.2f | %.2f | %.2f of %s |\n", sensors, row.name,
            row.median.cpu, row.median.wall, row.median.cpu * 1e3 / static_cast<double>(sensors),
            row.median.cpu / rows.front().median.cpu, row.median.cpu / peer->median.cpu,
            peer->name);
    }
}

// Starts a server that reads chips in parallel, as servers do by default.
Bench::ServerProcess startServer()
{
    const Testing::EnvironmentVariable sources("VORN_INSTRUMENTATION", "hwmon:parallel");
    return {};
}

void compare(const HwmonTree& tree, std::size_t rounds)
{
    const std::size_t sensors = tree.sensors();
    std::size_t attributes = 0;
    for (const HwmonTree::Chip& chip : tree.chips())
        attributes += chip.attributes.size();
    const RawReads raw(tree);
    const Provider provider;
    harvest(sensors); // initialises libsensors
    const Bench::ServerProcess server = startServer();
    Testing::HttpClient client(server.port());
    const std::string request =
        Testing::cimRequest("EnumerateInstances", Testing::cimClassParameter(className));

    const auto enumInstanceNames = [&] {
        provider.request(sensors, [](auto* mi, auto& handling, auto* result, auto& path) {
            return mi->ft->enumerateInstanceNames(
                mi, handling.context().handle(), result, path.handle());
        });
    };
    const auto enumInstances = [&] {
        provider.request(sensors, [](auto* mi, auto& handling, auto* result, auto& path) {
            return mi->ft->enumerateInstances(
                mi, handling.context().handle(), result, path.handle(), nullptr);
        });
    };
    const auto getInstance = [&] {
        provider.request(1, [&](auto* mi, auto& handling, auto* result, auto& path) {
            path.addKey("DeviceID", Host::Value::text(handling.arena(), tree.someDeviceID()));
            return mi->ft->getInstance(
                mi, handling.context().handle(), result, path.handle(), nullptr);
        });
    };
    const auto overHttp = [&] {
        client.send(request);
        expect(Bench::skim(client) > sensors, "a closed connection");
    };

    const auto scrape = [&] {
        client.send("GET /metrics HTTP/1.1\r\nHost: localhost\r\n\r\n");
        expect(Bench::skim(client) > sensors, "a closed connection");
    };

    std::vector<Row> rows = {{"raw reads", "raw reads", [&] { return costOf(std::cref(raw)); }},
        {"libsensors", "raw reads", [&] { return costOf([&] { readBySubfeatures(attributes); }); }},
        {"harvest", "raw reads", [&] { return costOf([&] { harvest(sensors); }); }},
        {"EnumInstanceNames", "harvest", [&] { return costOf(enumInstanceNames); }},
        {"EnumInstances", "harvest", [&] { return costOf(enumInstances); }},
        {"GetInstance", "harvest", [&] { return costOf(getInstance); }},
        {"EnumerateInstances of the server", "EnumInstances",
            [&] { return costOf(overHttp, server); }},
        {"GET /metrics of the server", "EnumInstances", [&] { return costOf(scrape, server); }},
        {"sensors -j", "sensors -j", [] { return program("/usr/bin/sensors", {"-j"}); }},
        {"libsensors' list and raw reads", "sensors -j",
            [] { return program("/proc/self/exe", {"list"}); }},
        {"sensorctl list", "sensors -j", [] { return program(Testing::sensorctl, {"list"}); }},
        {"sensorctl list --json", "sensors -j", [] {
             return program(Testing::sensorctl, {"list", "--json"});
         }}};
    measure(rows, rounds);
    print(rows, sensors);
}

} // namespace

int main(int argc, char** argv)
{
    try {
        if (argc > 1 && std::string_view(argv[1]) == "list") {
            listAndRead();
            return 0;
        }
        Tools::keepFreedMemory(1); // as in the server
        RynLog::configure({6000, "off", "off"});
        const Testing::EnvironmentVariable hardware("VORN_INSTRUMENTATION", "hwmon");
        const Testing::EnvironmentVariable log("RYNLOG_LOG", "off");
        const int rounds = argc > 1 ? std::atoi(argv[1]) : 21;
        expect(rounds > 0, "a number of rounds that is not positive");
        std::puts("| sensors | what | CPU ms | wall ms | CPU us/sensor | times raw | times peer |\n"
                  "|---|---|---|---|---|---|---|");
        for (const int sensors : {100, 1000, 5000})
            compare(HwmonTree(sensors), static_cast<std::size_t>(rounds));
        std::puts("on 250 PCI chips:");
        compare(HwmonTree(1000, HwmonTree::onPci), static_cast<std::size_t>(rounds));
        return 0;
    } catch (const std::exception& error) {
        std::fprintf(stderr, "bench_hwmon: %s\n", error.what());
        return 1;
    }
}
