// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Instance.h"
#include "tools/ObjectChoices.h"
#include "tools/ObjectSearch.h"
#include "tools/SourceOptions.h"
#include "tools/UsageError.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/commands/SelectionOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/Output.h"
#include "tools/output/PropertyList.h"
#include "tools/output/SensorDetails.h"
#include "tools/output/SensorJson.h"
#include "tools/sensors/ChipDevices.h"
#include "tools/sensors/Sources.h"

#include <CLI/CLI.hpp>

#include <algorithm>

namespace Tools {

namespace {

class GetCommand : public Command {
public:
    explicit GetCommand(CLI::App& tool)
        : Command(tool, "get", "Show single objects, most of all sensors, in detail")
    {
        parser()
            .add_option(
                "OBJECT", wanted_, "A selector as for list, an InstanceID or an object path")
            ->required()
            ->type_name("");
        parser().add_flag(
            "-v,--verbose", isVerbose_, "Show all properties with the meanings of their codes");
        selection_.addKind(parser());
        selection_.addProblems(parser());
        display_.addJson(parser());
        display_.addColor(parser());
        source_.addModel(parser());
        source_.addProvider(parser());
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        const ObjectFound missing = show(out);
        if (missing.complaint.empty())
            return ExitCode::success;
        return complainOfNoObject(missing, parser(), source_.model());
    }

private:
    // Returns the first of the wanted objects that was not found; nothing is printed then.
    ObjectFound show(Output& out) const
    {
        ProviderClient provider(source_.providerFiles());
        ObjectSearch search(provider, selection_.filter());
        Instances objects;
        Sensors sensors;
        for (const std::string& wanted : wanted_) {
            ObjectFound found = search.find(wanted);
            if (found.object == nullptr)
                return found;
            objects.push_back(found.object);
            if (found.object->className() == sensorClass)
                sensors.emplace_back(*found.object);
        }
        if (readsHwmon())
            nameDevices(sensors);
        write(out, provider, objects, sensors);
        return {};
    }

    void write(Output& out, const ProviderClient& provider, const Instances& objects,
        const Sensors& sensors) const
    {
        const std::string_view className = objects.front()->className();
        const bool areOfOneClass = std::all_of(objects.begin(), objects.end(),
            [&](const Host::Instance* object) { return object->className() == className; });
        if (display_.form() == Form::cim && areOfOneClass)
            return writeJson(out, className, objects);
        if (display_.form() == Form::json && sensors.size() == objects.size())
            return writeSensorJson(out, sensors);
        if (display_.form() != Form::table)
            throw UsageError(display_.form() == Form::json ? "--json is for sensors; --cim for all"
                                                           : "--cim is for objects of one class");
        auto sensor = sensors.begin();
        const char* separator = "";
        for (const Host::Instance* const object : objects) {
            const bool isSensor = object->className() == sensorClass;
            out.write(separator + (isSensor && !isVerbose_
                                          ? sensorDetails(*sensor, display_.style())
                                          : propertyList(*object, provider.classOf(*object),
                                                display_.style())));
            sensor += isSensor ? 1 : 0;
            separator = "\n";
        }
    }

    std::vector<std::string> wanted_;
    bool isVerbose_ = false;
    SelectionOptions selection_;
    DisplayOptions display_;
    SourceOptions source_;
};

} // namespace

std::unique_ptr<Command> makeGetCommand(CLI::App& tool)
{
    return std::make_unique<GetCommand>(tool);
}

} // namespace Tools
