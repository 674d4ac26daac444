// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests of many threads while the hardware changes.

#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/Instance.h"
#include "tests/providers/Factories.h"
#include "tests/providers/SensorRequest.h"
#include "tests/support/Environment.h"
#include "tests/support/MountNamespace.h"

#include <gmock/gmock.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <map>
#include <string>
#include <thread>

namespace HwmonRequestsTests {

using Testing::BoundSysfs;

constexpr const char* chip = "hwmon/hwmon1"; // the chip that is unplugged
constexpr const char* chipsSensor = "/hwmon/nvme-pci-0200/temp1";
constexpr std::uint64_t lostCommunication = 13;

class HwmonRequestsTest : public Testing::MountNamespaceTest {
protected:
    // Returns the readings by device identifier.
    std::map<std::string, std::int64_t> readings()
    {
        const Testing::SensorRequest sensors(broker_, mi_);
        std::map<std::string, std::int64_t> found;
        for (const Host::Instance* const sensor : sensors.instances())
            if (!hasLostCommunication(*sensor))
                found[std::string(*sensor->property("DeviceID")->text())] =
                    *sensor->property("CurrentReading")->signedInteger();
        return found;
    }

private:
    static bool hasLostCommunication(const Host::Instance& sensor)
    {
        const auto states = sensor.property("OperationalStatus")->array()->elements();
        return !states.empty() && states[0].unsignedInteger() == lostCommunication;
    }

    Testing::EnvironmentVariable hardware_{"VORN_INSTRUMENTATION", "hwmon"};
    Host::Broker broker_;
    CMPIInstanceMI* mi_ =
        SensorProfileProvider_Create_InstanceMI(broker_.handle(), nullptr, nullptr);
};

TEST_F(HwmonRequestsTest, EightThreadsEnumerateTrueReadingsWhileChipsComeAndGo)
{
    BoundSysfs sysfs("hotplug");
    const auto whole = readings();
    ASSERT_EQ(whole.size(), 3U);
    std::atomic<bool> goOn{true};
    std::atomic<unsigned> requests{0};
    std::vector<std::jthread> clients;
    for (int client = 0; client < 8; ++client)
        clients.emplace_back([&] {
            while (goOn) {
                EXPECT_THAT(readings(), testing::IsSubsetOf(whole));
                ++requests;
            }
        });
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(3);
    for (unsigned time = 0; std::chrono::steady_clock::now() < end; ++time) {
        const std::string unplugged = "unplugged" + std::to_string(time);
        sysfs.rename(chip, unplugged);
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
        // As in the kernel, a chip that is plugged in again has a new folder.
        std::filesystem::copy(sysfs.path(unplugged), sysfs.path("spare"),
            std::filesystem::copy_options::recursive |
                std::filesystem::copy_options::copy_symlinks);
        sysfs.rename("spare", chip);
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    goOn = false;
    clients.clear();
    EXPECT_GT(requests, 8U);
    EXPECT_EQ(readings(), whole);
}

TEST_F(HwmonRequestsTest, AChipThatIsGoneIsNotInTheNextAnswer)
{
    BoundSysfs sysfs("hotplug");
    ASSERT_EQ(readings().size(), 3U);
    sysfs.rename(chip, "unplugged");
    const auto rest = readings();
    EXPECT_EQ(rest.size(), 2U);
    for (const auto& [device, reading] : rest)
        EXPECT_FALSE(device.ends_with(chipsSensor)) << device;
}

} // namespace HwmonRequestsTests
