// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Slow chips, which `hwmon:parallel` reads at the same time.

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "platform/utilities/Descriptor.h"
#include "tests/platform/instrumentation/HwmonMachine.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <iterator>
#include <list>
#include <thread>

namespace HwmonParallelTests {

using std::chrono::milliseconds;
using Testing::BoundSysfs;
using Testing::EnvironmentVariable;
using Vorn::Descriptor;

using HwmonParallelTest = Testing::HwmonTest;
using Clock = std::chrono::steady_clock;

constexpr milliseconds lateness{100};

// A pipe over the file of an attribute, from which each reader gets the text late, as it does from
// a slow chip.
class LateAttribute {
public:
    LateAttribute(const std::string& attribute, std::string text)
        : text_(std::move(text)), mount_(pipe(), attribute),
          writer_([this](const std::stop_token& stop) { write(stop); })
    {
    }
    ~LateAttribute()
    {
        writer_.request_stop();
        const Descriptor reader(::open(pipe_.c_str(), O_RDONLY | O_NONBLOCK));
        writer_.join();
    }
    LateAttribute(const LateAttribute&) = delete;
    LateAttribute& operator=(const LateAttribute&) = delete;

private:
    const std::filesystem::path& pipe()
    {
        EXPECT_EQ(::mkfifo(pipe_.c_str(), 0600), 0);
        return pipe_;
    }

    void write(const std::stop_token& stop)
    {
        std::signal(SIGPIPE, SIG_IGN);
        while (!stop.stop_requested()) {
            {
                const Descriptor file(::open(pipe_.c_str(), O_WRONLY)); // waits for a reader
                std::this_thread::sleep_for(lateness);
                // Fails for the reader of the last value, when it has not closed the pipe in time.
                [[maybe_unused]] const auto written =
                    ::write(file.number(), text_.data(), text_.size());
            }
            std::this_thread::sleep_for(milliseconds(10));
        }
    }

    std::string text_;
    Testing::TemporaryFolder folder_;
    std::filesystem::path pipe_ = folder_.path() / "pipe";
    Testing::BindMount mount_;
    std::jthread writer_;
};

std::ptrdiff_t threads()
{
    const std::filesystem::directory_iterator entries("/proc/self/task");
    return std::distance(begin(entries), end(entries));
}

TEST_F(HwmonParallelTest, TenSlowChipsTakeLittleLongerThanOne)
{
    constexpr int chips = 10;
    BoundSysfs sysfs("");
    std::list<LateAttribute> attributes;
    for (int chip = 0; chip < chips; ++chip) {
        const std::string folder = "hwmon/hwmon" + std::to_string(chip);
        sysfs.addChip(
            "hwmon" + std::to_string(chip), "slow", "platform", "slow." + std::to_string(chip));
        sysfs.write(folder + "/temp1_input", "0\n");
        attributes.emplace_back(
            "/sys/class/" + folder + "/temp1_input", std::to_string(chip * 1000) + "\n");
    }
    const EnvironmentVariable parallel("VORN_INSTRUMENTATION", "hwmon:parallel");
    Testing::walk(); // makes the list of chips, which is not measured
    const auto threadsBefore = threads();
    const auto begin = Clock::now();
    const auto nodes = Testing::walk();
    const auto elapsed = Clock::now() - begin;
    EXPECT_GE(elapsed, lateness);
    EXPECT_LT(elapsed, 2 * lateness);
    EXPECT_EQ(threads(), threadsBefore);
    ASSERT_EQ(nodes.size(), std::size_t{chips});
    for (std::size_t chip = 0; chip < nodes.size(); ++chip)
        EXPECT_EQ(nodes[chip].values.reading, static_cast<double>(chip));
}

TEST_F(HwmonParallelTest, ReadsTheSameValues)
{
    for (const std::string machine : {"server", "twosocket", "laptop"}) {
        const BoundSysfs sysfs(machine);
        const auto nodes = Testing::walk();
        const EnvironmentVariable parallel("VORN_INSTRUMENTATION", "hwmon:parallel");
        EXPECT_EQ(Testing::walk(), nodes) << machine;
    }
}

TEST_F(HwmonParallelTest, ReadsAgainWhatIsReadTwice)
{
    Testing::OneChip chip(Testing::Attributes{{"temp1_input", "20000"}});
    Vorn::HwmonSource source(Vorn::HwmonSource::Order::parallel);
    const auto nodes = source.nodes(Vorn::NodeLexicon::NodeType::Temperature);
    EXPECT_EQ(source.read(nodes.at(0)).reading, 20.0);
    chip.set("temp1_input", "21000");
    EXPECT_EQ(source.read(nodes.at(0)).reading, 21.0);
}

} // namespace HwmonParallelTests
