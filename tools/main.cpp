// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/CommandLine.h"
#include "tools/commands/Commands.h"

#include <malloc.h>
#include <sys/mman.h>

#include <cstddef>
#include <cstdlib>

namespace {

// Has the allocator keep freed memory of any size, and take most of what a list of a thousand
// sensors needs from huge pages where the system grants them: page faults take a tenth of the time
// of a list otherwise. It is called before the command is known, and takes some thirty microseconds
// of those that need little memory.
void prepareMemory()
{
    constexpr std::size_t hugePage = std::size_t{2} << 20;
    constexpr std::size_t size = 4 * hugePage;
    ::mallopt(M_MMAP_THRESHOLD, 32 << 20);
    ::mallopt(M_TRIM_THRESHOLD, 64 << 20);
    void* const block = std::aligned_alloc(hugePage, size);
    if (block != nullptr)
        ::madvise(block, size, MADV_HUGEPAGE);
    std::free(block);
}

} // namespace

int main(int argc, char** argv)
{
    using namespace Tools;
    prepareMemory();
    return runTool(argc, argv, [&](CLI::App& tool) {
        Commands commands;
        for (auto* const make : {makeListCommand, makeGetCommand, makeWalkCommand, makeWatchCommand,
                 makeCheckCommand, makeRecordCommand, makeCollectCommand, makeMetricsCommand})
            commands.push_back(make(tool));
        commands.push_back(makeServeCommand(tool, {argv, argv + argc}));
        return commands;
    });
}
