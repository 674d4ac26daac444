// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/LogSettings.h"

#include <benchmark/benchmark.h>

int main(int argc, char** argv)
{
    // The settings of the environment do not reach the benchmarks.
    RynLog::configure({6000, "off", "off"});
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
