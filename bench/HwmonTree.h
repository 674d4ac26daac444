// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A machine with any number of sensors on chips, as a sysfs tree that is bound over /sys/class.
// REQUIRES: the process is in a mount namespace of its own, with the right to mount.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <array>
#include <cerrno>
#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <string>
#include <system_error>
#include <vector>

#include <sys/mount.h>

namespace Bench {

class HwmonTree {
public:
    // How the chips are made.
    struct Design {
        const char* bus;
        int temperatures;
        int voltages;
        int fans;

        int sensors() const { return temperatures + voltages + fans; }
    };
    static constexpr Design large = {"platform", 7, 7, 6};
    // Such as those of disks and network cards: each tenth chip has a network interface.
    static constexpr Design onPci = {"pci", 4, 0, 0};

    struct Chip {
        std::string folder;
        std::vector<std::string> attributes; // those with a number
    };

    // `sensors` is rounded down to whole chips.
    explicit HwmonTree(int sensors, const Design& design = large) : design_(design)
    {
        std::filesystem::create_directories(folder_.path() / "hwmon");
        for (int number = 1; number <= sensors / design_.sensors(); ++number)
            chips_.push_back(layOut(number));
        if (::mount(folder_.path().c_str(), mountPoint, nullptr, MS_BIND, nullptr) != 0)
            throw std::system_error(errno, std::generic_category(), "mount over /sys/class");
    }
    ~HwmonTree() { ::umount2(mountPoint, MNT_DETACH); }
    HwmonTree(const HwmonTree&) = delete;
    HwmonTree& operator=(const HwmonTree&) = delete;

    const std::vector<Chip>& chips() const { return chips_; }
    std::size_t sensors() const
    {
        return chips_.size() * static_cast<std::size_t>(design_.sensors());
    }

    // Returns the device identifier of a sensor on the first chip.
    std::string someDeviceID() const
    {
        const bool isOnPci = design_.bus == std::string("pci");
        return std::string("Core 1:/hwmon/bench-") + (isOnPci ? "pci-0008" : "isa-0001") + "/temp1";
    }

private:
    static constexpr const char* mountPoint = "/sys/class";

    Chip layOut(int number) const
    {
        const std::string device = "devices/" + addressOf(number);
        std::filesystem::create_directories(folder_.path() / device);
        std::filesystem::create_symlink(
            std::string("../../bus/") + design_.bus, folder_.path() / device / "subsystem");
        if (design_.bus == std::string("pci") && number % 10 == 0) {
            const std::string name = "eth" + std::to_string(number);
            std::filesystem::create_directories(folder_.path() / device / "net" / name);
            std::filesystem::create_directories(folder_.path() / "net");
            std::filesystem::create_symlink(
                "../" + device + "/net/" + name, folder_.path() / "net" / name);
        }
        const std::string folder = "hwmon/hwmon" + std::to_string(number) + "/";
        std::filesystem::create_directories(folder_.path() / folder);
        std::filesystem::create_symlink("../../" + device, folder_.path() / (folder + "device"));
        folder_.write(folder + "name", "bench\n");
        Chip chip{"/sys/class/" + folder, {}};
        const auto add = [&](const std::string& name, const char* value) {
            folder_.write(folder + name, std::string(value) + "\n");
            chip.attributes.push_back(name);
        };
        for (int index = 1; index <= design_.temperatures; ++index) {
            const std::string temperature = "temp" + std::to_string(index);
            folder_.write(folder + temperature + "_label", "Core " + std::to_string(index) + "\n");
            add(temperature + "_input", "41000");
            add(temperature + "_max", "80000");
            add(temperature + "_crit", "95000");
            add(temperature + "_crit_alarm", "0");
        }
        for (int index = 1; index <= design_.voltages; ++index) {
            const std::string voltage = "in" + std::to_string(index);
            add(voltage + "_input", "1200");
            add(voltage + "_min", "1100");
            add(voltage + "_max", "1300");
            add(voltage + "_alarm", "0");
        }
        for (int index = 1; index <= design_.fans; ++index) {
            const std::string fan = "fan" + std::to_string(index);
            add(fan + "_input", "900");
            add(fan + "_min", "300");
            add(fan + "_alarm", "0");
        }
        return chip;
    }

    std::string addressOf(int number) const
    {
        if (design_.bus != std::string("pci"))
            return "bench." + std::to_string(number);
        std::array<char, 32> address{};
        std::snprintf(address.data(), address.size(), "0000:%02x:%02x.0", unsigned(number) / 32,
            unsigned(number) % 32);
        return address.data();
    }

    const Design design_;
    Testing::TemporaryFolder folder_;
    std::vector<Chip> chips_;
};

} // namespace Bench
