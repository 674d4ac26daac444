// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The program that `sensorctl serve` executes.

#include "host/http/EventLog.h"
#include "host/http/Server.h"
#include "host/manager/SensorProfile.h"
#include "host/operations/ObjectManager.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tools/CommandLine.h"
#include "tools/UsageError.h"
#include "tools/cim/Classes.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/ServeCommand.h"
#include "tools/metrics/HarvestMetrics.h"
#include "tools/metrics/HwmonMetrics.h"
#include "tools/metrics/MetricsResource.h"
#include "tools/metrics/RequestCounts.h"
#include "tools/output/Output.h"
#include "tools/page/PageService.h"
#include "tools/sensors/Sources.h"
#include "tools/serve/FreedMemory.h"
#include "tools/serve/Greeting.h"
#include "tools/serve/MemoryReturn.h"
#include "tools/serve/Privileges.h"
#include "tools/serve/Protection.h"
#include "tools/serve/ServiceManager.h"
#include "tools/serve/Signals.h"

#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstdlib>
#include <memory>
#include <stdexcept>
#include <system_error>
#include <vector>

namespace {

using namespace Tools;

using Host::Http::report;
using Host::Http::Severity;

// With the default grace period, it is less than the TimeoutStopSec of the unit.
constexpr std::chrono::seconds timeoutOfPage{5};

// Sets the environment, since the libraries of the providers have logs of their own. The log has
// the reasons of failures that they report to standard error.
void logToStandardError()
{
    ::setenv("RYNLOG_STDERR", "off", 0);
    const char* const wanted = ::getenv("RYNLOG_LOG");
    if (wanted == nullptr || *wanted == '\0')
        ::setenv("RYNLOG_LOG", "stderr", 1);
}

std::vector<Host::Http::Endpoint> endpointsFor(const ServeOptions& options)
{
    try {
        return Host::Http::endpointsFor(options.listen);
    } catch (const std::invalid_argument& error) {
        throw UsageError(error.what());
    }
}

void requireReadable(const std::string& file)
{
    if (::access(file.c_str(), R_OK) == 0)
        return;
    const std::error_code reason(errno, std::system_category());
    throw std::system_error(reason,
        reason == std::errc::permission_denied
            ? file + ", which the server needs as the user it runs as (--user names another)"
            : file);
}

// Returns the model files of the machine that is served, from the environment variables that the
// options have set.
std::vector<std::string> modelFiles()
{
    std::vector<std::string> files;
    for (const Vorn::SourceEntry& entry : configuredSources())
        if (entry.scheme == "model")
            files.push_back(entry.argument);
    return files;
}

// Writes the first line of the log. Throws std::runtime_error when it cannot be written: a server
// does not start without a log. A running server continues when the log fails.
void beginLog(const std::string& text, Output& out)
{
    report({"beginLog", "main", __LINE__}, text, Severity::information);
    const std::string problem = Host::Http::logProblem();
    if (problem.empty())
        return;
    // Where the log is standard error, the message cannot be written either.
    if (::getenv("RYNLOG_LOG") == std::string("stderr")) {
        out.write("sensorctl: " + problem + "\n");
        out.flush();
    }
    throw std::runtime_error(problem);
}

// Serves until a signal ends it. Returns false when requests still run at the end of the grace
// period.
bool serve(Host::Http::Server& server, const Protection& protection, const Signals& signals,
    std::chrono::seconds gracePeriod)
{
    while (signals.wait() == SIGHUP) {
        notifyServiceManager("RELOADING=1");
        protection.renew(server);
        notifyServiceManager("READY=1");
    }
    notifyServiceManager("STOPPING=1");
    server.beginShutdown();
    report({"serve", "main", __LINE__}, "ending", Severity::information);
    constexpr std::chrono::milliseconds interval{20};
    const auto end = std::chrono::steady_clock::now() + gracePeriod;
    while (!server.waitUntilIdle(interval)) {
        const auto again = signals.waitFor(std::chrono::milliseconds(0));
        if (again && *again != SIGHUP)
            endBySignal(*again);
        if (std::chrono::steady_clock::now() >= end)
            return false;
    }
    return true;
}

class Serving : public ServeCommand {
public:
    using ServeCommand::ServeCommand;

    ExitCode run(Output& out) override
    {
        options_.complete(parser());
        const auto endpoints = endpointsFor(options_);
        logToStandardError();
        source_.selectMachine();
        // Slow chips do not delay each other, unless the environment names the sources.
        ::setenv("VORN_INSTRUMENTATION", "hwmon:parallel,ipmi", 0);
        const Signals signals; // before any thread starts
        const Protection protection(options_);
        if (options_.isCheck)
            return ExitCode::success;
        keepFreedMemory(options_.http.workers);
        auto sockets = Host::Http::listenOn(endpoints);
        const auto classes = compileClasses();
        const ProviderFiles files = source_.providerFiles();
        Host::ObjectManager objects(*classes,
            Host::registeredProfileProviders(files.sensors, files.computerSystem),
            Vorn::getSystemName, options_.operations);
        MemoryReturn memoryReturn(objects);
        RequestCounts operations(memoryReturn);
        ChipDevices devices;
        const bool readsRecords = !source_.provider() && canReadRecords();
        SingleFlight<Harvest> harvests([&objects, &devices, readsRecords] {
            return std::make_shared<const Harvest>(readsRecords
                                                       ? readHarvestOfRecords(devices)
                                                       : readHarvest(objects.manager(), devices));
        });
        Host::Http::ResponseCounts responses;
        MetricsResource metrics(harvests, [&](Exposition& exposition) {
            operations.addTo(exposition);
            addResponses(exposition, responses);
            addHeldObjects(exposition, objects.heldObjects());
            if (options_.compatible && readsHwmon())
                addHwmon(exposition);
        });
        beginLog(renounceRoot(options_.user), out);
        for (const std::string& file : modelFiles())
            requireReadable(file);

        const std::string text = greeting(sockets, protection.passwords() != nullptr);
        PageService page(
            harvests, options_.isHistoryKept, options_.history, installedFolder() / "web");
        Host::Http::Resources resources{{"/metrics", metrics}};
        page.addTo(resources);
        Host::Http::Server server(operations, std::move(sockets), options_.http,
            protection.certificate(), protection.passwords(), std::move(resources), &responses);
        out.write(text);
        out.flush();
        notifyServiceManager("READY=1");
        const bool isIdle = serve(server, protection, signals, options_.gracePeriod);
        const bool isPageOver = page.finish(timeoutOfPage);
        if (isIdle && isPageOver)
            return ExitCode::success;
        complain(isIdle ? "the sensors were still being read"
                        : "requests were still running at the end of the grace period");
        // The destructors would wait for what still runs.
        ::_exit(static_cast<int>(ExitCode::failure));
    }
};

} // namespace

int main(int argc, char** argv)
{
    return runTool(argc, argv, [](CLI::App& tool) {
        Commands commands;
        commands.push_back(std::make_unique<Serving>(tool));
        return commands;
    });
}
