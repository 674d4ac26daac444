// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/Installation.h"
#include "tools/collect/CollectOptions.h"
#include "tools/commands/Commands.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

class CollectCommand : public Command {
public:
    explicit CollectCommand(CLI::App& tool)
        : Command(tool, "collect", "Read the sensors of the BMC into a file again and again")
    {
        options_.addTo(parser());
    }

    bool writesLog() const override { return true; }

    ExitCode run(Output& /*out*/) override
    {
        constexpr const char* program = "sensorctl-collect";
        std::vector<std::string> words = options_.words();
        words.insert(words.begin(), program);
        executeProgram(program, std::move(words));
    }

private:
    CollectOptions options_;
};

} // namespace

std::unique_ptr<Command> makeCollectCommand(CLI::App& tool)
{
    return std::make_unique<CollectCommand>(tool);
}

} // namespace Tools
