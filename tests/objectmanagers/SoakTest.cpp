// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Clients keep asking OpenPegasus and sfcb while a chip of the machine comes and goes.

#include "tests/objectmanagers/Agents.h"
#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/MountNamespace.h"
#include "tests/support/Texts.h"

#include <gtest/gtest.h>

#include <unistd.h>

#include <atomic>
#include <chrono>
#include <thread>

namespace {

using namespace Testing;
using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

std::size_t residentKilobytes(::pid_t process)
{
    const std::string status = contentOf(processFolder(process) / "status");
    return std::stoul(status.substr(status.find("VmRSS:") + 6));
}

constexpr auto soakTime = 60s;
constexpr int clientsOfEach = 8;
constexpr std::size_t growthKilobytes = 4096;

// Runs clients of one object manager in threads.
class Clients {
public:
    Clients(const InstalledManager& manager, Clock::time_point end) : manager_(manager)
    {
        const std::string system =
            ask({"ein", manager.url("ZUMLO_ComputerSystem")}).objects.begin()->first;
        for (int i = 0; i < clientsOfEach; ++i)
            threads_.emplace_back([this, end, system, i] {
                try {
                    while (Clock::now() < end)
                        askOnce(i % 4, system);
                } catch (const std::exception& error) {
                    ADD_FAILURE() << error.what();
                }
            });
    }

    void join()
    {
        for (std::thread& thread : threads_)
            thread.join();
        EXPECT_GT(answers_, 100);
        EXPECT_GT(withChip_, 0);
        EXPECT_GT(withoutChip_, 0);
        testing::Test::RecordProperty(manager_.name() + "Answers", answers_);
    }

private:
    void askOnce(int kind, const std::string& system)
    {
        const std::string sensors = manager_.url("ZUMLO_NumericSensor");
        const Answer answer =
            kind == 0   ? ask({"ei", sensors})
            : kind == 1 ? ask({"ein", sensors})
            : kind == 2 ? ask({"ei", manager_.url("ZUMLO_SensorSystemDevice")})
                        : ask({"ain", "-ac", "ZUMLO_SensorSystemDevice", manager_.url(system)});
        ++answers_;
        ++(answer.objects.size() == 3 ? withChip_ : withoutChip_);
        EXPECT_TRUE(answer.objects.size() == 2 || answer.objects.size() == 3) << describe(answer);
    }

    const InstalledManager& manager_;
    std::atomic<int> answers_{0};
    std::atomic<int> withChip_{0};
    std::atomic<int> withoutChip_{0};
    std::vector<std::thread> threads_;
};

TEST(SoakTest, NothingFailsOrGrowsWhileAChipComesAndGoes)
{
    // It lasts long enough to run beside all other tests without being in their way.
    EXPECT_NE(::nice(10), -1);
    BoundSysfs sysfs("hotplug");
    const std::vector<const InstalledManager*> managers = {
        &InstalledManager::openPegasus(), &InstalledManager::sfcb()};
    for (const InstalledManager* manager : managers) {
        manager->reset();
        manager->startWithProviders({{"RYNLOG_LOG", "off"}});
    }
    const auto soak = [&](Clock::duration time) {
        const auto end = Clock::now() + time;
        Clients ofOpenPegasus(*managers[0], end);
        Clients ofSfcb(*managers[1], end);
        while (Clock::now() < end) {
            sysfs.rename("hwmon/hwmon2", "gone");
            std::this_thread::sleep_for(300ms);
            sysfs.renew("gone");
            sysfs.rename("gone", "hwmon/hwmon2");
            std::this_thread::sleep_for(300ms);
        }
        ofOpenPegasus.join();
        ofSfcb.join();
    };
    // Memory of the first requests stays.
    soak(soakTime / 6);
    std::map<::pid_t, std::size_t> before;
    for (const InstalledManager* manager : managers) {
        const auto agents = agentsBelow(manager->folder());
        EXPECT_FALSE(agents.empty()) << manager->name();
        for (const ::pid_t agent : agents)
            before[agent] = residentKilobytes(agent);
    }
    soak(soakTime);
    for (const InstalledManager* manager : managers)
        for (const ::pid_t agent : agentsBelow(manager->folder())) {
            EXPECT_TRUE(before.contains(agent)) << manager->name() << ": an agent ended";
            EXPECT_LT(residentKilobytes(agent), before[agent] + growthKilobytes) << manager->name();
        }
}

} // namespace
