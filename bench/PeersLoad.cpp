// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Measures requests in sensorctl serve, OpenPegasus and sfcb: each has one client on a connection
// that stays open, the same providers and the same model file. Prints a table.
//
//     bench_peers [blocks]
//
// They take turns in blocks of twenty requests, the first of which is not counted: a client that
// repeats requests finds the caches of the processor as its last request left them, and with turns
// of single requests each server would find them as another one left them. Two more rows show what
// none of them can save: the provider's call by itself, and the transport of the same answer.

#include "bench/AnswerRepeater.h"
#include "bench/Median.h"
#include "bench/ModelMachine.h"
#include "bench/ServerProcess.h"
#include "bench/Skim.h"
#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "platform/logging/LogSettings.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/providers/Factories.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/Texts.h"
#include "tools/serve/FreedMemory.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <functional>
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
    void ask(const std::string& request)
    {
        if (!tryAsk(request)) {
            client_ = HttpClient(port_);
            if (!tryAsk(request))
                throw std::runtime_error(name_ + " closes each connection");
        }
    }

private:
    // Returns false where the server has closed the connection.
    bool tryAsk(const std::string& request)
    {
        return client_.trySend(request) && Bench::skim(client_) != 0;
    }

    std::string name_;
    std::uint16_t port_;
    HttpClient client_;
};

// The provider without a server: its functions are called in a request of the embedded broker.
class ProviderAlone {
public:
    void getInstance(const char** properties) const
    {
        call([=, this](auto& context, auto& result, auto& path) {
            path.addKey("DeviceID", Host::Value::text(Host::Arena::required(),
                                        Bench::ModelMachine::someDeviceID(sensors)));
            return mi_->ft->getInstance(
                mi_, context.handle(), result.handle(), path.handle(), properties);
        });
    }

    void enumerateInstances(const char** properties) const
    {
        call([=, this](auto& context, auto& result, auto& path) {
            return mi_->ft->enumerateInstances(
                mi_, context.handle(), result.handle(), path.handle(), properties);
        });
    }

private:
    template <typename Function>
    void call(const Function& function) const
    {
        Host::Request request(broker_);
        Host::CollectedResult answer;
        Host::Result result(answer);
        function(request.context(), result, request.makePath("root/cimv2", className));
        if (answer.isEmpty())
            throw std::runtime_error("the provider does not answer");
    }

    const Host::Broker broker_;
    CMPIInstanceMI* const mi_ =
        SensorProfileProvider_Create_InstanceMI(broker_.handle(), nullptr, nullptr);
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

// Returns the names of all properties that an instance in the answer has.
std::vector<std::string> propertiesIn(const std::string& answer)
{
    std::vector<std::string> names;
    const std::string instance = answer.substr(0, answer.find("</INSTANCE>"));
    constexpr std::string_view start = "<PROPERTY";
    for (auto at = instance.find(start); at != std::string::npos;
         at = instance.find(start, at + 1)) {
        const auto name = instance.find("NAME=\"", at) + 6;
        names.push_back(instance.substr(name, instance.find('"', name) - name));
    }
    return names;
}

std::string propertyList(const std::vector<std::string>& names)
{
    std::string values;
    for (const std::string& name : names)
        values += "<VALUE>" + name + "</VALUE>";
    return Testing::cimParameter("PropertyList", "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>");
}

// Does the work of one line of the table.
struct Contestant {
    std::string name;
    std::size_t properties; // in an instance of the answer
    std::function<void()> ask;
    std::vector<double> milliseconds = {};
};

void takeTurns(std::vector<Contestant>& contestants, int blocks)
{
    constexpr int requests = 20; // in a block
    for (int block = 0; block < blocks; ++block)
        for (Contestant& each : contestants) {
            each.ask();
            for (int counted = 1; counted < requests; ++counted) {
                const auto begin = Clock::now();
                each.ask();
                each.milliseconds.push_back(Milliseconds(Clock::now() - begin).count());
            }
        }
}

struct Row {
    const char* label;
    std::string request;
    std::size_t instances;
    std::function<void()> callProvider;
};

void print(const Row& row, std::vector<Peer>& peers, int blocks)
{
    std::vector<Contestant> contestants;
    std::string ownAnswer;
    for (Peer& peer : peers) {
        const std::string body = peer.bodyOf(row.request);
        if (Testing::countOf(body, "<INSTANCE ") != row.instances)
            throw std::runtime_error(peer.name() + " answers " + body.substr(0, 500));
        contestants.push_back({peer.name(), Testing::countOf(body, "<PROPERTY") / row.instances,
            [&] { peer.ask(row.request); }});
        if (&peer == &peers.front())
            ownAnswer = body;
    }
    const std::size_t properties = contestants.front().properties;
    contestants.push_back({"the provider's call alone", properties, row.callProvider});
    const Bench::AnswerRepeater repeater(row.request.size(), ownAnswer);
    Peer transport("the same bytes", repeater.port());
    contestants.push_back(
        {"the same bytes alone", properties, [&] { transport.ask(row.request); }});
    takeTurns(contestants, blocks);
    const double own = Bench::median(contestants.front().milliseconds);
    for (const Contestant& each : contestants) {
        const double median = Bench::median(each.milliseconds);
        std::printf("| %s | %s | %zu | %.2f | %.2f |\n", row.label, each.name.c_str(),
            each.properties, median, median / own);
    }
}

void printTable(int blocks)
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
    const std::vector<std::string> names = propertiesIn(peers.front().bodyOf(getInstance()));
    const std::string list = propertyList(names);
    std::vector<const char*> listed(names.size() + 1, nullptr);
    std::transform(names.begin(), names.end(), listed.begin(), std::mem_fn(&std::string::c_str));
    const ProviderAlone alone;
    std::puts("| request | server | properties | ms | times sensorctl serve |\n"
              "|---|---|---|---|---|");
    for (const Row& row :
        {Row{"GetInstance", getInstance(), 1, [&] { alone.getInstance(nullptr); }},
            Row{"GetInstance, properties listed", getInstance(list), 1,
                [&] { alone.getInstance(listed.data()); }},
            Row{"EnumerateInstances", enumerateInstances(), sensors,
                [&] { alone.enumerateInstances(nullptr); }},
            Row{"EnumerateInstances, properties listed", enumerateInstances(list), sensors,
                [&] { alone.enumerateInstances(listed.data()); }}})
        print(row, peers, blocks);
    for (const InstalledManager* const manager : managers)
        manager->stop();
}

} // namespace

int main(int argc, char** argv)
{
    try {
        const int blocks = argc > 1 ? std::atoi(argv[1]) : 5;
        if (blocks <= 0)
            throw std::runtime_error("the number of blocks is not positive");
        RynLog::configure({6000, "off", "off"});
        Tools::keepFreedMemory(4); // as in the server
        printTable(blocks);
        return 0;
    } catch (const std::exception& error) {
        std::fprintf(stderr, "bench_peers: %s\n", error.what());
        return 1;
    }
}
