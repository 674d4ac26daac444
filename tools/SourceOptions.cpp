// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/SourceOptions.h"

#include "platform/instrumentation/SourceList.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "tools/cim/ProviderFile.h"

#include <CLI/CLI.hpp>

#include <cstdlib>
#include <filesystem>

namespace Tools {

void SourceOptions::addModel(CLI::App& parser)
{
    parser
        .add_option("--model", model_, "The machine this model file describes (default: this one)")
        ->type_name("FILE");
}

void SourceOptions::addProvider(CLI::App& parser)
{
    parser.add_option("--provider", provider_, "This provider library instead of the tool's own")
        ->type_name("FILE");
}

void SourceOptions::selectMachine() const
{
    if (!model_)
        return;
    // A provider returns an empty answer for a model that it cannot read.
    Vorn::checkMachineFile(*model_);
    const std::string entry =
        Vorn::formatSourceEntry("model", std::filesystem::absolute(*model_).string());
    ::setenv("VORN_INSTRUMENTATION", entry.c_str(), 1);
}

ProviderFiles SourceOptions::providerFiles() const
{
    ProviderFiles files = sensorProviderFile();
    files.computerSystem = findComputerSystemProviderFile();
    return files;
}

ProviderFiles SourceOptions::sensorProviderFile() const
{
    // The loader would search its own folders for a name without a slash.
    return {provider_ ? std::filesystem::absolute(*provider_).string() : findProviderFile(), {}};
}

} // namespace Tools
