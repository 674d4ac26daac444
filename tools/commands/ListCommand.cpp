// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/UsageError.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/ObjectTable.h"
#include "tools/output/Output.h"
#include "tools/output/SensorTable.h"
#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

constexpr const char* listFooter =
    "LOWER and UPPER are limits in the reading's unit, rounded to hundredths:\n"
    "warning/critical/fatal, with - for one that the sensor lacks. A reading of -\n"
    "means that the sensor delivers none.\n"
    "\n"
    "CLASS may be ZUMLO_ComputerSystem, ZUMLO_SensorSystemDevice,\n"
    "ZUMLO_SensorElementCapabilities, ZUMLO_SensorEnabledLogicalElementCapabilities,\n"
    "or a class that these are derived from.";

class ListCommand : public Command {
public:
    explicit ListCommand(CLI::App& tool)
        : Command(tool, "list", "Show all sensors with their readings, states and limits")
    {
        parser()
            .add_option(
                "CLASS", className_, "Show the objects of this class instead of the sensors")
            ->type_name("");
        source_.addModel(parser());
        source_.addProvider(parser());
        display_.addJson(parser());
        display_.addColor(parser());
        parser().footer(listFooter);
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        if (show(out))
            return ExitCode::success;
        if (className_ == sensorClass)
            checkMachineIsEmpty();
        else
            countSensors(); // throws for an unreadable machine, of which providers return nothing
        if (display_.isJson())
            writeJson(out, className_, {});
        if (className_ == sensorClass)
            return complainOfEmptyMachine(source_.model());
        complain("there are no objects of the class " + className_);
        return ExitCode::nothingFound;
    }

private:
    // Returns false when the class has no objects.
    bool show(Output& out)
    {
        ProviderClient provider(source_.providerFiles());
        className_ = declared(provider);
        const Instances objects = provider.instances(className_);
        if (objects.empty())
            return false;
        if (display_.isJson())
            writeJson(out, className_, objects);
        else if (className_ == sensorClass)
            out.write(sensorTable(objects, outputWidth(), display_.isColored()));
        else
            out.write(objectTable(objects, outputWidth(), display_.isColored()));
        return true;
    }

    std::string declared(const ProviderClient& provider) const
    {
        if (auto className = provider.declaredClass(className_))
            return *std::move(className);
        std::string text = "unknown class \"" + className_ + "\"; there are";
        for (const std::string& served : provider.servedClasses())
            text.append(" ").append(served);
        throw UsageError(text);
    }

    std::string className_ = sensorClass;
    SourceOptions source_;
    DisplayOptions display_;
};

} // namespace

std::unique_ptr<Command> makeListCommand(CLI::App& tool)
{
    return std::make_unique<ListCommand>(tool);
}

} // namespace Tools
