// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/ChipDevices.h"

#include "platform/text/Trim.h"

#include <dirent.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

namespace Tools {

namespace {

namespace Files = std::filesystem;

constexpr const char* hwmonFolder = "/sys/class/hwmon";
constexpr const char* slotFolder = "/sys/bus/pci/slots";

// Returns the first line of a file; an empty text when there is none.
std::string lineIn(const std::string& file)
{
    std::ifstream stream(file);
    std::string line;
    std::getline(stream, line);
    return std::string(Text::trimmed(line));
}

std::vector<std::string> entriesOf(const std::string& folder)
{
    std::vector<std::string> names;
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(::opendir(folder.c_str()), ::closedir);
    if (!directory)
        return names;
    while (const dirent* const entry = ::readdir(directory.get()))
        if (entry->d_name[0] != '.')
            names.emplace_back(entry->d_name);
    std::sort(names.begin(), names.end());
    return names;
}

template <typename... Numbers>
std::string formatted(const char* format, Numbers... numbers)
{
    std::array<char, 64> text{};
    std::snprintf(text.data(), text.size(), format, numbers...);
    return text.data();
}

// Returns what libsensors appends to the names of chips with that device, which the kernel names by
// its address on a SCSI, PCI or I2C bus. Returns nothing for other names.
std::optional<std::string> addressIn(const std::string& device)
{
    unsigned first = 0;
    unsigned second = 0;
    unsigned third = 0;
    unsigned fourth = 0;
    int end = 0;
    const auto isRead = [&](int count, int expected) {
        return count == expected && static_cast<std::size_t>(end) == device.size();
    };
    const char* const text = device.c_str();
    // NOLINTBEGIN(cert-err34-c): the kernel's names have no numbers that overflow
    if (isRead(std::sscanf(text, "%u:%u:%u:%x%n", &first, &second, &third, &fourth, &end), 4))
        return formatted("-scsi-%u-%x", first, (second << 8U) + (third << 4U) + fourth);
    if (isRead(std::sscanf(text, "%x:%2x:%2x.%1x%n", &first, &second, &third, &fourth, &end), 4))
        return formatted("-pci-%04x", (first << 16U) + (second << 8U) + (third << 3U) + fourth);
    if (isRead(std::sscanf(text, "%u-%4x%n", &first, &second, &end), 2))
        return formatted("-i2c-%u-%02x", first, second);
    // NOLINTEND(cert-err34-c)
    return std::nullopt;
}

// Returns the name of the slot of the PCI device at the address, such as "0000:03:00.0".
std::string slotOf(const std::string& address)
{
    for (const std::string& slot : entriesOf(slotFolder)) {
        const std::string place = lineIn(std::string(slotFolder) + "/" + slot + "/address");
        if (!place.empty() && address.starts_with(place + "."))
            return "PCI slot " + slot;
    }
    return "";
}

std::string deviceIn(const std::string& folder, const std::string& address)
{
    for (const char* const attribute : {"/model", "/model_name"})
        if (std::string model = lineIn(folder + attribute); !model.empty())
            return model;
    if (const auto interfaces = entriesOf(folder + "/net"); !interfaces.empty())
        return interfaces.front();
    return slotOf(address);
}

} // namespace

ChipDevices::ChipDevices()
{
    for (const std::string& entry : entriesOf(hwmonFolder))
        read(std::string(hwmonFolder).append("/").append(entry));
}

void ChipDevices::read(const std::string& folder)
{
    countChannels(folder);
    std::error_code failure;
    const Files::path real = Files::canonical(folder + "/device", failure);
    if (failure)
        return;
    // A disk's controller or an interface's class device may stand between the chip and its
    // address.
    for (Files::path place = real; place.has_relative_path(); place = place.parent_path())
        if (const auto address = addressIn(place.filename().string())) {
            const std::string device = deviceIn(folder + "/device", place.filename().string());
            devices_.emplace(lineIn(folder + "/name") + *address, device);
            return;
        }
}

void ChipDevices::countChannels(const std::string& folder)
{
    // The attributes that each channel of a kind has.
    struct OtherKind {
        std::string_view attribute;
        std::string_view suffix;
        const char* kind;
    };
    constexpr std::array kinds = {OtherKind{"curr", "_input", "current"},
        OtherKind{"power", "_input", "power"}, OtherKind{"power", "_average", "power"},
        OtherKind{"energy", "_input", "energy"}, OtherKind{"humidity", "_input", "humidity"},
        OtherKind{"intrusion", "_alarm", "intrusion"}};
    std::set<std::string> channels;
    for (const std::string& name : entriesOf(folder))
        for (const OtherKind& each : kinds)
            if (name.starts_with(each.attribute) && name.ends_with(each.suffix)) {
                channels.insert(name.substr(0, name.size() - each.suffix.size()));
                otherKinds_.insert(each.kind);
            }
    otherChannels_ += channels.size();
}

void ChipDevices::nameIn(Sensors& sensors) const
{
    for (Sensor& sensor : sensors)
        if (const auto device = devices_.find(sensor.chip); device != devices_.end())
            sensor.device = device->second;
}

std::string ChipDevices::otherChannels() const
{
    if (otherChannels_ == 0)
        return "";
    std::string kinds;
    for (const std::string& kind : otherKinds_)
        kinds.append(kinds.empty() ? "" : ", ").append(kind);
    return std::to_string(otherChannels_) +
           (otherChannels_ == 1 ? " channel of another kind is" : " channels of other kinds are") +
           " not shown (" + kinds + ").";
}

} // namespace Tools
