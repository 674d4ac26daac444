// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "tools/EmptyMachine.h"
#include "tools/ObjectChoices.h"
#include "tools/ObjectSearch.h"
#include "tools/SourceOptions.h"
#include "tools/cim/AssociationGraph.h"
#include "tools/cim/ProviderClient.h"
#include "tools/commands/Commands.h"
#include "tools/commands/DisplayOptions.h"
#include "tools/commands/SelectionOptions.h"
#include "tools/output/ObjectTree.h"
#include "tools/output/Output.h"

#include <CLI/CLI.hpp>

#include <stdexcept>

namespace Tools {

namespace {

constexpr const char* walkFooter =
    "Each line names an object by its role in an association, with the class of the\n"
    "association. ... stands where more was shown before, `each' for all objects with\n"
    "that role, `others' for those that are related like the object above.";

class WalkCommand : public Command {
public:
    explicit WalkCommand(CLI::App& tool)
        : Command(tool, "walk", "Follow the associations from the computer system down")
    {
        CLI::Option* const object =
            parser()
                .add_option("OBJECT", wanted_, "Begin at this one; OBJECT as for sensorctl get")
                ->type_name("");
        selection_.addKind(parser());
        parser().get_option("--kind")->needs(object);
        source_.addModel(parser());
        source_.addProvider(parser());
        display_.addColor(parser());
        parser().footer(walkFooter);
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        ObjectFound root;
        const ExitCode code = show(out, root);
        if (code == ExitCode::nothingFound)
            return complainOfNothing(root);
        // A provider that cannot read the machine returns no sensors; this call throws then.
        countSensors();
        return code;
    }

private:
    ExitCode show(Output& out, ObjectFound& root) const
    {
        ProviderClient provider(source_.providerFiles());
        const Instances roots = findRoots(provider, root);
        if (roots.empty())
            return ExitCode::nothingFound;
        AssociationGraph graph;
        const bool isWhole = addAssociations(provider, graph);
        const TextStyle style = display_.style();
        for (const Host::Instance* const each : roots)
            writeTree(out, graph, graph.indexOf(each->objectPath()), style);
        return isWhole ? ExitCode::success : ExitCode::failure;
    }

    // Sets the root to what was found for the object that the user wants.
    Instances findRoots(ProviderClient& provider, ObjectFound& root) const
    {
        if (!wanted_)
            return provider.instances(computerSystemClass);
        root = ObjectSearch(provider, selection_.filter()).find(*wanted_);
        return root.object == nullptr ? Instances{} : Instances{root.object};
    }

    // Returns false when a class fails. The tree still shows the associations of the others.
    static bool addAssociations(ProviderClient& provider, AssociationGraph& graph)
    {
        bool isWhole = true;
        for (const std::string& className : provider.associationClasses()) {
            try {
                for (const Host::Instance* const each : provider.instances(className))
                    graph.add(*each);
            } catch (const std::runtime_error& error) {
                complain(className + ": " + error.what());
                isWhole = false;
            }
        }
        return isWhole;
    }

    ExitCode complainOfNothing(const ObjectFound& root) const
    {
        if (wanted_)
            return complainOfNoObject(root, parser(), source_.model());
        complain("there is no computer system");
        return ExitCode::nothingFound;
    }

    std::optional<std::string> wanted_;
    SelectionOptions selection_;
    SourceOptions source_;
    DisplayOptions display_;
};

} // namespace

std::unique_ptr<Command> makeWalkCommand(CLI::App& tool)
{
    return std::make_unique<WalkCommand>(tool);
}

} // namespace Tools
