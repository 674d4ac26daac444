// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/SourceOptions.h"

#include "platform/instrumentation/Instrumentation.h"
#include "platform/instrumentation/OpenSource.h"
#include "platform/instrumentation/ipmi/IpmiSource.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"
#include "tools/cim/ProviderFile.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <exception>
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

std::vector<Vorn::SourceEntry> SourceOptions::sources()
{
    const char* const list = std::getenv("VORN_INSTRUMENTATION");
    return Vorn::parseSourceList(
        list == nullptr || *list == '\0' ? Vorn::Instrumentation::defaultSources : list);
}

bool SourceOptions::readsHwmon()
{
    const auto entries = sources();
    return std::any_of(entries.begin(), entries.end(),
        [](const Vorn::SourceEntry& entry) { return entry.scheme == "hwmon"; });
}

std::string SourceOptions::ageOfCollection()
{
    double oldest = -1;
    for (const Vorn::SourceEntry& entry : sources())
        try {
            if (entry.scheme == "ipmi")
                oldest = std::max(oldest, Vorn::IpmiSource(entry.argument).age().value_or(-1));
        } catch (const std::exception&) { // the library has reported the reason
        }
    return oldest < 0 ? "" : "read " + std::to_string(std::lround(oldest)) + " s ago";
}

std::vector<std::string> SourceOptions::failures(bool areChipsListed)
{
    std::vector<std::string> reasons;
    for (const Vorn::SourceEntry& entry : sources())
        try {
            if (entry.scheme != "hwmon" || !areChipsListed)
                Vorn::openSource(entry)->nodes(Vorn::NodeLexicon::NodeType::Temperature);
        } catch (const std::exception& error) {
            reasons.emplace_back(error.what());
        }
    return reasons;
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
