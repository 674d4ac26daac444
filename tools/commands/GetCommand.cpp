// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"
#include "tools/cim/SensorView.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/Output.h"
#include "tools/output/PropertyList.h"

#include <CLI/CLI.hpp>

#include <stdexcept>

namespace Tools {

namespace {

using Instances = std::vector<const Host::Instance*>;

Instances named(const Instances& sensors, std::string_view name)
{
    Instances found;
    for (const Host::Instance* const sensor : sensors)
        if (SensorView(*sensor).name() == name)
            found.push_back(sensor);
    return found;
}

[[noreturn]] void refuseAmbiguous(const std::string& name, const Instances& sensors)
{
    std::string text = "several sensors are named \"" + name + "\"; give one of their DeviceIDs:";
    for (const Host::Instance* const sensor : sensors)
        text.append(" \"").append(SensorView(*sensor).deviceId()).append("\"");
    throw std::runtime_error(text);
}

class GetCommand : public Command {
public:
    explicit GetCommand(CLI::App& tool)
        : Command(tool, "get", "Show one sensor in full, with the meanings of its codes")
    {
        parser()
            .add_option("DEVICEID", wanted_, "Its DeviceID, or its name when no other has the same")
            ->required()
            ->type_name("");
        source_.addModel(parser());
        source_.addProvider(parser());
        display_.addTo(parser());
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        bool isEmpty = false;
        if (show(out, isEmpty))
            return ExitCode::success;
        if (isEmpty) {
            checkMachineIsEmpty();
            return complainOfEmptyMachine(source_.model());
        }
        complain("no sensor has the DeviceID or the name \"" + wanted_ + "\"");
        return ExitCode::nothingFound;
    }

private:
    // False when there is no such sensor; isEmpty says whether there are none at all.
    bool show(Output& out, bool& isEmpty) const
    {
        ProviderClient provider(source_.providerFile());
        if (const Host::Instance* const sensor = provider.sensor(wanted_)) {
            print(out, *sensor);
            return true;
        }
        const Instances all = provider.sensors();
        isEmpty = all.empty();
        const Instances found = named(all, wanted_);
        if (found.size() > 1)
            refuseAmbiguous(wanted_, found);
        for (const Host::Instance* const sensor : found)
            print(out, *sensor);
        return !found.empty();
    }

    void print(Output& out, const Host::Instance& sensor) const
    {
        if (display_.isJson())
            writeJson(out, sensorClass, {&sensor});
        else
            out.write(propertyList(sensor, display_.width(), display_.isColored()));
    }

    std::string wanted_;
    SourceOptions source_;
    DisplayOptions display_;
};

} // namespace

std::unique_ptr<Command> makeGetCommand(CLI::App& tool)
{
    return std::make_unique<GetCommand>(tool);
}

} // namespace Tools
