// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the process costs, without sanitizers.

#include "tests/tools/collect/CollectProcessTest.h"

#include <unistd.h>

namespace CollectCostTests {

using CollectCostTest = Testing::CollectProcessTest;

// Returns the size of the memory in KiB.
unsigned long residentSizeOf(::pid_t process)
{
    std::ifstream file("/proc/" + std::to_string(process) + "/status");
    for (std::string word; file >> word;)
        if (unsigned long size = 0; word == "VmRSS:" && file >> size)
            return size;
    throw std::out_of_range("VmRSS");
}

double cpuSecondsOf(::pid_t process)
{
    std::ifstream file("/proc/" + std::to_string(process) + "/stat");
    std::string word;
    for (int field = 1; field < 14; ++field)
        file >> word;
    double user = 0;
    double system = 0;
    file >> user >> system;
    return (user + system) / static_cast<double>(::sysconf(_SC_CLK_TCK));
}

// Ten passes, ten times as often as by default. A command takes a millisecond.
TEST_F(CollectCostTest, StaysSmall)
{
    start({{"SIMULATED_BMC_DELAY", "1"}});
    const double before = cpuSecondsOf(process_);
    constexpr std::size_t passesMeasured = 10;
    const std::size_t first = passes().size();
    ASSERT_TRUE(Testing::waitUntil([&] { return passes().size() > first + passesMeasured; }));
    constexpr double defaultInterval = 10;
    EXPECT_LT((cpuSecondsOf(process_) - before) / (passesMeasured * defaultInterval), 0.005);
    EXPECT_LT(residentSizeOf(process_), 8U << 10U);

    // The repository and one set of thresholds are read besides, two are spent on a satellite.
    const std::vector<std::size_t> counts = passes();
    const std::size_t sensors = collected().nodes.size();
    for (std::size_t pass = first; pass < first + passesMeasured; ++pass) {
        EXPECT_GE(counts[pass], sensors);
        EXPECT_LE(counts[pass], sensors + 5);
    }
}

} // namespace CollectCostTests
