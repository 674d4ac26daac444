// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/ChipDevices.h"

#include "platform/text/Trim.h"
#include "tools/sensors/FolderEntries.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string_view>
#include <vector>

namespace Tools {

namespace {

namespace Files = std::filesystem;

constexpr const char* folderOfChips = "/sys/class/hwmon";
constexpr const char* slotFolder = "/sys/bus/pci/slots";

// Returns the first line of a file; an empty text when there is none.
std::string lineIn(const std::string& file)
{
    std::ifstream stream(file);
    std::string line;
    std::getline(stream, line);
    return std::string(Text::trimmed(line));
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
std::optional<std::string> addressIn(const std::string& device)
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

// Returns the name of the slot of the PCI device at the address, such as "0000:03:00.0".
std::string slotOf(const std::string& address)
{
    for (const std::string& slot : entriesOf(slotFolder)) {
        const std::string place =
            lineIn(std::string(slotFolder).append("/").append(slot).append("/address"));
        if (!place.empty() && address.starts_with(place + "."))
            return "PCI slot " + slot;
    }
    return "";
}

// Returns what the device of a chip is, or that with the address which it belongs to.
std::string deviceIn(const std::string& folder, const Files::path& addressed)
{
    for (const char* const attribute : {"/model", "/model_name"})
        if (std::string model = lineIn(folder + attribute); !model.empty())
            return model;
    for (const std::string& place : {folder, addressed.string()})
        if (const auto interfaces = entriesOf(place + "/net"); !interfaces.empty())
            return interfaces.front();
    return slotOf(addressed.filename().string());
}

// Adds the device of the chip in the folder to those by the name of the chip.
void addDevice(
    std::map<std::string, std::string>& devices, const std::string& folder, const std::string& name)
{
    const std::string device = folder + "/device";
    std::error_code failure;
    const Files::path real = Files::canonical(device, failure);
    if (failure)
        return;
    // A class device, such as that of a controller, may stand between the chip and its address.
    for (Files::path place = real; place.has_relative_path(); place = place.parent_path())
        if (const auto suffix = addressIn(place.filename().string())) {
            devices.emplace(name + *suffix, deviceIn(device, place));
            return;
        }
    devices.emplace(name + "-acpi-0", deviceIn(device, real));
}

} // namespace

void nameDevices(Sensors& sensors)
{
    constexpr std::array<std::string_view, 3> buses = {"-scsi-", "-pci-", "-acpi-"};
    std::set<std::string> named; // the beginnings of names of chips that may have a device
    for (const Sensor& sensor : sensors)
        for (const std::string_view bus : buses)
            if (const auto end = sensor.chip.rfind(bus); end != std::string::npos)
                named.insert(sensor.chip.substr(0, end));
    if (named.empty())
        return;
    std::map<std::string, std::string> devices;
    for (const std::string& entry : entriesOf(folderOfChips)) {
        const std::string folder = std::string(folderOfChips).append("/").append(entry);
        if (const std::string name = lineIn(folder + "/name"); named.contains(name))
            addDevice(devices, folder, name);
    }
    for (Sensor& sensor : sensors)
        if (const auto device = devices.find(sensor.chip); device != devices.end())
            sensor.device = device->second;
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
    for (const std::string& chip : entriesOf(folderOfChips))
        for (const std::string& name :
            entriesOf(std::string(folderOfChips).append("/").append(chip)))
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
