// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/metrics/CompatibleOption.h"
#include "tools/metrics/HarvestMetrics.h"
#include "tools/metrics/HwmonMetrics.h"
#include "tools/output/FileReplacement.h"
#include "tools/output/Output.h"
#include "tools/sensors/Sources.h"

#include <CLI/CLI.hpp>

#include <optional>
#include <string>
#include <utility>

namespace Tools {

namespace {

// node_exporter runs as a user of its own.
constexpr ::mode_t modeOfTextfile = 0644;

class MetricsCommand : public Command {
public:
    explicit MetricsCommand(CLI::App& tool)
        : Command(tool, "metrics", "Write the sensors as metrics for Prometheus")
    {
        parser()
            .add_option(
                "--textfile", file_, "Replace this file instead of writing to standard output")
            ->type_name("FILE");
        addCompatible(parser(), compatible_);
        source_.addModel(parser());
        source_.addProvider(parser());
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        ChipDevices devices;
        const ProviderClient provider(source_.sensorProviderFile());
        const Harvest harvest = readHarvest(provider.manager(), devices);
        Exposition exposition(ExpositionForm::text);
        SensorMetrics sensors(0); // there is no further exposition
        addHarvest(exposition, harvest, sensors);
        if (compatible_ && readsHwmon())
            addHwmon(exposition);
        const std::string text = std::move(exposition).finish();
        if (file_)
            replaceFile(*file_, text, modeOfTextfile);
        else
            out.write(text);
        out.flush();
        if (!harvest.sensors.empty())
            return ExitCode::success;
        checkMachineIsEmpty();
        return complainOfEmptyMachine(source_.model());
    }

private:
    std::optional<std::string> file_;
    std::optional<std::string> compatible_;
    SourceOptions source_;
};

} // namespace

std::unique_ptr<Command> makeMetricsCommand(CLI::App& tool)
{
    return std::make_unique<MetricsCommand>(tool);
}

} // namespace Tools
