// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/ChipDevices.h"

#include "platform/text/Trim.h"
#include "tools/sensors/HwmonFiles.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <set>
#include <string_view>
#include <system_error>
#include <unordered_map>
#include <utility>

namespace Tools {

namespace {

namespace Files = std::filesystem;

constexpr const char* slotFolder = "/sys/bus/pci/slots";

// Returns the first line of a file; an empty text when there is none.
std::string lineIn(const std::string& file)
{
    const std::string text = contentOf(file).value_or("");
    return std::string(Text::trimmed(text.substr(0, text.find('\n'))));
}

template <typename... Numbers>
std::string formatted(const char* format, Numbers... numbers)
{
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), format, numbers...);
    return text.data();
}

// Returns what libsensors appends to the names of chips with that device, which the kernel names by
// its address on a SCSI or PCI bus. Returns nothing for other names.
std::optional<std::string> suffixFor(const std::string& device)
{
    unsigned first = 0;
    unsigned second = 0;
    unsigned third = 0;
    unsigned fourth = 0;
    int end = 0;
    const auto isWhole = [&](int count) {
        return count == 4 && static_cast<std::size_t>(end) == device.size();
    };
    const char* const text = device.c_str();
    if (isWhole(std::sscanf(text, "%u:%u:%u:%x%n", &first, &second, &third, &fourth, &end)))
        return formatted("-scsi-%u-%x", first, (second << 8U) + (third << 4U) + fourth);
    if (isWhole(std::sscanf(text, "%x:%2x:%2x.%1x%n", &first, &second, &third, &fourth, &end)))
        return formatted("-pci-%04x", (first << 16U) + (second << 8U) + (third << 3U) + fourth);
    return std::nullopt;
}

// Returns whether the chip is on a bus whose devices have names.
bool mayHaveDevice(const Sensor& sensor)
{
    constexpr std::array<std::string_view, 3> buses = {"-scsi-", "-pci-", "-acpi-"};
    return std::any_of(buses.begin(), buses.end(),
        [&](std::string_view bus) { return sensor.chip.find(bus) != std::string::npos; });
}

} // namespace

ChipDevices::Chip ChipDevices::chipIn(const std::string& folder)
{
    Chip chip;
    std::error_code failure;
    const Files::path real = Files::canonical(folder + "/device", failure);
    if (failure)
        return chip;
    std::string suffix = "-acpi-0";
    chip.folders = {real};
    // A class device, such as that of a controller, may stand between the chip and its address.
    for (Files::path place = real; place.has_relative_path(); place = place.parent_path())
        if (auto found = suffixFor(place.filename().string())) {
            suffix = std::move(*found);
            if (place != real)
                chip.folders.push_back(place);
            break;
        }
    chip.name = lineIn(folder + "/name") + suffix;
    chip.model = lineIn(folder + "/device/model");
    if (chip.model.empty())
        chip.model = lineIn(folder + "/device/model_name");
    return chip;
}

// Returns the first interface of each device that has some. Lists them each time, as udev renames
// them while their chip stays: all at once, since most chips have none.
ChipDevices::Interfaces ChipDevices::networkInterfaces()
{
    const Files::path folder = "/sys/class/net";
    Interfaces first;
    for (const std::string& name : entriesOf(folder)) {
        std::error_code failure;
        const Files::path link = Files::read_symlink(folder / name, failure);
        if (failure || link.native().find("/virtual/") != std::string::npos)
            continue;
        // The folder of the device has a folder "net" with one of the interface.
        const Files::path device = (folder / link).lexically_normal().parent_path().parent_path();
        auto& interface = first.try_emplace(device, name).first->second;
        interface = std::min(interface, name);
    }
    return first;
}

std::string ChipDevices::deviceOf(const Chip& chip, const Interfaces& interfaces) const
{
    if (!chip.model.empty())
        return chip.model;
    for (const std::string& folder : chip.folders)
        if (const auto found = interfaces.find(folder); found != interfaces.end())
            return found->second;
    const std::string address = Files::path(chip.folders.back()).filename();
    const auto slot = slotAt_.find(address.substr(0, address.rfind('.')));
    return slot == slotAt_.end() ? "" : "PCI slot " + slot->second;
}

void ChipDevices::renewChips(const Vorn::Hwmon::Machine& machine)
{
    decltype(chips_) present;
    for (const auto& folder : machine.chips)
        if (auto known = chips_.extract(folder))
            present.insert(std::move(known));
        else
            present.emplace(folder, chipIn(std::string(hwmonFolder).append("/") + folder.first));
    chips_ = std::move(present);
}

void ChipDevices::renewSlots()
{
    auto slots = entriesOf(slotFolder);
    if (slots == slots_)
        return;
    slots_ = std::move(slots);
    slotAt_.clear();
    for (const std::string& slot : slots_)
        if (std::string address = lineIn(std::string(slotFolder) + "/" + slot + "/address");
            !address.empty())
            slotAt_.emplace(std::move(address), slot);
}

void ChipDevices::nameIn(Sensors& sensors, const Vorn::Hwmon::Machine& machine)
{
    if (std::none_of(sensors.begin(), sensors.end(), mayHaveDevice))
        return;
    renewChips(machine);
    renewSlots();
    const Interfaces interfaces = networkInterfaces();
    std::unordered_map<std::string_view, std::string> devices; // by the name of the chip
    for (const auto& [folder, chip] : chips_)
        if (!chip.folders.empty())
            devices.emplace(chip.name, deviceOf(chip, interfaces));
    for (Sensor& sensor : sensors)
        if (const auto device = devices.find(sensor.chip); device != devices.end())
            sensor.device = device->second;
}

void nameDevices(Sensors& sensors)
{
    if (std::none_of(sensors.begin(), sensors.end(), mayHaveDevice))
        return; // without a list of the chips
    try {
        ChipDevices().nameIn(sensors, Vorn::Hwmon::presentMachine());
    } catch (const std::system_error&) { // the chips cannot be listed
    }
}

std::string otherChannels()
{
    // The attributes that each channel of a kind has.
    struct OtherKind {
        std::string_view attribute;
        std::string_view suffix;
        const char* kind;
    };
    constexpr std::array otherKinds = {OtherKind{"curr", "_input", "current"},
        OtherKind{"power", "_input", "power"}, OtherKind{"power", "_average", "power"},
        OtherKind{"energy", "_input", "energy"}, OtherKind{"humidity", "_input", "humidity"},
        OtherKind{"intrusion", "_alarm", "intrusion"}};
    std::set<std::string> channels;
    std::set<std::string> kinds;
    for (const std::string& chip : entriesOf(hwmonFolder))
        visitEntries(std::string(hwmonFolder).append("/").append(chip), [&](std::string_view name) {
            for (const OtherKind& each : otherKinds)
                if (name.front() == each.attribute.front() && name.starts_with(each.attribute) &&
                    name.ends_with(each.suffix)) {
                    name.remove_suffix(each.suffix.size());
                    channels.insert(std::string(chip).append(name));
                    kinds.insert(each.kind);
                    return;
                }
        });
    if (channels.empty())
        return "";
    std::string list;
    for (const std::string& kind : kinds)
        list.append(list.empty() ? "" : ", ").append(kind);
    return std::to_string(channels.size()) +
           (channels.size() == 1 ? " channel of another kind is" : " channels of other kinds are") +
           " not shown (" + list + ").";
}

} // namespace Tools
