// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures `sensorctl serve` under the requests of several clients, each with a connection of its
// own, and compares it with the same request within this process. Prints tables.
//
//     bench_server [seconds for each line of the table]

#include "bench/Median.h"
#include "bench/ModelMachine.h"
#include "bench/ProcessorTime.h"
#include "bench/ServerProcess.h"
#include "bench/Skim.h"
#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "tests/providers/Factories.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/Texts.h"
#include "tools/serve/FreedMemory.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <functional>
#include <future>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Bench::median;
using Bench::ModelMachine;
using Bench::ServerProcess;
using Bench::skim;
using Testing::HttpClient;
using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;
using Seconds = std::chrono::duration<double>;
using Durations = std::vector<double>; // in milliseconds

constexpr const char* Class = "ZUMLO_NumericSensor";

std::string enumerateInstances()
{
    return Testing::cimRequest("EnumerateInstances", Testing::cimClassParameter(Class));
}

std::string getInstance(std::int64_t sensors)
{
    return Testing::cimRequest("GetInstance",
        Testing::cimParameter("InstanceName",
            Testing::cimInstanceName(Class, {{"DeviceID", ModelMachine::someDeviceID(sensors)}})));
}

// Throws unless the answer has so many instances, or other parts that begin in that way.
void check(const Testing::HttpReply& reply, std::int64_t count, const char* part = "<INSTANCE ")
{
    if (static_cast<std::int64_t>(Testing::countOf(reply.body, part)) != count)
        throw std::runtime_error("a request failed: " + reply.body.substr(0, 500));
}

struct Load {
    const char* operation;
    std::int64_t sensors;
    std::string request;
    std::int64_t instances; // of the answer
    const char* part = "<INSTANCE ";
};

Load enumeration(std::int64_t sensors)
{
    return {"EnumerateInstances", sensors, enumerateInstances(), sensors};
}

Load scrape(std::int64_t sensors)
{
    return {"GET /metrics", sensors, "GET /metrics HTTP/1.1\r\nHost: localhost\r\n\r\n", sensors,
        "\nsensor_profile_health{"};
}

// Sends one request after another on one connection. The first answer is checked and not measured.
Durations askUntil(Clock::time_point end, std::uint16_t port, const Load& load)
{
    HttpClient client(port);
    client.send(load.request);
    check(client.receive(), load.instances, load.part);
    Durations durations;
    do {
        const auto begin = Clock::now();
        client.send(load.request);
        skim(client);
        durations.push_back(Milliseconds(Clock::now() - begin).count());
    } while (Clock::now() < end);
    return durations;
}

using Clients = std::vector<std::future<Durations>>;

Clients start(const Load& load, unsigned clients, Clock::time_point end, std::uint16_t port)
{
    Clients asked;
    for (unsigned i = 0; i < clients; ++i)
        asked.push_back(std::async(std::launch::async, askUntil, end, port, std::cref(load)));
    return asked;
}

Clock::time_point after(Seconds time)
{
    return Clock::now() + std::chrono::duration_cast<Clock::duration>(time);
}

void printLoad(const Load& load, unsigned clients, Seconds time, std::uint16_t port)
{
    const auto begin = Clock::now();
    Clients asked = start(load, clients, after(time), port);
    Durations all;
    for (std::future<Durations>& each : asked) {
        const Durations own = each.get();
        all.insert(all.end(), own.begin(), own.end());
    }
    const double elapsed = Seconds(Clock::now() - begin).count();
    std::sort(all.begin(), all.end());
    std::printf("| %s | %ld | %u | %.0f | %.2f | %.2f |\n", load.operation,
        static_cast<long>(load.sensors), clients, static_cast<double>(all.size()) / elapsed,
        all.at(all.size() / 2), all.at(all.size() * 99 / 100));
}

void printLoads(Seconds time)
{
    std::puts("| operation | sensors | clients | requests/s | p50 ms | p99 ms |\n"
              "|---|---|---|---|---|---|");
    for (const std::int64_t sensors : {40, 1000, 10000}) {
        const ModelMachine machine(sensors);
        const ServerProcess server;
        for (const Load& load : {Load{"GetInstance", sensors, getInstance(sensors), 1},
                 enumeration(sensors), scrape(sensors)})
            for (const unsigned clients : {1U, 8U})
                printLoad(load, clients, time, server.port());
    }
}

