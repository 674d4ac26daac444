// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Instance.h"
#include "tools/EmptyMachine.h"
#include "tools/ObjectSearch.h"
#include "tools/SourceOptions.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/output/JsonDocument.h"
#include "tools/output/Output.h"
#include "tools/output/PropertyList.h"
#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

class GetCommand : public Command {
public:
    explicit GetCommand(CLI::App& tool)
        : Command(tool, "get", "Show one object in full, with the meanings of its codes")
    {
        parser()
            .add_option(
                "OBJECT", wanted_, "Its DeviceID, InstanceID, object path or unambiguous name")
            ->required()
            ->type_name("");
        source_.addModel(parser());
        source_.addProvider(parser());
        display_.addJson(parser());
        display_.addColor(parser());
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        bool isEmpty = false;
        if (show(out, isEmpty))
            return ExitCode::success;
        return complainOfNoObject(wanted_, isEmpty, source_.model());
    }

private:
    // Returns false when there is no such object; sets isEmpty when the machine has no sensors.
    bool show(Output& out, bool& isEmpty) const
    {
        ProviderClient provider(source_.providerFiles());
        const ObjectFound found = findObject(provider, wanted_);
        isEmpty = found.isMachineEmpty;
        if (found.object == nullptr)
            return false;
        if (display_.isJson())
            writeJson(out, found.object->className(), {found.object});
        else
            out.write(propertyList(*found.object, outputWidth(), display_.isColored()));
        return true;
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
