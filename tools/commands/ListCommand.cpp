// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/UsageError.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/commands/SelectionOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/ObjectTable.h"
#include "tools/output/Output.h"
#include "tools/output/PrintableText.h"
#include "tools/output/SensorCsv.h"
#include "tools/output/SensorJson.h"
#include "tools/output/SensorTable.h"
#include "tools/sensors/ChipDevices.h"
#include "tools/sensors/Sources.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

constexpr const char* listFooter =
    "LOW and HIGH are limits in the reading's unit: warning, critical and fatal, with\n"
    "- for one that the sensor lacks. A reading of - means that there is none.\n"
    "\n"
    "SELECTOR may be a class, whose objects are shown instead: ZUMLO_ComputerSystem,\n"
    "ZUMLO_SensorSystemDevice, ZUMLO_SensorElementCapabilities,\n"
    "ZUMLO_SensorEnabledLogicalElementCapabilities, or one above these.";

class ListCommand : public Command {
public:
    explicit ListCommand(CLI::App& tool)
        : Command(tool, "list", "Show the sensors with their readings, states and limits")
    {
        selection_.addTo(parser());
        selection_.addProblems(parser());
        display_.addJson(parser());
        display_.addTables(parser());
        display_.addColor(parser());
        source_.addModel(parser());
        source_.addProvider(parser());
        parser().footer(listFooter);
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        std::string className = sensorClass;
        if (const auto code = show(out, className))
            return *code;
        if (className != sensorClass) {
            countSensors(); // throws for an unreadable machine, of which providers return nothing
            complain("there are no objects of the class " + className);
            return ExitCode::nothingFound;
        }
        checkMachineIsEmpty();
        write(out, {});
        return complainOfEmptyMachine(source_.model());
    }

private:
    // Sets the name of the class if the user named one. Returns nothing when there is no object.
    std::optional<ExitCode> show(Output& out, std::string& className) const
    {
        const auto& selectors = selection_.selectors();
        const bool mayNameClass = selectors.size() == 1;
        ProviderClient provider(
            mayNameClass ? source_.providerFiles() : source_.sensorProviderFile());
        const auto named = mayNameClass ? provider.declaredClass(selectors.front()) : std::nullopt;
        if (named && *named != sensorClass) {
            className = *named;
            return showObjects(out, provider, className);
        }
        Sensors all = readSensors(provider, display_.form() == Form::cim);
        if (all.empty())
            return std::nullopt;
        auto selected = (named ? selection_.withoutSelectors() : selection_).select(std::move(all));
        write(out, std::move(selected.sensors));
        out.flush();
        for (const std::string& complaint : selected.complaints)
            complain(complaint);
        return selected.complaints.empty() ? ExitCode::success : ExitCode::nothingFound;
    }

    std::optional<ExitCode> showObjects(
        Output& out, ProviderClient& provider, const std::string& className) const
    {
        const Instances objects = provider.instances(className);
        for (const char* const option : {"--kind", "--problems", "--flat", "--csv"})
            if (parser().count(option) != 0)
                throw UsageError(std::string(option) +
                                 " is for sensors, not for objects of the class " + className);
        if (display_.form() == Form::json || display_.form() == Form::cim)
            writeJson(out, className, objects);
        else if (!objects.empty())
            out.write(objectTable(provider, objects, display_.style()));
        return objects.empty() ? std::nullopt : std::optional(ExitCode::success);
    }

    void write(Output& out, Sensors sensors) const
    {
        const bool isOfKernel = readsHwmon();
        if (isOfKernel && display_.form() != Form::cim)
            nameDevices(sensors);
        switch (display_.form()) {
        case Form::csv:
            return writeCsv(out, sensors);
        case Form::json:
            return writeSensorJson(out, sensors);
        case Form::cim:
            return writeInstances(out, sensors);
        case Form::flat:
        case Form::table:
            break;
        }
        if (sensors.empty())
            return;
        const bool isGrouped = display_.form() == Form::table;
        const std::string age = isGrouped ? ageOfCollection() : "";
        for (Sensor& sensor : sensors)
            if (sensor.chip == "ipmi")
                sensor.device = age;
        const TextStyle style = display_.style();
        out.write(sensorTable(sensors, isGrouped ? Grouping::byChip : Grouping::none, style));
        if (isGrouped)
            writeSummary(out, summaryOf(sensors),
                isOfKernel && !selection_.isGiven() ? otherChannels() : "", style);
    }

    static void writeInstances(Output& out, const Sensors& sensors)
    {
        Instances instances;
        for (const Sensor& sensor : sensors)
            instances.push_back(sensor.instance);
        writeJson(out, sensorClass, instances);
    }

    void writeSummary(
        Output& out, std::string text, const std::string& others, const TextStyle& style) const
    {
        if (!others.empty())
            text += (text.size() + others.size() + 2 <= style.width ? "  " : "\n") + others;
        out.write(text + "\n");
    }

    SelectionOptions selection_;
    DisplayOptions display_;
    SourceOptions source_;
};

} // namespace

std::unique_ptr<Command> makeListCommand(CLI::App& tool)
{
    return std::make_unique<ListCommand>(tool);
}

} // namespace Tools
