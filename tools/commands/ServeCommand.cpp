// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/ServeCommand.h"

#include "tools/Installation.h"
#include "tools/commands/Commands.h"

#include <CLI/CLI.hpp>

#include <cstdlib>
#include <utility>

namespace Tools {

namespace {

constexpr const char* serveFooter =
    "Addresses other than loopback need --certificate, --key and --passwords. SIGTERM\n"
    "ends the server; SIGHUP has it read certificate, key and passwords anew. `man\n"
    "sensorctl` describes these files, the page, the log and the limits of clients.";

class ServerExecution : public ServeCommand {
public:
    ServerExecution(CLI::App& tool, std::vector<std::string> words)
        : ServeCommand(tool), words_(std::move(words))
    {
    }

    ExitCode run(Output& /*out*/) override
    {
        // With this setting, each thread of the server keeps up to 1,000 freed blocks of a size,
        // such as the texts of a thousand sensors: a GetInstance of these takes 8 % less time. The
        // allocator of glibc reads the variable when a program starts.
        ::setenv("GLIBC_TUNABLES", "glibc.malloc.tcache_count=1000", 0);
        executeProgram("sensorctl-serve", std::move(words_));
    }

private:
    std::vector<std::string> words_;
};

} // namespace

ServeCommand::ServeCommand(CLI::App& tool)
    : Command(tool, "serve", "Answer CIM clients, browsers and Prometheus over HTTP")
{
    // Other commands need not wait for the many options.
    parser().preparse_callback([this](std::size_t) {
        options_.addTo(parser());
        source_.addModel(parser());
        source_.addProvider(parser());
    });
    parser().footer(serveFooter);
}

std::unique_ptr<Command> makeServeCommand(CLI::App& tool, std::vector<std::string> words)
{
    return std::make_unique<ServerExecution>(tool, std::move(words));
}

} // namespace Tools
