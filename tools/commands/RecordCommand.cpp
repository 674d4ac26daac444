// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Recorder.h"
#include "tools/EmptyMachine.h"
#include "tools/SourceOptions.h"
#include "tools/commands/Commands.h"
#include "tools/output/FileReplacement.h"
#include "tools/output/JsonText.h"
#include "tools/output/Output.h"
#include "tools/sensors/Sources.h"

#include <CLI/CLI.hpp>

#include <optional>
#include <stdexcept>
#include <string>

namespace Tools {

namespace {

class RecordCommand : public Command {
public:
    explicit RecordCommand(CLI::App& tool)
        : Command(tool, "record", "Write the present machine as a model file for --model")
    {
        parser()
            .add_option("-o,--output", file_,
                "Replace this file instead of writing to "
                "standard output")
            ->type_name("FILE");
        source_.addModel(parser());
    }

    ExitCode run(Output& out) override
    {
        source_.selectMachine();
        const std::string recording = escapeUnprintable(Vorn::recordMachineFile());
        const bool isEmpty = countSensors() == 0;
        // A record of the other sources is no record of the machine.
        if (const auto failures = failuresOfSources(false); !failures.empty())
            throw std::runtime_error(failures.front());
        if (!file_ || *file_ == "-")
            out.write(recording);
        else if (!isEmpty) // the file may be the reference of `check --expect`
            replaceFile(*file_, recording);
        return isEmpty ? complainOfEmptyMachine(source_.model()) : ExitCode::success;
    }

private:
    std::optional<std::string> file_;
    SourceOptions source_;
};

} // namespace

std::unique_ptr<Command> makeRecordCommand(CLI::App& tool)
{
    return std::make_unique<RecordCommand>(tool);
}

} // namespace Tools
