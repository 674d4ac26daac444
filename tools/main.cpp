// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/CommandLine.h"
#include "tools/commands/Commands.h"

#include <malloc.h>

namespace {

// Has the allocator keep freed memory of any size: a command ends soon, and the kernel would map
// what it needs next page by page.
void keepFreedMemory()
{
    ::mallopt(M_MMAP_THRESHOLD, 32 << 20);
    ::mallopt(M_TRIM_THRESHOLD, 64 << 20);
}

} // namespace

int main(int argc, char** argv)
{
    using namespace Tools;
    keepFreedMemory();
    return runTool(argc, argv, [&](CLI::App& tool) {
        Commands commands;
        for (auto* const make : {makeListCommand, makeGetCommand, makeWalkCommand, makeWatchCommand,
                 makeCheckCommand, makeRecordCommand, makeCollectCommand, makeMetricsCommand})
            commands.push_back(make(tool));
        commands.push_back(makeServeCommand(tool, {argv, argv + argc}));
        return commands;
    });
}
