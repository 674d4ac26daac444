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

// Returns the names and the identities of the chips' folders; none when they cannot be listed.
auto presentChips()
{
    try {
        return Vorn::Hwmon::presentMachine().chips;
    } catch (const std::system_error&) {
        return decltype(Vorn::Hwmon::Machine::chips)();
    }
}

} // namespace

ChipDevices::Chip ChipDevices::chipIn(const std::string& folder)
{
    Chip chip;
    std::error_code failure;
    const Files::path real = Files::canonical(folder + "/device", failure);
    if (failure)
        return chip;
    chip.suffix = "-acpi-0";
    chip.folders = {real};
    // A class device, such as that of a controller, may stand between the chip and its address.
    for (Files::path place = real; place.has_relative_path(); place = place.parent_path())
        if (const auto suffix = suffixFor(place.filename().string())) {
            chip.suffix = *suffix;
            if (place != real)
                chip.folders.push_back(place);
            break;
        }
    chip.model = lineIn(folder + "/device/model");
    if (chip.model.empty())
        chip.model = lineIn(folder + "/device/model_name");
    return chip;
}

// Looks for network interfaces each time, as udev renames them while their chip stays.
std::string ChipDevices::deviceOf(const Chip& chip) const
{
    if (!chip.model.empty())
        return chip.model;
    for (const std::string& folder : chip.folders)
        if (const auto interfaces = entriesOf(folder + "/net"); !interfaces.empty())
            return *std::min_element(interfaces.begin(), interfaces.end());
    const std::string address = Files::path(chip.folders.back()).filename();
    const auto slot = slotAt_.find(address.substr(0, address.rfind('.')));
    return slot == slotAt_.end() ? "" : "PCI slot " + slot->second;
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

void ChipDevices::nameIn(Sensors& sensors)
{
    constexpr std::array<std::string_view, 3> buses = {"-scsi-", "-pci-", "-acpi-"};
    std::set<std::string> named; // the beginnings of names of chips that may have a device
    for (const Sensor& sensor : sensors)
        for (const std::string_view bus : buses)
            if (const auto end = sensor.chip.rfind(bus); end != std::string::npos)
                named.insert(sensor.chip.substr(0, end));
    if (named.empty())
        return;
    renewSlots();
    std::map<std::string, Known> present;
    std::map<std::string, std::string> devices; // by the name of the chip
    for (const auto& [entry, id] : presentChips()) {
        const std::string folder = std::string(hwmonFolder).append("/").append(entry);
        const auto before = known_.find(entry);
        Known& known = present[entry];
        if (before != known_.end() && before->second.id == id)
            known = std::move(before->second);
        else
            known = {id, lineIn(folder + "/name"), std::nullopt};
        if (!named.contains(known.name))
            continue;
        if (!known.chip)
            known.chip = chipIn(folder);
        if (!known.chip->folders.empty())
            devices.emplace(known.name + known.chip->suffix, deviceOf(*known.chip));
    }
    for (Sensor& sensor : sensors)
        if (const auto device = devices.find(sensor.chip); device != devices.end())
            sensor.device = device->second;
    known_ = std::move(present);
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
        for (const std::string& name : entriesOf(std::string(hwmonFolder).append("/").append(chip)))
            for (const OtherKind& each : otherKinds)
                if (name.starts_with(each.attribute) && name.ends_with(each.suffix)) {
                    channels.insert(chip + name.substr(0, name.size() - each.suffix.size()));
                    kinds.insert(each.kind);
                }
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
