// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorName.h"

#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace Ipmi {

namespace {

constexpr std::array<const char*, 55> entityNames = {"Unspecified", "Other", "Unknown", "Processor",
    "Disk", "Peripheral Bay", "Management Module", "System Board", "Memory Module",
    "Processor Module", "Power Supply", "Add-in Card", "Front Panel", "Back Panel", "Power Board",
    "Drive Backplane", "Expansion Board", "Other Board", "Processor Board", "Power Unit",
    "Power Module", "Power Management", "Chassis Back Panel", "Chassis", "Sub-Chassis",
    "Other Chassis Board", "Disk Bay", "Peripheral Bay", "Device Bay", "Fan", "Cooling Unit",
    "Cable", "Memory Device", "Management Software", "System Firmware", "Operating System",
    "System Bus", "Group", "Remote Management", "External Environment", "Battery",
    "Processing Blade", "Connectivity Switch", "Processor/Memory Module", "I/O Module",
    "Processor/I/O Module", "Management Controller", "IPMI Channel", "PCI Bus", "PCI Express Bus",
    "SCSI Bus", "SATA/SAS Bus", "Front-Side Bus", "Clock", "System Firmware"};

std::string fromBcdPlus(std::span<const std::uint8_t> bytes)
{
    constexpr std::string_view digits = "0123456789 -."; // the other codes are reserved
    std::string text;
    for (const unsigned byte : bytes)
        for (const unsigned digit : {byte & 0xFU, byte >> 4U})
            if (digit < digits.size())
                text += digits[digit];
    return text;
}

// Unpacks characters of six bits, the lowest bits first.
std::string fromSixBits(std::span<const std::uint8_t> bytes)
{
    std::string text;
    unsigned bits = 0;
    unsigned count = 0;
    for (const unsigned byte : bytes) {
        bits |= byte << count;
        for (count += 8; count >= 6; count -= 6, bits >>= 6U)
            text += static_cast<char>((bits & 0x3FU) + ' ');
    }
    return text;
}

std::string fromLatin1(std::span<const std::uint8_t> bytes)
{
    std::string text;
    for (const char32_t byte : bytes)
        Text::appendUtf8(text, byte);
    return text;
}

std::string fromEightBits(std::span<const std::uint8_t> bytes)
{
    const std::string text(bytes.begin(), bytes.end());
    return Text::toValidUtf8(text) == text ? text : fromLatin1(bytes);
}

std::string printableIn(std::string_view text)
{
    std::string printable;
    while (!text.empty()) {
        const Text::Character character = Text::firstCharacter(text);
        if (!Text::isUnprintable(character.code))
            printable += text.substr(0, character.size);
        text.remove_prefix(character.size);
    }
    return printable;
}

std::string decoded(unsigned type, std::span<const std::uint8_t> bytes)
{
    switch (type) {
    case 1:
        return fromBcdPlus(bytes);
    case 2:
        return fromSixBits(bytes);
    default: // 0 is "Unicode" in an encoding that the standard leaves open; controllers use 8 bits
        return fromEightBits(bytes);
    }
}

} // namespace

std::string decodeName(std::span<const std::uint8_t> idString)
{
    if (idString.empty())
        return {};
    const std::size_t length = std::min<std::size_t>(idString[0] & 0x1FU, idString.size() - 1);
    const std::string text = printableIn(decoded(idString[0] >> 6U, idString.subspan(1, length)));
    return std::string(Text::trimmed(text));
}

std::string entityName(std::uint8_t entity, std::uint8_t instance)
{
    const std::string name = entity < entityNames.size() ? std::string(entityNames[entity])
                                                         : "Entity " + std::to_string(entity);
    return name + " " + std::to_string(instance & 0x7FU); // bit 7: relative to a controller
}

} // namespace Ipmi
