// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures requests in sensorctl serve, OpenPegasus and sfcb, in turn: each has one client on a
// connection that stays open, the same providers and the same model file. Prints a table.
//
//     bench_peers [rounds]

#include "bench/Median.h"
#include "bench/ModelMachine.h"
#include "bench/ServerProcess.h"
#include "bench/Skim.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/Texts.h"

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace {

using Testing::HttpClient;
using Testing::InstalledManager;
using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;

constexpr std::int64_t sensors = 1000;
constexpr const char* className = "ZUMLO_NumericSensor";

// A server and its client.
class Peer {
public:
    Peer(std::string name, std::uint16_t port) : name_(std::move(name)), port_(port), client_(port)
    {
    }

    const std::string& name() const { return name_; }

    std::string bodyOf(const std::string& request)
    {
        client_ = HttpClient(port_);
        client_.send(request);
        return client_.receive().body;
    }

    // sfcb closes a connection after 10 requests: the request is sent once more on a new one then.
    void measure(const std::string& request)
    {
        if (!trySend(request)) {
            client_ = HttpClient(port_);
            if (!trySend(request))
                throw std::runtime_error(name_ + " closes each connection");
        }
    }

    // Returns the median in milliseconds of what was measured since the last call.
    double median() { return Bench::median(std::exchange(durations_, {})); }

private:
    // Returns false where the server has closed the connection.
    bool trySend(const std::string& request)
    {
        const auto begin = Clock::now();
        if (!client_.trySend(request) || Bench::skim(client_) == 0)
            return false;
        durations_.push_back(Milliseconds(Clock::now() - begin).count());
        return true;
    }

    std::string name_;
    std::uint16_t port_;
    HttpClient client_;
    std::vector<double> durations_;
};

std::string getInstance(const std::string& moreParameters = {})
{
    return Testing::cimRequest(
        "GetInstance", Testing::cimParameter("InstanceName",
                           Testing::cimInstanceName(className,
                               {{"CreationClassName", className},
                                   {"DeviceID", Bench::ModelMachine::someDeviceID(sensors)},
                                   {"SystemCreationClassName", "ZUMLO_ComputerSystem"},
                                   {"SystemName", Vorn::getSystemName()}})) +
                           moreParameters);
}

std::string enumerateInstances(const std::string& moreParameters = {})
{
    return Testing::cimRequest(
        "EnumerateInstances", Testing::cimClassParameter(className) + moreParameters);
}

// Returns the parameter with a list of all properties that an instance in the answer has.
std::string propertyList(const std::string& answer)
{
    std::string values;
    const std::string instance = answer.substr(0, answer.find("</INSTANCE>"));
    constexpr std::string_view start = "<PROPERTY";
    for (auto at = instance.find(start); at != std::string::npos;
         at = instance.find(start, at + 1)) {
        const auto name = instance.find("NAME=\"", at) + 6;
        values += "<VALUE>" + instance.substr(name, instance.find('"', name) - name) + "</VALUE>";
    }
    return Testing::cimParameter("PropertyList", "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>");
}

struct Row {
    const char* label;
    std::string request;
    std::size_t instances;
};

void print(const Row& row, std::vector<Peer>& peers, int rounds)
{
    std::vector<std::size_t> properties;
    for (Peer& peer : peers) {
        const std::string body = peer.bodyOf(row.request);
        if (Testing::countOf(body, "<INSTANCE ") != row.instances)
            throw std::runtime_error(peer.name() + " answers " + body.substr(0, 500));
        properties.push_back(Testing::countOf(body, "<PROPERTY") / row.instances);
    }
    for (int round = 0; round < rounds; ++round)
        for (Peer& peer : peers)
            peer.measure(row.request);
    const double own = peers.front().median();
    for (Peer& peer : peers) {
        const double median = &peer == &peers.front() ? own : peer.median();
        std::printf("| %s | %s | %zu | %.2f | %.2f |\n", row.label, peer.name().c_str(),
            properties[static_cast<std::size_t>(&peer - peers.data())], median, median / own);
    }
}

void printTable(int rounds)
{
    const Bench::ModelMachine machine(sensors);
    const Bench::ServerProcess server;
    const std::vector<const InstalledManager*> managers = {
        &InstalledManager::openPegasus(), &InstalledManager::sfcb()};
    std::vector<Peer> peers;
    peers.emplace_back("sensorctl serve", server.port());
    for (const InstalledManager* const manager : managers) {
        manager->startWithProviders(
            {{"VORN_INSTRUMENTATION", std::getenv("VORN_INSTRUMENTATION")}, {"RYNLOG_LOG", "off"}});
        peers.emplace_back(manager->name(), static_cast<std::uint16_t>(manager->port()));
    }
    // sensorctl serve leaves out what is not set: with this list, the answers have equal content.
    const std::string set = propertyList(peers.front().bodyOf(getInstance()));
    std::puts("| request | server | properties | ms | times sensorctl serve |\n"
              "|---|---|---|---|---|");
    for (const Row& row : {Row{"GetInstance", getInstance(), 1},
             Row{"GetInstance, properties listed", getInstance(set), 1},
             Row{"EnumerateInstances", enumerateInstances(), sensors},
             Row{"EnumerateInstances, properties listed", enumerateInstances(set), sensors}})
        print(row, peers, rounds);
    for (const InstalledManager* const manager : managers)
        manager->stop();
}

} // namespace

int main(int argc, char** argv)
{
    try {
        const int rounds = argc > 1 ? std::atoi(argv[1]) : 100;
        if (rounds <= 0)
            throw std::runtime_error("the number of rounds is not positive");
        printTable(rounds);
        return 0;
    } catch (const std::exception& error) {
        std::fprintf(stderr, "bench_peers: %s\n", error.what());
        return 1;
    }
}
