// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/Output.h"
#include "tools/output/SensorTable.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

constexpr const char* footer =
    "LOWER and UPPER are limits in the reading's unit, rounded to hundredths:\n"
    "warning/critical/fatal, with - for one that the sensor lacks. A reading of -\n"
    "means that the sensor delivers none.";

class ListCommand : public Command {
public:
    explicit ListCommand(CLI::App& tool)
        : Command(tool, "list", "Show all sensors with their readings, states and limits")
    {
        source_.addModel(parser());
        source_.addProvider(parser());
        display_.addTo(parser());
        parser().footer(footer);
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        if (show(out))
            return ExitCode::success;
        checkMachineIsEmpty();
        if (display_.isJson())
            writeJson(out, sensorClass, {});
        return complainOfEmptyMachine(source_.model());
    }

private:
    // False when there are none.
    bool show(Output& out) const
    {
        ProviderClient provider(source_.providerFile());
        const auto sensors = provider.sensors();
        if (sensors.empty())
            return false;
        if (display_.isJson())
            writeJson(out, sensorClass, sensors);
        else
            out.write(sensorTable(sensors, display_.width(), display_.isColored()));
        return true;
    }

    SourceOptions source_;
    DisplayOptions display_;
};

} // namespace

std::unique_ptr<Command> makeListCommand(CLI::App& tool)
{
    return std::make_unique<ListCommand>(tool);
}

} // namespace Tools
