// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/CollectOptions.h"
#include "tools/commands/Commands.h"

#include <CLI/CLI.hpp>

#include <unistd.h>

#include <cerrno>
#include <filesystem>
#include <system_error>

namespace Tools {

namespace {

// Returns the program of the collector, which is beside the tool in a build folder.
std::filesystem::path collectorFile()
{
    constexpr const char* name = "sensorctl-collect";
    const auto here = std::filesystem::read_symlink("/proc/self/exe").parent_path();
    const auto installed = here.parent_path() / "libexec/sensor-profile" / name;
    return std::filesystem::exists(installed) ? installed : here / name;
}

class CollectCommand : public Command {
public:
    explicit CollectCommand(CLI::App& tool)
        : Command(tool, "collect", "Read the sensors of the BMC into a file again and again")
    {
        options_.addTo(parser());
    }

    bool writesLog() const override { return true; }

    // Executes the collector in place of this program.
    ExitCode run(Output& /*out*/) override
    {
        const std::string file = collectorFile().string();
        std::vector<std::string> words = options_.words();
        words.insert(words.begin(), "sensorctl-collect");
        std::vector<char*> arguments;
        arguments.reserve(words.size() + 1);
        for (std::string& word : words)
            arguments.push_back(word.data());
        arguments.push_back(nullptr);
        ::execv(file.c_str(), arguments.data());
        throw std::system_error(errno, std::generic_category(), file);
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
