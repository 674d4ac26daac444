// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/CommandLine.h"
#include "tools/commands/Commands.h"

int main(int argc, char** argv)
{
    using namespace Tools;
    return runTool(argc, argv, [&](CLI::App& tool) {
        Commands commands;
        for (auto* const make : {makeListCommand, makeGetCommand, makeWalkCommand, makeWatchCommand,
                 makeCheckCommand, makeRecordCommand, makeCollectCommand, makeMetricsCommand})
            commands.push_back(make(tool));
        commands.push_back(makeServeCommand(tool, {argv, argv + argc}));
        return commands;
    });
}
