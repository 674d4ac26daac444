// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LogSettings.h"
#include "tools/serve/FreedMemory.h"

#include <benchmark/benchmark.h>

int main(int argc, char** argv)
{
    // The settings of the environment do not reach the benchmarks.
    RynLog::configure({6000, "off", "off"});
    Tools::keepFreedMemory(4); // as in the server
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