// Prints what scrapes and operations cost each other.
void printMixture(Seconds time)
{
    constexpr std::int64_t sensors = 1000;
    constexpr unsigned others = 48; // of 64 connections that an address may have
    const ModelMachine machine(sensors);
    const ServerProcess server;
    for (const auto& [load, beside] : {std::pair(scrape(sensors), enumeration(sensors)),
             {enumeration(sensors), scrape(sensors)}}) {
        std::printf("beside %u clients that send %s:\n", others, beside.operation);
        const Clients busy = start(beside, others, after(2 * time), server.port());
        printLoad(load, 1, time, server.port());
    }
}

// Has the provider in this process return the same instances as objects.
void enumerateHere(const Host::Broker& broker, CMPIInstanceMI& mi, std::size_t sensors)
{
    Host::Request request(broker);
    Host::CollectedResult answer;
    Host::Result result(answer);
    mi.ft->enumerateInstances(&mi, request.context().handle(), result.handle(),
        request.makePath("root/cimv2", Class).handle(), nullptr);
    if (answer.instances().size() != sensors)
        throw std::runtime_error("an answer in this process is not whole");
}

// Prints what requests cost the server against EnumInstances in this process, which writes no text.
void printComparison()
{
    constexpr std::int64_t sensors = 1000;
    constexpr int rounds = 200;
    const ModelMachine machine(sensors);
    const ServerProcess server;
    const ::clockid_t clock = Bench::clockOf(server.id());
    const Host::Broker broker;
    CMPIInstanceMI& mi =
        *SensorProfileProvider_Create_InstanceMI(broker.handle(), nullptr, nullptr);
    std::puts("| request | ms | processor time, ms | times EnumInstances | in processor time |\n"
              "|---|---|---|---|---|");
    for (const Load& load : {enumeration(sensors), scrape(sensors)}) {
        HttpClient client(server.port());
        client.send(load.request);
        check(client.receive(), sensors, load.part);
        Durations here;
        Durations hereOnProcessor;
        Durations there;
        Durations thereOnProcessor;
        for (int i = 0; i < rounds; ++i) { // alternately, for the same load of the machine
            const double before = Bench::processorTime(clock);
            auto begin = Clock::now();
            client.send(load.request);
            skim(client);
            there.push_back(Milliseconds(Clock::now() - begin).count());
            const double own = Bench::processorTime();
            begin = Clock::now();
            enumerateHere(broker, mi, sensors);
            here.push_back(Milliseconds(Clock::now() - begin).count());
            hereOnProcessor.push_back(Bench::processorTime() - own);
            // With the time that the server takes to free the answer.
            thereOnProcessor.push_back(Bench::processorTime(clock) - before);
        }
        std::printf("| %s of %ld sensors | %.2f | %.2f | %.2f | %.2f |\n", load.operation,
            static_cast<long>(sensors), median(there), median(thereOnProcessor),
            median(there) / median(here), median(thereOnProcessor) / median(hereOnProcessor));
    }
}

void printLargeAnswer()
{
    constexpr std::int64_t sensors = 60000;
    const ModelMachine machine(sensors);
    const ServerProcess server;
    HttpClient client(server.port());
    for (int round = 0; round < 3; ++round) {
        const auto begin = Clock::now();
        client.send(enumerateInstances());
        if (!client.hasReplyWithin(HttpClient::timeout))
            throw std::runtime_error("no answer");
        const double first = Milliseconds(Clock::now() - begin).count();
        const std::size_t bytes = skim(client);
        std::printf("EnumerateInstances of %ld sensors: first byte after %.0f ms, %zu bytes after "
                    "%.0f ms, peak memory %zu MiB\n",
            static_cast<long>(sensors), first, bytes, Milliseconds(Clock::now() - begin).count(),
            server.peakMemory() / 1024);
    }
}

void printRest()
{
    const ModelMachine machine(40);
    Durations startUps;
    for (int i = 0; i < 20; ++i)
        startUps.push_back(Milliseconds(ServerProcess().startUp()).count());
    const ServerProcess server;
    HttpClient client(server.port());
    const std::size_t fresh = server.residentMemory();
    client.send(enumerateInstances());
    client.receive();
    std::printf("start-up %.1f ms; at rest %.1f MiB, after a first request %.1f MiB\n",
        median(startUps), static_cast<double>(fresh) / 1024,
        static_cast<double>(server.residentMemory()) / 1024);
}

} // namespace

int main(int argc, char** argv)
{
    try {
        Tools::keepFreedMemory(1); // as in the server
        const Seconds time(argc > 1 ? std::atof(argv[1]) : 3.0);
        printRest();
        printComparison();
        printLargeAnswer();
        printLoads(time);
        printMixture(time);
        return 0;
    } catch (const std::exception& error) {
        std::fprintf(stderr, "bench_server: %s\n", error.what());
        return 1;
    }
}
